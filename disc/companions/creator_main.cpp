// The sample disc's creator tool, installed beside the game in "The Vemo Creator".
#include <windows.h>

#include "companion_log.h"
#include "companion_window_win.h"

int WINAPI wWinMain(HINSTANCE instance, HINSTANCE, PWSTR commandLine, int showCommand) {
    AppendCompanionLog(L"TheVemoCreator.exe", commandLine);
    CompanionPage page{L"VemoCreatorWindow",
                       L"The Vemo Creator",
                       L"The Vemo Creator",
                       L"The creator tool of The Vemo Vodizuri Virezazida, for making your own "
                       L"Vemo worlds.",
                       RGB(214, 120, 40),
                       StartFacts(commandLine, L"(none)")};
    return RunCompanionWindow(instance, page, showCommand);
}
