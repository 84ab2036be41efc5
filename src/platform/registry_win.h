// Registry access as the launcher needs it: a missing key or value is simply absent.
#ifndef AUTOPLAY_PLATFORM_REGISTRY_WIN_H
#define AUTOPLAY_PLATFORM_REGISTRY_WIN_H

#include <windows.h>

#include <cstddef>

#include "platform/handles_win.h"

// Read access as the installed product's keys are opened: KEY_READ (0x20019).
RegistryKey OpenKeyForReading(HKEY root, const wchar_t* path);

// Reads a REG_SZ value into `buffer` (`capacity` characters). False, with the buffer left
// alone, when the value is missing, of another type or longer than the buffer. The text is
// always terminated, also when the stored data lacks its NUL.
bool QueryText(HKEY key, const wchar_t* name, wchar_t* buffer, std::size_t capacity);

// Reads a value of any type into `buffer` (`size` bytes); `size` becomes the data length.
// False when the value is missing or longer than the buffer.
bool QueryData(HKEY key, const wchar_t* name, BYTE* buffer, DWORD& size, DWORD* type = nullptr);

#endif
