#include "actions/shell_start_win.h"

#include <string>

#include "actions/command_lines.h"
#include "platform/handles_win.h"

namespace {

using ShellExecuteFunction = HINSTANCE(WINAPI*)(HWND, LPCWSTR, LPCWSTR, LPCWSTR, LPCWSTR, INT);

std::wstring SystemFile(const wchar_t* name) {
    wchar_t system[MAX_PATH];
    UINT length = GetSystemDirectoryW(system, MAX_PATH);
    if (length == 0 || length >= MAX_PATH) return std::wstring();
    return std::wstring(system, length) + L"\\" + name;
}

// The shell is not among the program's imports: only a few commands need it, and loading it
// with everything it brings would cost every start-up. It comes from the system folder, never
// from the disc or the current folder.
ShellExecuteFunction ShellExecuteEntry() {
    static const ShellExecuteFunction entry = []() -> ShellExecuteFunction {
        const std::wstring path = SystemFile(L"shell32.dll");
        HMODULE shell = path.empty() ? nullptr : LoadLibraryW(path.c_str());
        FARPROC found = shell ? GetProcAddress(shell, "ShellExecuteW") : nullptr;
        return reinterpret_cast<ShellExecuteFunction>(reinterpret_cast<void (*)()>(found));
    }();
    return entry;
}

}  // namespace

INT_PTR OpenWithShell(HWND owner, const wchar_t* file, const wchar_t* parameters,
                      const wchar_t* directory) {
    // https://learn.microsoft.com/windows/win32/api/shellapi/nf-shellapi-shellexecutew
    ShellExecuteFunction open = ShellExecuteEntry();
    // Like ShellExecute's own 0: the system lacks the resources to start anything.
    if (!open) return 0;
    HINSTANCE result = open(owner, L"open", file, parameters, directory, SW_SHOWNORMAL);
    return reinterpret_cast<INT_PTR>(result);
}

bool StartNotepad(const std::wstring& documentPath) {
    const std::wstring program = SystemFile(L"notepad.exe");
    if (program.empty()) return false;
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
