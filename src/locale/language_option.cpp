#include "locale/language_option.h"

#include <cstddef>

namespace {

bool IsCSpace(wchar_t c) {
    return c == L' ' || c == L'\t' || c == L'\n' || c == L'\v' || c == L'\f' || c == L'\r';
}

int HexDigitValue(wchar_t c) {
    if (c >= L'0' && c <= L'9') return c - L'0';
    if (c >= L'a' && c <= L'f') return c - L'a' + 10;
    if (c >= L'A' && c <= L'F') return c - L'A' + 10;
    return -1;
}

}  // namespace

std::uint32_t ParseHexLikeStrtoul(const wchar_t* text, std::size_t length) {
    std::size_t i = 0;
    while (i < length && IsCSpace(text[i])) ++i;
    bool negative = false;
    if (i < length && (text[i] == L'+' || text[i] == L'-')) {
        negative = text[i] == L'-';
        ++i;
    }
    // "0x" is a prefix only when a hex digit follows it; otherwise the "0" alone is the number.
    if (i + 2 < length && text[i] == L'0' && (text[i + 1] == L'x' || text[i + 1] == L'X') &&
        HexDigitValue(text[i + 2]) >= 0) {
        i += 2;
    }
    std::uint32_t value = 0;
    for (; i < length; ++i) {
        int digit = HexDigitValue(text[i]);
        if (digit < 0) break;
        value = value * 16 + static_cast<std::uint32_t>(digit);
    }
    // Unsigned negation, as strtoul does for a leading minus.
    return negative ? 0u - value : value;
}

std::optional<std::uint16_t> ParseLanguageOption(const wchar_t* commandLine) {
    constexpr std::size_t kOptionLength = 6;
    if (commandLine == nullptr) return std::nullopt;
    std::size_t length = 0;
    while (length <= kOptionLength && commandLine[length] != L'\0') ++length;
    if (length != kOptionLength || commandLine[0] != L'-' || commandLine[1] != L'l') {
        return std::nullopt;
    }
    return static_cast<std::uint16_t>(ParseHexLikeStrtoul(commandLine + 2, 4) & 0xFFFF);
}
