// The launcher's one window.
#ifndef AUTOPLAY_SHELL_WINDOW_WIN_H
#define AUTOPLAY_SHELL_WINDOW_WIN_H

#include <windows.h>

inline constexpr wchar_t kWindowClassName[] = L"LauncherAppClass";
inline constexpr wchar_t kWindowTitle[] = L"AutoPlay";
// A second launcher broadcasts this to bring the first one to the front.
constexpr UINT kBringToFrontMessage = 0xFFFE;
// Registered message that asks the launcher, from another process, what it holds: wParam
// kGdiHandlesHeld for the GDI objects and device contexts its handle owners hold, kWindowsHeld
// for the windows of its thread. Wine's GetGuiResources answers neither.
inline constexpr wchar_t kGuiObjectCountsMessageName[] = L"AutoPlay.GuiObjectCounts";
constexpr WPARAM kGdiHandlesHeld = 0;
constexpr WPARAM kWindowsHeld = 1;

LRESULT CALLBACK MainWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

#endif
