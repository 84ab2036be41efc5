// The owner of every picture button: which page is up, which fold-out panel is open, whether
// the game is installed and where, and the command handler behind every button.
#ifndef AUTOPLAY_MENU_MENU_CONTROLLER_H
#define AUTOPLAY_MENU_MENU_CONTROLLER_H

#include <windows.h>

#include <array>
#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "menu/launcher_button_win.h"
#include "menu/screen_layout.h"

class MenuController {
  public:
    MenuController() = default;
    ~MenuController();
    MenuController(const MenuController&) = delete;
    MenuController& operator=(const MenuController&) = delete;

    // The first screen, once the main window exists.
    void StartMainMenu(HWND parent);
    void StartLanguageList(HWND parent);

    // The screens: every button is created hidden and registered in its page.
    void BuildLanguageList(HWND parent);
    void BuildMainMenu(HWND parent);
    void BuildGamesPanel(HWND parent);
    void BuildPlayPanel(HWND parent);
    void AddPanelButton(HWND parent, std::int32_t page, std::int32_t slot, std::uint32_t id,
                        std::uint32_t labelOffset);

    // Runs the installation check again and shows Install or Play to match.
    void Refresh();
    void CheckInstallation();
    // Shows a page's buttons as their `wanted` flags say; a panel's only while it is open.
    void ShowPage(std::int32_t page);
    void SetPageShown(std::int32_t page, bool show);
    // Opens the panel page (1, 3 or 4) when none is open, else closes it.
    void TogglePanel(std::int32_t page);
    // Draws the first button with this control id.
    void DrawButton(HDC dc, std::uint32_t id, std::uint32_t itemState);
    void DestroyAllButtons();

    // Everything a button (or the start-up failure path) asks for.
    void OnCommand(std::uint32_t id);

    // Keyboard use: Tab, Shift+Tab and the arrows move the focus among the visible buttons,
    // Enter presses the focused one (Space is the button's own), Escape closes an open panel.
    // True when the key was the menu's; `focus` is the window that has the keyboard focus.
    bool HandleKey(std::uint32_t virtualKey, bool shift, HWND focus);

    LauncherButton* ButtonForWindow(HWND window) const;

    std::array<std::vector<LauncherButton*>, kPageCount> pages;
    // Every button ever created, in creation order; owns them.
    std::vector<std::unique_ptr<LauncherButton>> allButtons;
    std::map<std::uintptr_t, LauncherButton*> buttonsByWindow;
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
    // Adds a new button to its page, to allButtons and to buttonsByWindow; the position it got
    // in its page.
    std::int32_t Register(std::int32_t page, std::unique_ptr<LauncherButton> button);
    LauncherButton* MainPageButton(std::int32_t index) const;
    void ShowInstallOrPlay();
    // Running out of memory while a screen is built keeps the buttons built so far.
    void BuildSafely(void (MenuController::*build)(HWND), HWND parent);

    void MoveKeyboardFocus(int step, HWND focus);

    // The command actions.
    void ChooseLanguage(std::uint32_t id);
    void CloseOpenPanel();
    void SwitchToPanel(std::int32_t page);
    void StartInstaller();
    void OpenWebSite();
    void StartGame(std::uint32_t id);
    void OpenReadme();
    void OpenSupport();
    void PlayDemo(std::uint32_t id);
    void Reinstall();
};

#endif
