// Where the launcher finds the disc: the folder of the program as it was invoked.
#ifndef AUTOPLAY_SHELL_ROOT_PATH_H
#define AUTOPLAY_SHELL_ROOT_PATH_H

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

// Room for the disc root, terminator included.
constexpr std::size_t kRootPathCapacity = 260;

// The text of `programPath` up to and including its last backslash, when there is a
// backslash and the folder fits in `capacity` characters with its terminator.
std::optional<std::wstring> FolderWithTrailingBackslash(std::wstring_view programPath,
                                                        std::size_t capacity);

// `folder` + `fileName`, when the whole path fits in `capacity` characters with its terminator.
std::optional<std::wstring> PathInFolder(std::wstring_view folder, std::wstring_view fileName,
                                         std::size_t capacity);

// The drive letter of a current directory: its first character upper-cased when the second is
// a colon, else '@' (the character before 'A'), as for a network path.
wchar_t DriveLetterOfDirectory(std::wstring_view directory);

#endif
