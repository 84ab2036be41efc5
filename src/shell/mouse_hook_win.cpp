#include "shell/mouse_hook_win.h"

#include <climits>

#include "shell/launcher_state.h"

namespace {

struct HookState {
    HHOOK hookHandle = nullptr;
    bool hookInstalled = false;
    HWND focusWindow = nullptr;
    // Where the mouse was at the last move the hook acted on.
    POINT lastPoint{LONG_MIN, LONG_MIN};
};
HookState hook;

void GiveFocus(HWND window) {
    hook.focusWindow = window;
    SetFocus(window);
}

void FollowMouse(const MOUSEHOOKSTRUCT& mouse) {
    // Circles first: every shaped button is asked, and where circles overlap the last one hit
    // keeps the focus.
    bool hit = false;
    for (const std::unique_ptr<LauncherButton>& button : launcher.menu.allButtons) {
        if (!button->IsShaped() || !button->wanted || !button->HitTest(mouse.pt.x, mouse.pt.y)) {
            continue;
        }
        hit = true;
        if (hook.focusWindow != button->window) GiveFocus(button->window);
    }
    if (hit) return;

    LauncherButton* under = launcher.menu.ButtonForWindow(mouse.hwnd);
    if (!under) {
        // The plain background: the focus goes there once.
        if (mouse.hwnd != hook.focusWindow) GiveFocus(mouse.hwnd);
    } else if (!under->wanted) {
        return;
    } else if (!under->IsShaped()) {
        GiveFocus(under->window);
    } else {
        // Inside a circular button's window but outside its circle.
        GiveFocus(launcher.mainWindow);
    }
}

}  // namespace

int SetMouseHook(HINSTANCE instance, HWND /*window*/, bool install) {
    if (install == hook.hookInstalled) return 0;
    if (install) {
        // https://learn.microsoft.com/windows/win32/winmsg/mouseproc
        hook.hookHandle =
            SetWindowsHookExW(WH_MOUSE, MouseHookProc, instance, GetCurrentThreadId());
        if (!hook.hookHandle) return 0;
        hook.hookInstalled = true;
        return 1;
    }
    BOOL removed = UnhookWindowsHookEx(hook.hookHandle);
    hook.hookHandle = nullptr;
    hook.hookInstalled = false;
    return removed;
}

LRESULT CALLBACK MouseHookProc(int code, WPARAM wParam, LPARAM lParam) {
    if (code >= 0 && launcher.appActive && LOWORD(wParam) == WM_MOUSEMOVE && lParam) {
        const auto& mouse = *reinterpret_cast<const MOUSEHOOKSTRUCT*>(lParam);
        // The system also sends a move, at the same point, when a window appears or goes
        // under a resting mouse; only a real move takes the focus from where the keyboard
        // put it.
        if (mouse.pt.x != hook.lastPoint.x || mouse.pt.y != hook.lastPoint.y) {
            hook.lastPoint = mouse.pt;
            FollowMouse(mouse);
        }
    }
    return CallNextHookEx(hook.hookHandle, code, LOWORD(wParam), lParam);
}

HWND HoverFocusWindow() {
    return hook.focusWindow;
}

void NoteKeyboardFocus(HWND window) {
    hook.focusWindow = window;
}
