#include "shell/window_win.h"

#include "shell/launcher_state.h"

LRESULT CALLBACK MainWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
        case WM_DESTROY:
            PostQuitMessage(0);
            return 0;
        case WM_ACTIVATE:
            if (LOWORD(wParam) == WA_INACTIVE) {
                launcher.appActive = false;
            } else {
                launcher.appActive = true;
                launcher.menu.Refresh();
            }
            return 0;
        case WM_PAINT: {
            launcher.menu.CheckInstallation();
            PAINTSTRUCT paint;
            BeginPaint(window, &paint);
            EndPaint(window, &paint);
            return 0;
        }
        case WM_COMMAND:
            launcher.menu.OnCommand(static_cast<std::uint32_t>(wParam));
            return 0;
        case kBringToFrontMessage:
            ShowWindow(launcher.mainWindow, SW_SHOWNORMAL);
            SetForegroundWindow(launcher.mainWindow);
            return 0;
        default:
            return DefWindowProcW(window, message, wParam, lParam);
    }
}
