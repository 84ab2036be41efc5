#include "shell/about_box_win.h"

#include "platform/system_style_win.h"
#include "shell/launcher_state.h"

INT_PTR CALLBACK AboutProc(HWND dialog, UINT message, WPARAM wParam, LPARAM /*lParam*/) {
    switch (message) {
        case WM_INITDIALOG:
            return TRUE;  // the system puts the focus on the default button
        case WM_COMMAND:
            // Only OK (or Enter) closes the box: Escape arrives as IDCANCEL and is ignored.
            if (wParam == IDOK) {
                EndDialog(dialog, 1);
                return TRUE;
            }
            return FALSE;
        case WM_CLOSE:
            EndDialog(dialog, 1);
            return TRUE;
        default:
            // WM_PAINT included: the dialog's own handling paints its background and validates
            // the area; the picture and the button paint themselves.
            return FALSE;
    }
}

void ShowAboutBox(HWND owner) {
    SystemStyle style(launcher.instance);
    DialogBoxParamW(launcher.instance, kAboutDialog, owner, AboutProc, 0);
}
