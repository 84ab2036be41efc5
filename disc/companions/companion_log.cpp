#include "companion_log.h"

#include <windows.h>

#include <string>

namespace {

std::wstring LogPath() {
    wchar_t path[MAX_PATH * 2];
    DWORD length = GetEnvironmentVariableW(L"VEMO_COMPANION_LOG", path, MAX_PATH * 2);
    if (length > 0 && length < MAX_PATH * 2) return path;
    length = GetTempPathW(MAX_PATH * 2, path);
    if (length == 0 || length >= MAX_PATH * 2) return L"vemo-companions.log";
    return std::wstring(path) + L"vemo-companions.log";
}

std::string Utf8(const std::wstring& text) {
    if (text.empty()) return std::string();
    int size = WideCharToMultiByte(CP_UTF8, 0, text.data(), static_cast<int>(text.size()), nullptr,
                                   0, nullptr, nullptr);
    std::string utf8(static_cast<std::size_t>(size), '\0');
    WideCharToMultiByte(CP_UTF8, 0, text.data(), static_cast<int>(text.size()), utf8.data(), size,
                        nullptr, nullptr);
    return utf8;
}

}  // namespace

void AppendCompanionLog(const wchar_t* program, const wchar_t* arguments) {
    wchar_t folder[MAX_PATH * 2] = {};
    GetCurrentDirectoryW(MAX_PATH * 2, folder);
    std::wstring line = std::wstring(program) + L"\t" + (arguments ? arguments : L"") + L"\t" +
                        folder + L"\r\n";
    std::string bytes = Utf8(line);
    // Appends are atomic per write, so programs started together do not interleave lines.
    HANDLE file = CreateFileW(LogPath().c_str(), FILE_APPEND_DATA,
                              FILE_SHARE_READ | FILE_SHARE_WRITE, nullptr, OPEN_ALWAYS,
                              FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file == INVALID_HANDLE_VALUE) return;
    DWORD written = 0;
    WriteFile(file, bytes.data(), static_cast<DWORD>(bytes.size()), &written, nullptr);
    CloseHandle(file);
}
