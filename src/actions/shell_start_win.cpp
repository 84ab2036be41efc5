#include "actions/shell_start_win.h"

#include <shellapi.h>

INT_PTR OpenWithShell(HWND owner, const wchar_t* file, const wchar_t* parameters,
                      const wchar_t* directory) {
    // https://learn.microsoft.com/windows/win32/api/shellapi/nf-shellapi-shellexecutew
    HINSTANCE result = ShellExecuteW(owner, L"open", file, parameters, directory, SW_SHOWNORMAL);
    return reinterpret_cast<INT_PTR>(result);
}
