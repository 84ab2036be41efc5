#include "actions/commands_win.h"

#include <windows.h>
#include <mmsystem.h>
#include <shellapi.h>

#include <string>

#include "actions/checks_win.h"
#include "actions/command_ids.h"
#include "actions/command_lines.h"
#include "actions/shell_start_win.h"
#include "locale/config_win.h"
#include "locale/picture_ids.h"
#include "locale/strings_win.h"
#include "menu/menu_controller.h"
#include "platform/text_win.h"
#include "shell/launcher_state.h"

namespace {

constexpr unsigned kNoticeFlags = MB_TASKMODAL | MB_ICONEXCLAMATION | MB_OK;
// ShellExecute's "no program is associated with this kind of file".
constexpr INT_PTR kNoAssociation = SE_ERR_NOASSOC;

bool Started(INT_PTR shellResult) { return shellResult > 32; }

bool IsLanguageCommand(std::uint32_t id) {
    return id >= kCmdFirstLanguage && id <= kCmdLastLanguage;
}

bool IsDemoCommand(std::uint32_t id) { return id >= kCmdDemoPc && id <= kCmdDemoConsole; }

}  // namespace

void PlayClickSound() {
    PlaySoundW(MAKEINTRESOURCEW(kClickSoundId), nullptr, SND_RESOURCE | SND_ASYNC);
}

void MenuController::OnCommand(std::uint32_t id) {
    // The web site and Exit work without the disc; everything else first makes sure the
    // launcher's own file is still reachable.
    if (id != kCmdWebSite && id != kCmdExit && !CheckLauncherFile()) return;
    PlayClickSound();
    if (IsLanguageCommand(id)) {
        ChooseLanguage(id);
        return;
    }
    if (IsDemoCommand(id)) {
        PlayDemo(id);
        return;
    }
    switch (id) {
        case kCmdInstall:
            StartInstaller();
            break;
        case kCmdPlayPanel:
            SwitchToPanel(PlayPanel);
            break;
        case kCmdGamesPanel:
            SwitchToPanel(GamesPanel);
            break;
        case kCmdInfoPanel:
            SwitchToPanel(InfoPanel);
            break;
        case kCmdWebSite:
            OpenWebSite();
            break;
        case kCmdExit:
            PostQuitMessage(0);
            break;
        case kCmdPlay:
        case kCmdPlayHighResolution:
        case kCmdCreator:
            StartGame(id);
            break;
        case kCmdReadme:
            OpenReadme();
            break;
        case kCmdSupport:
            OpenSupport();
            break;
        case kCmdRegistration:
            if (CheckDiscFiles()) {
                const ShellTarget target = RegistrationTarget(launcher.rootPath);
                OpenWithShell(nullptr, target.file.c_str(), nullptr, target.folder.c_str());
            }
            break;
        case kCmdReinstall:
            Reinstall();
            break;
        default:
            // Ids no button carries, and double-click notifications: only the click.
            break;
    }
}

void MenuController::CloseOpenPanel() {
    if (panelOpen) TogglePanel(lastPanel);
}

void MenuController::SwitchToPanel(std::int32_t page) {
    // At most one panel is open: another one closes first, and the same one closes again.
    if (panelOpen && lastPanel != page) TogglePanel(lastPanel);
    TogglePanel(page);
}

void MenuController::ChooseLanguage(std::uint32_t id) {
    const std::optional<LanguageBase> base = LanguageOfCommand(id);
    // The choice is made once: the main menu exists after it.
    if (!base || !pages[MainPage].empty()) return;
    launcher.languageBase = *base;
    launcher.languageKnown = true;
    SetPageShown(LanguagePage, false);
    BuildSafely(&MenuController::BuildMainMenu, launcher.mainWindow);
    ShowPage(MainPage);
    if (launcher.mainWindow) InvalidateRect(launcher.mainWindow, nullptr, TRUE);
}

void MenuController::StartInstaller() {
    if (!CheckDiscFiles()) return;
    CloseOpenPanel();
    const std::wstring parameters = InstallerParameters(launcher.languageBase);
    const std::wstring folder = SetupFolder(launcher.rootPath);
    OpenWithShell(launcher.mainWindow, kInstallerProgram, parameters.c_str(), folder.c_str());
}

void MenuController::OpenWebSite() {
    CloseOpenPanel();
    INT_PTR result =
        OpenWithShell(launcher.mainWindow, WebSiteFor(launcher.languageBase), nullptr, nullptr);
    if (result == kNoAssociation) {
        ShowLauncherMessage(kStrNoBrowserCaption, kStrNoBrowserText, kNoticeFlags);
    } else if (!Started(result)) {
        ShowLauncherMessage(kStrBrowserFailedCaption, kStrBrowserFailedText, kNoticeFlags);
    }
}

void MenuController::StartGame(std::uint32_t id) {
    // The game's folder is read again now: the game may have been removed since the last
    // check. Without it nothing starts and the launcher stays, showing Install.
    CheckInstallation();
    if (!installed || installPath.empty()) return;
    if (id == kCmdCreator) {
        const std::wstring folder = CreatorFolder(installPath);
        OpenWithShell(launcher.mainWindow, kCreatorProgram, nullptr, folder.c_str());
    } else {
        OpenWithShell(launcher.mainWindow, kGameProgram,
                      id == kCmdPlayHighResolution ? kHighResolutionParameters : nullptr,
                      installPath.c_str());
    }
    PostQuitMessage(0);
}

void MenuController::OpenReadme() {
    if (!CheckDiscFiles()) return;
    StartNotepad(ReadmePath(launcher.rootPath, launcher.languageBase));
}

void MenuController::OpenSupport() {
    if (!CheckDiscFiles()) return;
    const ShellTarget target =
        SupportTarget(launcher.rootPath, launcher.discSku, launcher.languageBase);
    OpenWithShell(nullptr, target.file.c_str(), nullptr, target.folder.c_str());
}

void MenuController::PlayDemo(std::uint32_t id) {
    if (!CheckDiscFiles()) return;
    const ShellTarget demo = DemoTarget(launcher.rootPath, id);
    INT_PTR result = OpenWithShell(launcher.mainWindow, demo.file.c_str(), launcher.emptyText,
                                   demo.folder.c_str());
    if (Started(result)) return;
    // One message for every failure: a missing file or no player for it.
    wchar_t format[kMessageCapacity];
    LoadLocalString(launcher.languageBase, kStrDemoMissingFormat, format, kMessageCapacity);
    LoadLocalString(launcher.languageBase, kStrDemoCaption, launcher.messageCaption,
                    kCaptionCapacity);
    CopyBounded(launcher.messageText, kMessageCapacity, FillPlaceholder(format, demo.file));
    ShowMessageBuffers(kNoticeFlags);
}

void MenuController::Reinstall() {
    if (!CheckDiscFiles()) return;
    if (ShowLauncherMessage(kStrReinstallCaption, kStrReinstallText, MB_OKCANCEL,
                            launcher.mainWindow) != IDOK) {
        return;
    }
    DeleteUninstallEntry();
    OnCommand(kCmdInstall);
}
