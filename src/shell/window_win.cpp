#include "shell/window_win.h"

#include <new>

#include "actions/command_ids.h"
#include "actions/commands_win.h"
#include "graphics/painting_win.h"
#include "shell/about_box_win.h"
#include "platform/handles_win.h"
#include "shell/launcher_state.h"

namespace {

// The button that had the keyboard focus when the launcher was left, so that coming back (from
// the readme, a message box, another program) puts the focus where the user left it.
HWND focusWhenLeft = nullptr;

void RememberFocus(HWND window) {
    HWND focus = GetFocus();
    focusWhenLeft = focus && GetParent(focus) == window ? focus : nullptr;
}

void RestoreFocus(HWND window) {
    if (focusWhenLeft && IsWindowVisible(focusWhenLeft) && GetParent(focusWhenLeft) == window) {
        SetFocus(focusWhenLeft);
    } else {
        // Keys must reach the launcher, not fall through as system keys to a window without
        // focus.
        SetFocus(window);
    }
}

void DrawLauncherButton(std::uint32_t id, const DRAWITEMSTRUCT& item) {
    // A paint of the window restored the pristine background under every button, so after each
    // paint every button draws itself again, once and completely.
    if (!launcher.buttonsRefreshed) {
        launcher.buttonsRefreshed = true;
        for (const std::unique_ptr<LauncherButton>& button : launcher.menu.allButtons) {
            if (!button->latched) button->lastState = kNotDrawn;
            InvalidateRect(button->window, nullptr, TRUE);
        }
    }
    PaletteGuard palette(item.hDC, launcher.palette.Get());
    launcher.menu.DrawButton(item.hDC, id, item.itemState);
}

BOOL CALLBACK CountWindow(HWND, LPARAM count) {
    ++*reinterpret_cast<LRESULT*>(count);
    return TRUE;
}

BOOL CALLBACK CountWindowAndDescendants(HWND window, LPARAM count) {
    CountWindow(window, count);
    EnumChildWindows(window, CountWindow, count);
    return TRUE;
}

LRESULT GuiObjectCount(WPARAM what) {
    if (what == kGdiHandlesHeld) return gdiHandlesHeld;
    LRESULT windows = 0;
    if (what == kWindowsHeld) {
        EnumThreadWindows(GetCurrentThreadId(), CountWindowAndDescendants,
                          reinterpret_cast<LPARAM>(&windows));
    }
    return windows;
}

LRESULT HandleMessage(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

}  // namespace

LRESULT CALLBACK MainWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    // Nothing may unwind through the system's frames: a message that runs out of memory is
    // dropped, and the launcher goes on with what it has.
    try {
        return HandleMessage(window, message, wParam, lParam);
    } catch (const std::bad_alloc&) {
        return 0;
    }
}

namespace {

LRESULT HandleMessage(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case WM_DESTROY:
            PostQuitMessage(0);
            return 0;
        case WM_ACTIVATE:
            if (LOWORD(wParam) == WA_INACTIVE) {
                launcher.appActive = false;
                RememberFocus(window);
            } else {
                launcher.appActive = true;
                launcher.menu.Refresh();
                RestoreFocus(window);
            }
            return 0;
        case WM_PAINT: {
            launcher.menu.CheckInstallation();
            PAINTSTRUCT paint;
            HDC dc = BeginPaint(window, &paint);
            PaintLauncherWindow(dc);
            EndPaint(window, &paint);
            return 0;
        }
        case WM_PRINTCLIENT:
            PaintLauncherWindow(reinterpret_cast<HDC>(wParam));
            return 0;
        case WM_CTLCOLORBTN:
            return 0;
        case WM_QUERYNEWPALETTE: {
            WindowDc dc(window);
            // Switching the static colours off and on makes the system map the palette anew.
            SetSystemPaletteUse(dc.Get(), SYSPAL_NOSTATIC);
            SetSystemPaletteUse(dc.Get(), SYSPAL_STATIC);
            HPALETTE previous = SelectPalette(dc.Get(), launcher.palette.Get(), FALSE);
            UINT changed = RealizePalette(dc.Get());
            SelectPalette(dc.Get(), previous, FALSE);
            if (changed == 0 || changed == GDI_ERROR) return 0;
            InvalidateRect(window, nullptr, TRUE);
            return 1;
        }
        case WM_PALETTECHANGED: {
            if (reinterpret_cast<HWND>(wParam) == window) return 0;
            WindowDc dc(window);
            PaletteGuard palette(dc.Get(), launcher.palette.Get());
            InvalidateRect(window, nullptr, TRUE);
            return 0;
        }
        case WM_DRAWITEM:
            DrawLauncherButton(static_cast<std::uint32_t>(wParam),
                               *reinterpret_cast<const DRAWITEMSTRUCT*>(lParam));
            return 0;
        case WM_COMMAND:
            if (wParam == kCmdAbout) {
                PlayClickSound();
                ShowAboutBox(window);
            } else {
                launcher.menu.OnCommand(static_cast<std::uint32_t>(wParam));
            }
            return 0;
        case kBringToFrontMessage:
            ShowWindow(launcher.mainWindow, SW_SHOWNORMAL);
            SetForegroundWindow(launcher.mainWindow);
            return 0;
        default: {
            static const UINT guiObjectCounts = RegisterWindowMessageW(kGuiObjectCountsMessageName);
            if (message == guiObjectCounts) return GuiObjectCount(wParam);
            return DefWindowProcW(window, message, wParam, lParam);
        }
    }
}

}  // namespace
