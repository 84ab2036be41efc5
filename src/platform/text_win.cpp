#include "platform/text_win.h"

#include <windows.h>

std::wstring UpperCased(std::wstring_view text) {
    std::wstring upper(text);
    if (!upper.empty()) CharUpperBuffW(upper.data(), static_cast<DWORD>(upper.size()));
    return upper;
}

void CopyBounded(wchar_t* buffer, std::size_t capacity, std::wstring_view text) {
    if (capacity == 0) return;
    std::size_t length = text.size() < capacity - 1 ? text.size() : capacity - 1;
    text.copy(buffer, length);
    buffer[length] = L'\0';
}

std::wstring ModuleFileName(void* module) {
    std::wstring path(MAX_PATH, L'\0');
    for (;;) {
        DWORD length = GetModuleFileNameW(static_cast<HMODULE>(module), path.data(),
                                          static_cast<DWORD>(path.size()));
        if (length == 0) return std::wstring();
        if (length < path.size()) {
            path.resize(length);
            return path;
        }
        // Truncated: try again with more room (long paths can exceed MAX_PATH).
        if (path.size() >= 32768) return std::wstring();
        path.resize(path.size() * 2);
    }
}
