// Registry access as the launcher needs it: a missing key or value is simply absent.
#ifndef AUTOPLAY_PLATFORM_REGISTRY_WIN_H
#define AUTOPLAY_PLATFORM_REGISTRY_WIN_H

#include <windows.h>

#include <cstddef>

#include "platform/handles_win.h"

// The shipped launcher and the product's installer are 32-bit programs, so on 64-bit Windows
// the product's keys live in the 32-bit view (Software\Wow6432Node). Every product, uninstall
// and locale key is opened in that view, so the 64-bit build reads and writes the same values.
// https://learn.microsoft.com/windows/win32/winprog64/accessing-an-alternate-registry-view
inline constexpr REGSAM kProductRegistryView = KEY_WOW64_32KEY;

// Opens the key for reading (KEY_READ).
RegistryKey OpenKeyForReading(HKEY root, const wchar_t* path);

// Opens the key, creating it and the keys above it as needed, with full access.
RegistryKey CreateKeyForWriting(HKEY root, const wchar_t* path);

// Deletes the key with its values and everything below it. True when the key is gone,
// also when it was not there.
bool DeleteKeyTree(HKEY root, const wchar_t* path);

// Reads a REG_SZ value into `buffer` (`capacity` characters). False, with the buffer left
// alone, when the value is missing, of another type or longer than the buffer. The text is
// always terminated, also when the stored data lacks its NUL.
bool QueryText(HKEY key, const wchar_t* name, wchar_t* buffer, std::size_t capacity);

// Reads a value of any type into `buffer` (`size` bytes); `size` becomes the data length.
// False when the value is missing or longer than the buffer.
bool QueryData(HKEY key, const wchar_t* name, BYTE* buffer, DWORD& size, DWORD* type = nullptr);

#endif
