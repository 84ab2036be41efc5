// The launcher's whole life: start-up checks, configuration, window, message loop, shutdown.
#ifndef AUTOPLAY_SHELL_STARTUP_WIN_H
#define AUTOPLAY_SHELL_STARTUP_WIN_H

#include <windows.h>

#include "platform/handles_win.h"

inline constexpr wchar_t kSingleInstanceMutexName[] = L"Autoplay";
inline constexpr wchar_t kGameWindowClass[] = L"Brask";
inline constexpr wchar_t kGameWindowTitle[] = L"The Vemo";

// Returns the process exit code.
int RunLauncher(HINSTANCE instance, HINSTANCE previous, const wchar_t* commandLine);

// Everything start-up made goes, in order: buttons, fonts, pictures and palette, the hook, the
// window, the mutex. Afterwards no global holds anything, so nothing is left for the
// destructors that run after the entry point returns.
void ShutDownLauncher(UniqueHandle& mutex, HINSTANCE instance);

// Sets the launcher's disc root from the program's path as invoked, falling back to the
// program's own folder when that path has no folder or is too long; and its drive string
// from the current directory.
void FindDiscRoot(const wchar_t* invokedAs);
void FindCurrentDrive();

#endif
