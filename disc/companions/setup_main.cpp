// The sample disc's installer.
#include <windows.h>

#include "companion_log.h"

int WINAPI wWinMain(HINSTANCE, HINSTANCE, PWSTR commandLine, int) {
    AppendCompanionLog(L"setup.exe", commandLine);
    return 0;
}
