// The hover look: a thread-local mouse hook gives the keyboard focus to the button under the
// mouse (circular buttons only inside their circle), and a focused button draws its
// highlighted face. It acts only while the launcher is the active application.
#ifndef AUTOPLAY_SHELL_MOUSE_HOOK_WIN_H
#define AUTOPLAY_SHELL_MOUSE_HOOK_WIN_H

#include <windows.h>

// Installs (true) or removes (false) the hook. 1 when a hook was installed, the result of
// UnhookWindowsHookEx when one was removed, 0 when there was nothing to do or it failed. The
// window is not used.
int SetMouseHook(HINSTANCE instance, HWND window, bool install);

LRESULT CALLBACK MouseHookProc(int code, WPARAM wParam, LPARAM lParam);

// The window to which the hook last gave the focus.
HWND HoverFocusWindow();
// The keyboard moved the focus: the next mouse move gives it to what is under the mouse again.
void NoteKeyboardFocus(HWND window);

#endif
