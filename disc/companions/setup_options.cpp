#include "setup_options.h"

#include <cwctype>

namespace {

bool IsBlank(wchar_t c) {
    return c == L' ' || c == L'\t';
}

std::optional<std::uint16_t> ParseHexLangId(std::wstring_view digits) {
    if (digits.empty() || digits.size() > 4) return std::nullopt;
    std::uint16_t value = 0;
    for (wchar_t c : digits) {
        std::uint16_t digit = 0;
        if (c >= L'0' && c <= L'9') {
            digit = static_cast<std::uint16_t>(c - L'0');
        } else if (c >= L'a' && c <= L'f') {
            digit = static_cast<std::uint16_t>(c - L'a' + 10);
        } else if (c >= L'A' && c <= L'F') {
            digit = static_cast<std::uint16_t>(c - L'A' + 10);
        } else {
            return std::nullopt;
        }
        value = static_cast<std::uint16_t>(value * 16 + digit);
    }
    return value;
}

}  // namespace

SetupOptions ParseSetupOptions(std::wstring_view commandLine) {
    SetupOptions options;
    std::size_t position = 0;
    while (position < commandLine.size()) {
        if (IsBlank(commandLine[position])) {
            ++position;
            continue;
        }
        std::size_t end = position;
        while (end < commandLine.size() && !IsBlank(commandLine[end])) ++end;
        std::wstring_view word = commandLine.substr(position, end - position);
        position = end;

        wchar_t letter = L'\0';
        if (word.size() >= 2 && (word[0] == L'-' || word[0] == L'/')) {
            letter = static_cast<wchar_t>(std::towlower(static_cast<wint_t>(word[1])));
        }
        std::wstring_view rest = word.size() >= 2 ? word.substr(2) : std::wstring_view();
        if (letter == L'l') {
            options.langId = ParseHexLangId(rest);
            if (!options.langId) options.understood = false;
        } else if (letter == L's' && rest.empty()) {
            options.silent = true;
        } else if (letter == L'u' && rest.empty()) {
            options.uninstall = true;
        } else {
            options.understood = false;
        }
    }
    return options;
}
