// A stand-in for the programs the shell opens web addresses, help pages and videos with. The
// tests associate those with it; it records how it was started and ends at once. Its line names
// the program by its own file name, so a copy planted under another name (a "notepad.exe" on the
// disc) shows up in the log as that name. It is not part of the sample disc.
#include <windows.h>

#include <string>

#include "companion_log.h"

namespace {

std::wstring OwnFileName() {
    wchar_t path[MAX_PATH * 2] = {};
    DWORD length = GetModuleFileNameW(nullptr, path, MAX_PATH * 2);
    if (length == 0 || length >= MAX_PATH * 2) return L"viewer.exe";
    std::wstring full(path, length);
    std::size_t slash = full.find_last_of(L"\\/");
    return slash == std::wstring::npos ? full : full.substr(slash + 1);
}

}  // namespace

int WINAPI wWinMain(HINSTANCE, HINSTANCE, PWSTR commandLine, int) {
    AppendCompanionLog(OwnFileName().c_str(), commandLine);
    return 0;
}
