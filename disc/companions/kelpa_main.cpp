// The sample disc's electronic registration program, started from the disc's Support folder.
#include <windows.h>

#include "companion_log.h"
#include "companion_window_win.h"

int WINAPI wWinMain(HINSTANCE instance, HINSTANCE, PWSTR commandLine, int showCommand) {
    AppendCompanionLog(L"Kelpa.exe", commandLine);
    CompanionPage page{L"KelpaWindow",
                       L"Kelpa Electronic Registration",
                       L"Kelpa Electronic Registration",
                       L"Registers your copy of The Vemo Vodizuri Virezazida with Orvak.",
                       RGB(150, 70, 170),
                       StartFacts(commandLine, L"(none)")};
    return RunCompanionWindow(instance, page, showCommand);
}
