// Text helpers at the Win32 boundary.
#ifndef AUTOPLAY_PLATFORM_TEXT_WIN_H
#define AUTOPLAY_PLATFORM_TEXT_WIN_H

#include <cstddef>
#include <string>
#include <string_view>

// Upper-cases a text as the system does for file names (CharUpperBuffW).
std::wstring UpperCased(std::wstring_view text);

// Copies `text` into a fixed buffer, cutting it to fit; the buffer always ends in NUL.
void CopyBounded(wchar_t* buffer, std::size_t capacity, std::wstring_view text);

// The full path of a module (null: this program), whatever its length.
std::wstring ModuleFileName(void* module = nullptr);

#endif
