// Starting other programs and documents through the shell, without waiting for them.
#ifndef AUTOPLAY_ACTIONS_SHELL_START_WIN_H
#define AUTOPLAY_ACTIONS_SHELL_START_WIN_H

#include <windows.h>

#include <string>

// ShellExecuteW with the verb "open" and SW_SHOWNORMAL; returns its result as a number
// (above 32 on success).
INT_PTR OpenWithShell(HWND owner, const wchar_t* file, const wchar_t* parameters,
                      const wchar_t* directory);

// Starts the Windows system folder's Notepad on a document, without waiting for it. Notepad is
// never looked for in the current folder or on the disc, where a program of that name could
// have been planted. False when it could not be started.
bool StartNotepad(const std::wstring& documentPath);

#endif
