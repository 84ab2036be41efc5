#include "menu/menu_controller.h"

#include "shell/launcher_state.h"

MenuController::~MenuController() { DestroyAllButtons(); }

void MenuController::StartMainMenu(HWND /*parent*/) {
    Refresh();
    if (!launcher.languageKnown) return;
    mainMenuBuilt = true;
}

void MenuController::StartLanguageList(HWND /*parent*/) {
    Refresh();
}

void MenuController::Refresh() {
    CheckInstallation();
    installPath.clear();
}

void MenuController::ShowInstallOrPlay() {
    // The Install and Play buttons come with the main menu's buttons; until they exist
    // there is nothing on screen to switch.
}

void MenuController::TogglePanel(std::int32_t page) {
    if (panelOpen) {
        launcher.openPanel = kNoPanel;
    } else {
        launcher.openPanel = page == GamesPanel ? 2 : page == InfoPanel ? 1 : 0;
    }
    panelOpen = !panelOpen;
    if (launcher.mainWindow) InvalidateRect(launcher.mainWindow, nullptr, FALSE);
    lastPanel = page;
}

void MenuController::DestroyAllButtons() { installPath.clear(); }
