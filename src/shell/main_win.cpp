#include <windows.h>

#include "shell/startup_win.h"

int WINAPI wWinMain(HINSTANCE instance, HINSTANCE previous, PWSTR commandLine, int /*showCommand*/) {
    return RunLauncher(instance, previous, commandLine);
}
