// The one record of the running launcher, shared by every subsystem on its one thread.
#ifndef AUTOPLAY_SHELL_LAUNCHER_STATE_H
#define AUTOPLAY_SHELL_LAUNCHER_STATE_H

#include <windows.h>

#include <cstdint>

#include "locale/language_table.h"
#include "menu/menu_controller.h"
#include "shell/root_path.h"

constexpr std::uint32_t kNoPanel = 3;
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
};

extern LauncherState launcher;

#endif
