#include "graphics/catalogue_win.h"

#include <windows.h>

#include <string>

#include "locale/language_table.h"
#include "platform/handles_win.h"
#include "shell/launcher_state.h"

namespace {

// The size of the first language background that loads from the disc.
bool MeasureFirstBackground(LONG& width, LONG& height) {
    for (const LanguageInfo& language : Languages()) {
        std::wstring path = std::wstring(launcher.rootPath) + language.backgroundFile;
        UniqueGdiObject picture(LoadImageW(nullptr, path.c_str(), IMAGE_BITMAP, 0, 0,
                                           LR_LOADFROMFILE | LR_CREATEDIBSECTION));
        BITMAP info{};
        if (picture && GetObjectW(picture.Get(), sizeof(info), &info) == sizeof(info)) {
            width = info.bmWidth;
            height = info.bmHeight;
            return true;
        }
    }
    return false;
}

}  // namespace

void LoadCatalogue() {
    LONG width = 0;
    LONG height = 0;
    if (!MeasureFirstBackground(width, height)) width = height = 0;
    launcher.backgroundWidth = width;
    launcher.backgroundHeight = height;
}

void ReleaseCatalogue() {}
