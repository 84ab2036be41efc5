// Message boxes and dialogs in the system's own style (common controls 6).
//
// The program's manifest leaves the controls library out on purpose: the menu's buttons draw
// themselves, and had the manifest asked for version 6, the first of them would load the
// library at start-up. A second manifest in the program's resources asks for it, and a
// `SystemStyle` puts that manifest in force for as long as it lives, so the windows made
// meanwhile (a message box, the About box and its controls) take version 6.
#ifndef AUTOPLAY_PLATFORM_SYSTEM_STYLE_WIN_H
#define AUTOPLAY_PLATFORM_SYSTEM_STYLE_WIN_H

#include <windows.h>

class SystemStyle {
  public:
    // Without the manifest (a module that does not carry it) nothing changes.
    explicit SystemStyle(HINSTANCE module);
    ~SystemStyle();
    SystemStyle(const SystemStyle&) = delete;
    SystemStyle& operator=(const SystemStyle&) = delete;

  private:
    ULONG_PTR cookie_ = 0;
    bool active_ = false;
};

#endif
