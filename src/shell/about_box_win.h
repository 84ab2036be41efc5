// The About box: the product's picture and an OK button, modal over the launcher.
#ifndef AUTOPLAY_SHELL_ABOUT_BOX_WIN_H
#define AUTOPLAY_SHELL_ABOUT_BOX_WIN_H

#include <windows.h>

inline constexpr wchar_t kAboutDialog[] = L"AboutDlg";

// Enter, OK and the system menu's Close end the box with 1; Escape does not close it.
INT_PTR CALLBACK AboutProc(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam);

// Runs the box until the user closes it.
void ShowAboutBox(HWND owner);

#endif
