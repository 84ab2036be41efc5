#include "locale/strings_win.h"

#include <windows.h>

#include "platform/system_style_win.h"
#include "shell/launcher_state.h"

int LoadLocalString(LanguageBase base, std::uint32_t offset, wchar_t* buffer,
                    std::size_t capacity) {
    if (capacity == 0) return 0;
    buffer[0] = L'\0';
    // LoadStringW with a zero-length buffer would hand back a pointer instead of a copy.
    int length = LoadStringW(launcher.instance, static_cast<UINT>(base + offset), buffer,
                             static_cast<int>(capacity));
    if (length <= 0) buffer[0] = L'\0';
    return length > 0 ? length : 0;
}

int ShowLauncherMessage(std::uint32_t captionOffset, std::uint32_t textOffset, unsigned flags,
                        HWND owner) {
    LoadLocalString(launcher.languageBase, textOffset, launcher.messageText, kMessageCapacity);
    LoadLocalString(launcher.languageBase, captionOffset, launcher.messageCaption,
                    kCaptionCapacity);
    return ShowMessageBuffers(flags, owner);
}

int ShowMessageBuffers(unsigned flags, HWND owner) {
    SystemStyle style(launcher.instance);
    return MessageBoxW(owner, launcher.messageText, launcher.messageCaption, flags);
}
