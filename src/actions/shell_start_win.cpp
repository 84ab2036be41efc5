#include "actions/shell_start_win.h"

#include <shellapi.h>

#include "actions/command_lines.h"
#include "platform/handles_win.h"

INT_PTR OpenWithShell(HWND owner, const wchar_t* file, const wchar_t* parameters,
                      const wchar_t* directory) {
    // https://learn.microsoft.com/windows/win32/api/shellapi/nf-shellapi-shellexecutew
    HINSTANCE result = ShellExecuteW(owner, L"open", file, parameters, directory, SW_SHOWNORMAL);
    return reinterpret_cast<INT_PTR>(result);
}

bool StartNotepad(const std::wstring& documentPath) {
    wchar_t system[MAX_PATH];
    UINT length = GetSystemDirectoryW(system, MAX_PATH);
    if (length == 0 || length >= MAX_PATH) return false;
    const std::wstring program = std::wstring(system, length) + L"\\notepad.exe";
    std::wstring commandLine = NotepadCommandLine(documentPath);
    STARTUPINFOW startup{};
    startup.cb = sizeof(startup);
    PROCESS_INFORMATION started{};
    if (!CreateProcessW(program.c_str(), commandLine.data(), nullptr, nullptr, FALSE, 0, nullptr,
                        nullptr, &startup, &started)) {
        return false;
    }
    UniqueHandle process(started.hProcess);
    UniqueHandle thread(started.hThread);
    return true;
}
