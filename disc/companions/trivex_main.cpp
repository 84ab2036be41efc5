// The sample disc's support information tool, started from the disc's Support folder.
#include <windows.h>

#include "companion_log.h"
#include "companion_window_win.h"

int WINAPI wWinMain(HINSTANCE instance, HINSTANCE, PWSTR commandLine, int showCommand) {
    AppendCompanionLog(L"Trivex.exe", commandLine);
    CompanionPage page{L"TrivexWindow",
                       L"Trivex Support Information",
                       L"Trivex Support Information",
                       L"Gathers details of this computer for Orvak's support staff, so that they "
                       L"can help with The Vemo Vodizuri Virezazida.",
                       RGB(34, 140, 110),
                       StartFacts(commandLine, L"(none)")};
    return RunCompanionWindow(instance, page, showCommand);
}
