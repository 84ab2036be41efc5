// The launcher's one window.
#ifndef AUTOPLAY_SHELL_WINDOW_WIN_H
#define AUTOPLAY_SHELL_WINDOW_WIN_H

#include <windows.h>

inline constexpr wchar_t kWindowClassName[] = L"LauncherAppClass";
inline constexpr wchar_t kWindowTitle[] = L"AutoPlay";
// A second launcher broadcasts this to bring the first one to the front.
constexpr UINT kBringToFrontMessage = 0xFFFE;

LRESULT CALLBACK MainWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

#endif
