// The launcher used from the keyboard. Nothing here changes what the mouse does: the keys
// move the same focus the mouse hook moves (the focused face is the hover face), and Enter
// sends the same click a mouse would.
#include <vector>

#include "menu/button_rules.h"
#include "menu/menu_controller.h"

namespace {

bool IsPanelPage(std::int32_t page) {
    return page == InfoPanel || page == GamesPanel || page == PlayPanel;
}

}  // namespace

bool MenuController::HandleKey(std::uint32_t virtualKey, bool shift, HWND focus) {
    switch (virtualKey) {
        case VK_TAB:
            MoveKeyboardFocus(shift ? -1 : 1, focus);
            return true;
        case VK_RIGHT:
        case VK_DOWN:
            MoveKeyboardFocus(1, focus);
            return true;
        case VK_LEFT:
        case VK_UP:
            MoveKeyboardFocus(-1, focus);
            return true;
        case VK_RETURN: {
            LauncherButton* button = ButtonForWindow(focus);
            if (!button || !button->visible) return false;
            // A click as the mouse makes it: pressed look, then the button's own WM_COMMAND.
            SendMessageW(button->window, BM_CLICK, 0, 0);
            return true;
        }
        case VK_ESCAPE:
            // Closes an open panel and never ends the launcher.
            if (panelOpen) {
                const std::int32_t page = lastPanel;
                CloseOpenPanel();
                std::int32_t opener = page == GamesPanel  ? gamesIndex
                                      : page == InfoPanel ? infoIndex
                                                          : playIndex;
                if (LauncherButton* button = MainPageButton(opener); button && button->visible) {
                    SetFocus(button->window);
                }
            }
            return true;
        default:
            return false;
    }
}

void MenuController::MoveKeyboardFocus(int step, HWND focus) {
    std::vector<LauncherButton*> buttons;
    std::vector<KeyboardStop> stops;
    for (std::int32_t page = 0; page < kPageCount; ++page) {
        for (LauncherButton* button : pages[static_cast<std::size_t>(page)]) {
            if (!button->visible || !button->window) continue;
            buttons.push_back(button);
            stops.push_back({IsPanelPage(page), button->x, button->y});
        }
    }
    if (buttons.empty()) return;
    const std::vector<std::size_t> order = KeyboardOrder(stops);
    std::size_t current = order.size();
    for (std::size_t i = 0; i < order.size(); ++i) {
        if (buttons[order[i]]->window == focus) current = i;
    }
    SetFocus(buttons[order[StepInOrder(order.size(), current, step)]]->window);
}
