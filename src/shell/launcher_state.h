// The one record of the running launcher, shared by every subsystem on its one thread.
#ifndef AUTOPLAY_SHELL_LAUNCHER_STATE_H
#define AUTOPLAY_SHELL_LAUNCHER_STATE_H

#include <windows.h>

#include <cstdint>

#include "graphics/dib.h"
#include "locale/language_table.h"
#include "menu/menu_controller.h"
#include "platform/handles_win.h"
#include "shell/root_path.h"

constexpr std::size_t kCaptionCapacity = 64;
constexpr std::size_t kMessageCapacity = 256;

struct LauncherState {
    HINSTANCE instance = nullptr;
    HWND mainWindow = nullptr;
    wchar_t rootPath[kRootPathCapacity] = {};
    wchar_t driveString[3] = {};
    std::int32_t backgroundWidth = 0;
    std::int32_t backgroundHeight = 0;
    LanguageBase languageBase = kNoLanguage;
    bool languageKnown = false;
    bool useSystemLanguage = false;
    bool appActive = false;
    std::uint32_t productSku = 0;
    std::uint32_t discSku = 0;
    std::uint32_t openPanel = 0;
    bool buttonsRefreshed = false;
    const wchar_t emptyText[4] = {};
    wchar_t messageCaption[kCaptionCapacity] = {};
    wchar_t messageText[kMessageCapacity] = {};
    MenuController menu;

    // Graphics: the 256-colour palette (none on displays of more than 8 bits per pixel) with
    // its colours in picture order, the cursor kept while a picture converts, the working copy
    // of the background that panels and buttons are composited into, and the device bitmap
    // made from it at each paint, on which captions are written.
    UniqueGdi<HPALETTE> palette;
    DibPtr paletteTable;
    HCURSOR savedCursor = nullptr;
    DibPtr workingBackground;
    UniqueGdi<HBITMAP> backgroundBitmap;
};

extern LauncherState launcher;

#endif
