#include <windows.h>
#include <mmsystem.h>

#include <string>

#include "actions/checks_win.h"
#include "actions/command_lines.h"
#include "actions/shell_start_win.h"
#include "menu/menu_controller.h"
#include "shell/launcher_state.h"

namespace {

constexpr std::uint32_t kInstallCommand = 101;
constexpr std::uint32_t kExitCommand = 110;
constexpr std::uint32_t kWebSiteCommand = 107;
constexpr WORD kClickSound = 113;

void PlayClick() {
    PlaySoundW(MAKEINTRESOURCEW(kClickSound), nullptr, SND_RESOURCE | SND_ASYNC);
}

}  // namespace

void MenuController::OnCommand(std::uint32_t id) {
    // The web site and Exit work without the disc; everything else first makes sure the
    // launcher's own file is still reachable.
    if (id != kWebSiteCommand && id != kExitCommand && !CheckLauncherFile()) return;
    PlayClick();
    switch (id) {
        case kInstallCommand:
            StartInstaller();
            break;
        case kExitCommand:
            PostQuitMessage(0);
            break;
        default:
            break;
    }
}

void MenuController::CloseOpenPanel() {
    if (panelOpen) TogglePanel(lastPanel);
}

void MenuController::StartInstaller() {
    if (!CheckDiscFiles()) return;
    CloseOpenPanel();
    const std::wstring parameters = InstallerParameters(launcher.languageBase);
    const std::wstring folder = SetupFolder(launcher.rootPath);
    OpenWithShell(launcher.mainWindow, L"setup.exe", parameters.c_str(), folder.c_str());
}
