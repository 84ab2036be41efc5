// Finding and reading the files of a disc folder the way the launcher finds them on Windows,
// from any system.
#ifndef AUTOPLAY_TOOLS_DISCCHECK_DISC_FILES_H
#define AUTOPLAY_TOOLS_DISCCHECK_DISC_FILES_H

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

// The launcher's tables name disc files in UTF-16 with backslashes; reports use UTF-8.
std::string Utf8(std::wstring_view text);

// The file or folder that a Windows path below `root` names ("support\readme.txt"), found as
// Windows finds it: every component is compared without regard to case (ASCII letters, which
// is all the disc's names use), so a disc mastered on a case-sensitive system is judged as
// the launcher will see it. An exact match wins over others that differ only in case.
// Nothing when a component is missing.
std::optional<std::filesystem::path> ResolveDiscPath(const std::filesystem::path& root,
                                                     std::string_view windowsPath);

// True when the path is a file that opens for reading, the launcher's test for disc files.
bool OpensForReading(const std::filesystem::path& path);

// The whole file, or nothing when it cannot be read or is larger than `limit` bytes.
std::optional<std::vector<std::uint8_t>> ReadWholeFile(const std::filesystem::path& path,
                                                       std::uintmax_t limit);

// A key of a Windows profile (.ini) file as the profile reader finds it: section and key
// names without regard to case and surrounding blanks, the first match, the value without
// surrounding blanks or one pair of quotes.
struct ProfileValue {
    bool sectionFound = false;
    std::optional<std::string> value;  // nothing when the section or the key is missing
};
ProfileValue FindProfileValue(std::string_view fileText, std::string_view section,
                              std::string_view key);

// The number the profile reader's integer call makes of a value: leading decimal digits
// after an optional sign, 0 when there are none.
std::int64_t ProfileInteger(std::string_view value);

#endif
