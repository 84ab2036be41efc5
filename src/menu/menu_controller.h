// The owner of the launcher's screens: which page is up, which fold-out panel is open,
// whether the game is installed and where, and the command handler behind every button.
#ifndef AUTOPLAY_MENU_MENU_CONTROLLER_H
#define AUTOPLAY_MENU_MENU_CONTROLLER_H

#include <windows.h>

#include <cstdint>
#include <string>

#include "menu/screen_layout.h"


class MenuController {
public:
    MenuController() = default;
    ~MenuController();
    MenuController(const MenuController&) = delete;
    MenuController& operator=(const MenuController&) = delete;

    // First screen, once the main window exists.
    void StartMainMenu(HWND parent);
    void StartLanguageList(HWND parent);

    void Refresh();
    void CheckInstallation();
    void TogglePanel(std::int32_t page);
    void DestroyAllButtons();

    // Everything a button (or the start-up failure path) asks for.
    void OnCommand(std::uint32_t id);

    std::wstring installPath;
    bool installed = false;
    bool mainMenuBuilt = false;
    bool panelOpen = false;
    std::int32_t installIndex = -1;
    std::int32_t playIndex = -1;
    std::int32_t gamesIndex = -1;
    std::int32_t infoIndex = -1;
    std::int32_t lastPanel = 0;

private:
    void CloseOpenPanel();
    void ShowInstallOrPlay();
    void StartInstaller();
};

#endif
