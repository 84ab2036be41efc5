#include "shell/startup_win.h"

#include <mmsystem.h>

#include <cstdlib>
#include <string>

#include "locale/catalogue_win.h"
#include "locale/config_win.h"
#include "locale/strings_win.h"
#include "platform/handles_win.h"
#include "platform/system_style_win.h"
#include "platform/text_win.h"
#include "shell/launcher_state.h"
#include "shell/mouse_hook_win.h"
#include "shell/root_path.h"
#include "shell/window_win.h"

namespace {

constexpr WORD kIconResource = 101;
constexpr WORD kMusicResource = 308;
constexpr UINT kClassStyle = CS_VREDRAW | CS_HREDRAW | CS_OWNDC;
constexpr DWORD kWindowStyle = WS_POPUP | WS_DLGFRAME;
constexpr unsigned kNoticeFlags = MB_TASKMODAL | MB_ICONEXCLAMATION | MB_OK;
constexpr std::uint32_t kInstallCommand = 101;
// How long a second launcher waits for any one window to take its bring-to-front request.
constexpr UINT kBroadcastTimeoutMs = 1000;

void AskFirstLauncherToComeForward() {
    // The first launcher may raise itself only if this process, which the user just started,
    // lends it the right to take the foreground.
    AllowSetForegroundWindow(ASFW_ANY);
    // A hung or busy window elsewhere must not keep this process alive.
    SendMessageTimeoutW(HWND_BROADCAST, kBringToFrontMessage, 0, 0,
                        SMTO_ABORTIFHUNG | SMTO_NORMAL, kBroadcastTimeoutMs, nullptr);
}

bool RegisterLauncherClass(HINSTANCE instance) {
    WNDCLASSEXW windowClass{};
    windowClass.cbSize = sizeof(windowClass);
    windowClass.style = kClassStyle;
    windowClass.lpfnWndProc = MainWindowProc;
    windowClass.hInstance = instance;
    windowClass.hIcon = LoadIconW(instance, MAKEINTRESOURCEW(kIconResource));
    windowClass.hCursor = LoadCursorW(nullptr, IDC_ARROW);
    windowClass.lpszClassName = kWindowClassName;
    if (windowClass.hCursor == nullptr) return false;
    return RegisterClassExW(&windowClass) != 0;
}

HWND CreateLauncherWindow(HINSTANCE instance) {
    int width = launcher.backgroundWidth + 2 * GetSystemMetrics(SM_CXDLGFRAME);
    int height = launcher.backgroundHeight + 2 * GetSystemMetrics(SM_CYDLGFRAME);
    // Arithmetic shifts: a screen smaller than the window puts it at a negative position.
    int x = (GetSystemMetrics(SM_CXFULLSCREEN) - width) >> 1;
    int y = (GetSystemMetrics(SM_CYFULLSCREEN) - height) >> 1;
    return CreateWindowExW(0, kWindowClassName, kWindowTitle, kWindowStyle, x, y, width, height,
                           nullptr, nullptr, instance, nullptr);
}

void PlayStartupMusic() {
    PlaySoundW(MAKEINTRESOURCEW(kMusicResource), nullptr, SND_RESOURCE | SND_ASYNC);
}

// Not on the disc: say so in the system's language, and offer to install the product when
// it is not installed yet.
void ReportNotOnDisc() {
    LanguageFromLangId(GetSystemDefaultLangID());
    wchar_t text[kMessageCapacity];
    LoadLocalString(launcher.languageBase, kStrNotOnDiscText, text, kMessageCapacity);
    {
        SystemStyle style(launcher.instance);
        MessageBoxW(nullptr, text, launcher.emptyText, kNoticeFlags);
    }
    if (!UninstallEntryExists()) launcher.menu.OnCommand(kInstallCommand);
}

// Keys for the menu (Tab, the arrows, Enter, Escape) are taken before the focused button sees
// them, as a dialog's own loop would.
bool TakeMenuKey(const MSG& message) {
    if (message.message != WM_KEYDOWN || !launcher.mainWindow) return false;
    if (message.hwnd != launcher.mainWindow && GetParent(message.hwnd) != launcher.mainWindow) {
        return false;
    }
    const bool shift = GetKeyState(VK_SHIFT) < 0;
    if (!launcher.menu.HandleKey(static_cast<std::uint32_t>(message.wParam), shift, GetFocus())) {
        return false;
    }
    NoteKeyboardFocus(GetFocus());
    return true;
}

int RunMessageLoop() {
    MSG message{};
    for (;;) {
        BOOL result = GetMessageW(&message, nullptr, 0, 0);
        // -1: the loop itself failed; there is no quit message to take a code from.
        if (result == -1) return 0;
        if (result == 0) return static_cast<int>(message.wParam);
        if (TakeMenuKey(message)) continue;
        TranslateMessage(&message);
        DispatchMessageW(&message);
    }
}

}  // namespace

void ShutDownLauncher(UniqueHandle& mutex, HINSTANCE instance) {
    launcher.menu.DestroyAllButtons();
    ReleaseCatalogue();
    SetMouseHook(instance, launcher.mainWindow, false);
    if (launcher.mainWindow) DestroyWindow(launcher.mainWindow);
    launcher.mainWindow = nullptr;
    if (mutex) ReleaseMutex(mutex.Get());
    mutex.Reset();
}

void FindDiscRoot(const wchar_t* invokedAs) {
    std::optional<std::wstring> folder;
    if (invokedAs) folder = FolderWithTrailingBackslash(UpperCased(invokedAs), kRootPathCapacity);
    if (!folder) {
        folder = FolderWithTrailingBackslash(UpperCased(ModuleFileName()), kRootPathCapacity);
    }
    CopyBounded(launcher.rootPath, kRootPathCapacity, folder ? *folder : std::wstring());
}

void FindCurrentDrive() {
    wchar_t directory[MAX_PATH] = {};
    DWORD length = GetCurrentDirectoryW(MAX_PATH, directory);
    if (length >= MAX_PATH) length = 0;  // did not fit: no drive letter to read
    launcher.driveString[0] = DriveLetterOfDirectory(std::wstring_view(directory, length));
    launcher.driveString[1] = L':';
    launcher.driveString[2] = L'\0';
}

int RunLauncher(HINSTANCE instance, HINSTANCE previous, const wchar_t* commandLine) {
    UniqueHandle mutex(CreateMutexW(nullptr, TRUE, kSingleInstanceMutexName));
    if (GetLastError() == ERROR_ALREADY_EXISTS) {
        mutex.Reset();
        AskFirstLauncherToComeForward();
        return 0;
    }
    if (FindWindowExW(nullptr, nullptr, kGameWindowClass, kGameWindowTitle)) return 0;

    FindDiscRoot(__wargv ? __wargv[0] : nullptr);
    FindCurrentDrive();
    ReadConfiguration(commandLine);

    if (previous == nullptr && !RegisterLauncherClass(instance)) return 0;
    launcher.appActive = true;
    launcher.instance = instance;
    LoadCatalogue();

    if (launcher.backgroundWidth == 0) {
        ReportNotOnDisc();
        ShutDownLauncher(mutex, instance);
        return 0;
    }

    launcher.mainWindow = CreateLauncherWindow(instance);
    PlayStartupMusic();
    if (launcher.mainWindow == nullptr) {
        ReleaseCatalogue();
        return 0;
    }
    launcher.openPanel = kNoPanel;
    if (launcher.languageKnown) {
        launcher.menu.StartMainMenu(launcher.mainWindow);
    } else {
        launcher.menu.StartLanguageList(launcher.mainWindow);
    }
    ShowWindow(launcher.mainWindow, SW_SHOWNORMAL);
    SetMouseHook(instance, launcher.mainWindow, true);

    int exitCode = RunMessageLoop();
    ShutDownLauncher(mutex, instance);
    return exitCode;
}
