#include "disc_files.h"

#include <fstream>
#include <limits>
#include <system_error>

namespace fs = std::filesystem;

namespace {

char FoldCase(char c) {
    return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c;
}

bool SameIgnoringCase(std::string_view a, std::string_view b) {
    if (a.size() != b.size()) return false;
    for (std::size_t i = 0; i < a.size(); ++i) {
        if (FoldCase(a[i]) != FoldCase(b[i])) return false;
    }
    return true;
}

std::string_view Trim(std::string_view text) {
    const auto first = text.find_first_not_of(" \t\r\n");
    if (first == std::string_view::npos) return {};
    const auto last = text.find_last_not_of(" \t\r\n");
    return text.substr(first, last - first + 1);
}

// The entry of `folder` whose name matches `name` as Windows compares names.
std::optional<fs::path> FindEntry(const fs::path& folder, std::string_view name) {
    std::error_code error;
    const fs::path exact = folder / fs::u8path(name);
    if (fs::exists(exact, error)) return exact;
    std::optional<fs::path> found;
    for (fs::directory_iterator it(folder, error), end; !error && it != end; it.increment(error)) {
        const fs::path candidate = it->path();
        // The first in name order, so that a folder holding two spellings gives one answer.
        if (SameIgnoringCase(candidate.filename().u8string(), name) &&
            (!found || candidate.filename() < found->filename())) {
            found = candidate;
        }
    }
    return found;
}

}  // namespace

std::string Utf8(std::wstring_view text) {
    std::string out;
    for (wchar_t unit : text) {
        const auto c = static_cast<std::uint32_t>(unit);
        if (c < 0x80) {
            out += static_cast<char>(c);
        } else if (c < 0x800) {
            out += static_cast<char>(0xC0 | (c >> 6));
            out += static_cast<char>(0x80 | (c & 0x3F));
        } else {
            out += static_cast<char>(0xE0 | ((c >> 12) & 0x0F));
            out += static_cast<char>(0x80 | ((c >> 6) & 0x3F));
            out += static_cast<char>(0x80 | (c & 0x3F));
        }
    }
    return out;
}

std::optional<fs::path> ResolveDiscPath(const fs::path& root, std::string_view windowsPath) {
    fs::path at = root;
    while (!windowsPath.empty()) {
        const auto slash = windowsPath.find_first_of("\\/");
        const std::string_view component = windowsPath.substr(0, slash);
        windowsPath =
            slash == std::string_view::npos ? std::string_view{} : windowsPath.substr(slash + 1);
        if (component.empty()) continue;
        auto next = FindEntry(at, component);
        if (!next) return std::nullopt;
        at = *next;
    }
    return at;
}

bool OpensForReading(const fs::path& path) {
    std::error_code error;
    if (!fs::is_regular_file(path, error)) return false;
    std::ifstream file(path, std::ios::binary);
    return file.is_open();
}

std::optional<std::vector<std::uint8_t>> ReadWholeFile(const fs::path& path, std::uintmax_t limit) {
    std::error_code error;
    const std::uintmax_t size = fs::file_size(path, error);
    if (error || size > limit || size > std::numeric_limits<std::size_t>::max()) {
        return std::nullopt;
    }
    std::ifstream file(path, std::ios::binary);
    if (!file) return std::nullopt;
    std::vector<std::uint8_t> bytes(static_cast<std::size_t>(size));
    if (!bytes.empty() &&
        !file.read(reinterpret_cast<char*>(bytes.data()), static_cast<std::streamsize>(size))) {
        return std::nullopt;
    }
    return bytes;
}

ProfileValue FindProfileValue(std::string_view fileText, std::string_view section,
                              std::string_view key) {
    ProfileValue result;
    bool inSection = false;
    if (fileText.substr(0, 3) == "\xEF\xBB\xBF") fileText.remove_prefix(3);  // UTF-8 mark
    while (!fileText.empty()) {
        const auto newline = fileText.find('\n');
        const std::string_view line = Trim(fileText.substr(0, newline));
        fileText =
            newline == std::string_view::npos ? std::string_view{} : fileText.substr(newline + 1);
        if (!line.empty() && line.front() == '[') {
            const auto close = line.find(']');
            inSection = SameIgnoringCase(
                Trim(line.substr(
                    1, close == std::string_view::npos ? std::string_view::npos : close - 1)),
                section);
            result.sectionFound = result.sectionFound || inSection;
            continue;
        }
        const auto equals = line.find('=');
        if (!inSection || equals == std::string_view::npos ||
            !SameIgnoringCase(Trim(line.substr(0, equals)), key)) {
            continue;
        }
        std::string_view value = Trim(line.substr(equals + 1));
        if (value.size() >= 2 && (value.front() == '"' || value.front() == '\'') &&
            value.back() == value.front()) {
            value = value.substr(1, value.size() - 2);
        }
        result.value = std::string(value);
        return result;
    }
    return result;
}

std::int64_t ProfileInteger(std::string_view value) {
    std::size_t at = 0;
    const bool negative = !value.empty() && value[0] == '-';
    if (!value.empty() && (value[0] == '-' || value[0] == '+')) at = 1;
    std::int64_t number = 0;
    for (; at < value.size() && value[at] >= '0' && value[at] <= '9'; ++at) {
        // Far beyond any edition; the exact value of a huge number does not matter.
        if (number < (std::int64_t{1} << 40)) number = number * 10 + (value[at] - '0');
    }
    return negative ? -number : number;
}
