#include "shell/mouse_hook_win.h"

#include "shell/launcher_state.h"

namespace {

struct HookState {
    HHOOK hookHandle = nullptr;
    bool hookInstalled = false;
    HWND focusWindow = nullptr;
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
        FollowMouse(*reinterpret_cast<const MOUSEHOOKSTRUCT*>(lParam));
    }
    return CallNextHookEx(hook.hookHandle, code, LOWORD(wParam), lParam);
}

HWND HoverFocusWindow() { return hook.focusWindow; }
