#include <new>

#include "menu/menu_controller.h"
#include "shell/launcher_state.h"

MenuController::~MenuController() {
    DestroyAllButtons();
}

void MenuController::BuildSafely(void (MenuController::*build)(HWND), HWND parent) {
    try {
        (this->*build)(parent);
    } catch (const std::bad_alloc&) {
        // Every button registered so far is whole and owned; the rest of the screen is missing.
    }
}

void MenuController::StartMainMenu(HWND parent) {
    Refresh();
    if (!launcher.languageKnown) return;
    BuildSafely(&MenuController::BuildMainMenu, parent);
    ShowPage(MainPage);
    mainMenuBuilt = true;
}

void MenuController::StartLanguageList(HWND parent) {
    Refresh();
    if (!launcher.languageKnown) {
        BuildSafely(&MenuController::BuildLanguageList, parent);
        ShowPage(LanguagePage);
    }
    // Some editions settle the language without offering a list.
    if (launcher.languageKnown) {
        BuildSafely(&MenuController::BuildMainMenu, parent);
        ShowPage(MainPage);
        mainMenuBuilt = true;
    }
}

std::int32_t MenuController::Register(std::int32_t page, std::unique_ptr<LauncherButton> button) {
    std::vector<LauncherButton*>& list = pages[static_cast<std::size_t>(page)];
    // Room first: if memory runs out, no list has changed and the button is destroyed.
    if (list.size() == list.capacity()) list.reserve(list.size() * 2 + 4);
    if (allButtons.size() == allButtons.capacity()) allButtons.reserve(allButtons.size() * 2 + 8);
    LauncherButton* raw = button.get();
    buttonsByWindow.insert_or_assign(reinterpret_cast<std::uintptr_t>(raw->window), raw);
    list.push_back(raw);
    allButtons.push_back(std::move(button));
    return static_cast<std::int32_t>(list.size() - 1);
}

LauncherButton* MenuController::MainPageButton(std::int32_t index) const {
    const std::vector<LauncherButton*>& list = pages[MainPage];
    if (index < 0 || static_cast<std::size_t>(index) >= list.size()) return nullptr;
    return list[static_cast<std::size_t>(index)];
}

LauncherButton* MenuController::ButtonForWindow(HWND window) const {
    auto it = buttonsByWindow.find(reinterpret_cast<std::uintptr_t>(window));
    return it == buttonsByWindow.end() ? nullptr : it->second;
}

void MenuController::ShowInstallOrPlay() {
    bool changed = false;
    if (LauncherButton* install = MainPageButton(installIndex)) {
        changed |= install->SetWanted(!installed);
        install->Show(install->wanted);
    }
    if (LauncherButton* play = MainPageButton(playIndex)) {
        changed |= play->SetWanted(installed);
        play->Show(play->wanted);
    }
    // The play panel goes with its button: its commands need the game that has just gone.
    if (!installed && panelOpen && lastPanel == PlayPanel) TogglePanel(PlayPanel);
    // The caption beside the button is part of the window's picture: "Install" must not stay
    // written beside the Play button until something else repaints the window.
    if (changed && launcher.mainWindow) InvalidateRect(launcher.mainWindow, nullptr, FALSE);
}

void MenuController::Refresh() {
    CheckInstallation();
    // installPath stays as the check left it: a play command that arrives before the next
    // paint still needs the game's folder.
    if (!mainMenuBuilt) return;
    bool changed = false;
    if (LauncherButton* install = MainPageButton(installIndex))
        changed |= install->SetWanted(!installed);
    if (LauncherButton* play = MainPageButton(playIndex)) changed |= play->SetWanted(installed);
    if (changed) ShowPage(MainPage);
}

void MenuController::ShowPage(std::int32_t page) {
    if (page < 0 || page >= kPageCount) return;
    const bool panel = page == InfoPanel || page == GamesPanel || page == PlayPanel;
    if (panel && !panelOpen) return;
    for (LauncherButton* button : pages[static_cast<std::size_t>(page)])
        button->Show(button->wanted);
}

void MenuController::SetPageShown(std::int32_t page, bool show) {
    if (page < 0 || page >= kPageCount) return;
    for (LauncherButton* button : pages[static_cast<std::size_t>(page)]) {
        button->Show(show && button->wanted);
    }
}

void MenuController::TogglePanel(std::int32_t page) {
    std::int32_t openerIndex = -1;
    switch (page) {
        case GamesPanel:
            openerIndex = gamesIndex;
            break;
        case InfoPanel:
            openerIndex = infoIndex;
            break;
        case PlayPanel:
            openerIndex = playIndex;
            break;
        default:
            return;
    }
    LauncherButton* opener = MainPageButton(openerIndex);
    if (panelOpen) {
        if (opener) opener->latched = false;
        launcher.openPanel = kNoPanel;
    } else {
        if (opener) opener->latched = true;
        launcher.openPanel = OpenPanelValueFor(page);
    }
    panelOpen = !panelOpen;
    for (LauncherButton* button : pages[static_cast<std::size_t>(page)]) {
        if (!panelOpen) {
            button->Show(false);
        } else if (button->wanted) {
            button->Show(true);
        }
    }
    ShowPage(MainPage);
    // The backdrop is part of the window's picture: paint it in or out.
    if (launcher.mainWindow) InvalidateRect(launcher.mainWindow, nullptr, FALSE);
    lastPanel = page;
}

void MenuController::DrawButton(HDC dc, std::uint32_t id, std::uint32_t itemState) {
    for (const std::unique_ptr<LauncherButton>& button : allButtons) {
        if (button->id == id) {
            button->DrawItem(dc, itemState);
            return;
        }
    }
}

void MenuController::DestroyAllButtons() {
    // The lists forget each button before its window goes, so nothing that runs while windows
    // are destroyed (focus changes, redraws) can reach a button that is half gone.
    for (std::vector<LauncherButton*>& list : pages) list.clear();
    buttonsByWindow.clear();
    while (!allButtons.empty()) {
        std::unique_ptr<LauncherButton> last = std::move(allButtons.back());
        allButtons.pop_back();
        last.reset();
    }
    installPath.clear();
}
