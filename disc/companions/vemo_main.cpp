// The sample disc's game: the window the launcher looks for (class "Brask", title
// "The Vemo") showing how it was started. "-r1024x768" asks for the high resolution.
#include <windows.h>

#include "companion_log.h"
#include "companion_window_win.h"

int WINAPI wWinMain(HINSTANCE instance, HINSTANCE, PWSTR commandLine, int showCommand) {
    AppendCompanionLog(L"Vemo.exe", commandLine);
    CompanionPage page{L"Brask",
                       L"The Vemo",
                       L"The Vemo",
                       L"The game of The Vemo Vodizuri Virezazida. This stand-in shows how the "
                       L"launcher started it.",
                       RGB(46, 110, 190),
                       StartFacts(commandLine, L"(default resolution)")};
    return RunCompanionWindow(instance, page, showCommand);
}
