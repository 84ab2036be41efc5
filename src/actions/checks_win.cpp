#include "actions/checks_win.h"

#include <windows.h>

#include <string>

#include "actions/command_lines.h"
#include "locale/config_win.h"
#include "locale/strings_win.h"
#include "platform/handles_win.h"
#include "platform/registry_win.h"
#include "shell/launcher_state.h"

namespace {

constexpr unsigned kPromptOkCancel = MB_TASKMODAL | MB_ICONEXCLAMATION | MB_OKCANCEL;
constexpr unsigned kPromptRetryCancel = MB_TASKMODAL | MB_ICONEXCLAMATION | MB_RETRYCANCEL;

}  // namespace

bool FileOpensForReading(const wchar_t* path) {
    UniqueHandle file(CreateFileW(path, GENERIC_READ, FILE_SHARE_READ | FILE_SHARE_WRITE, nullptr,
                                  OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL, nullptr));
    return static_cast<bool>(file);
}

bool CheckLauncherFile() {
    for (;;) {
        wchar_t path[MAX_PATH];
        if (GetModuleFileNameW(nullptr, path, MAX_PATH) != 0) return true;
        std::uint32_t text = kStrNoDriveText;
        std::uint32_t caption = kStrNoDriveCaption;
        switch (GetDriveTypeW(launcher.driveString)) {
            case DRIVE_CDROM:
                text = kStrReplaceCdText;
                caption = kStrReplaceCdCaption;
                break;
            case DRIVE_REMOVABLE:
                text = kStrRemovableText;
                caption = kStrRemovableCaption;
                break;
            default:
                break;
        }
        if (ShowLauncherMessage(caption, text, kPromptRetryCancel) == IDCANCEL) return false;
    }
}

bool CheckDiscFiles() {
    const std::wstring first = FirstDiscFile(launcher.rootPath);
    const std::wstring second = SecondDiscFile(launcher.rootPath);
    for (;;) {
        if (FileOpensForReading(first.c_str()) && FileOpensForReading(second.c_str())) return true;
        if (ShowLauncherMessage(kStrInsertDiscCaption, kStrInsertDiscText, kPromptOkCancel) ==
            IDCANCEL) {
            return false;
        }
    }
}

namespace {

constexpr std::size_t kGameFolderCapacity = 256;

// The installed game's folder, or nothing when the product is not (or no longer) installed.
// `markerSeen` carries the installation marker over from earlier checks: once seen, its
// removal alone does not make the game uninstalled.
bool ReadGameFolder(bool& markerSeen, std::wstring& folder) {
    RegistryKey key = OpenKeyForReading(HKEY_LOCAL_MACHINE, kProductKeyPath);
    if (!key) return false;
    // Presence is all that counts for these two values, whatever their type or length.
    if (RegQueryValueExW(key.Get(), L"Version", nullptr, nullptr, nullptr, nullptr) !=
        ERROR_SUCCESS) {
        return false;
    }
    if (RegQueryValueExW(key.Get(), L"EP8Installed", nullptr, nullptr, nullptr, nullptr) ==
        ERROR_SUCCESS) {
        markerSeen = true;
    }
    if (!markerSeen) return false;
    wchar_t text[kGameFolderCapacity];
    if (!QueryText(key.Get(), L"VEMO_DATA", text, kGameFolderCapacity)) return false;
    folder = text;
    return true;
}

}  // namespace

void MenuController::CheckInstallation() {
    bool markerSeen = installed;
    std::wstring folder;
    bool found = ReadGameFolder(markerSeen, folder);
    if (found) {
        installPath = folder;
        // A folder too long to name the game's program in counts as no game.
        const std::optional<std::wstring> program = GameProgramPath(folder);
        found = program && FileOpensForReading(program->c_str());
    }
    installed = found;
    ShowInstallOrPlay();
}
