// The two screens: the disc edition's language list, and the main menu with its three
// fold-out panels. Every button is created hidden; the controller shows the pages.
#include "locale/config_win.h"
#include "locale/picture_ids.h"
#include "menu/menu_controller.h"
#include "shell/launcher_state.h"

void MenuController::BuildLanguageList(HWND parent) {
    if (launcher.languageKnown) return;
    launcher.languageBase = kNoLanguage;
    const LanguageListLayout list = LanguageListFor(launcher.discSku);
    if (list.productSku) launcher.productSku = *list.productSku;
    std::int32_t position = 0;
    for (const LanguageButtonLayout& item : list.buttons) {
        // Each language's name, in its own script and font.
        auto button = std::make_unique<LauncherButton>(
            parent, kFirstListPlate + position, item.id, kLanguageNameOffset, item.x, item.y,
            kListPlateWidth, kListPlateHeight, false, item.base);
        button->SetWanted(true);
        Register(LanguagePage, std::move(button));
        ++position;
    }
    if (list.settledLanguage != kNoLanguage) {
        launcher.languageBase = list.settledLanguage;
        launcher.languageKnown = true;
    }
    // The list's own About button is never shown; it shares the About id with the main menu's.
    const CircleButtonLayout& about = kListAboutButton;
    auto button = std::make_unique<VemoLauncherButton>(
        parent, about.imageIndex, about.id, about.labelOffset, about.place.x, about.place.y,
        about.place.width, about.place.height, false, kActiveLanguage);
    button->SetCircle(about.circle.centerX, about.circle.centerY, about.circle.radius);
    button->SetWanted(false);
    Register(LanguagePage, std::move(button));
}

void MenuController::BuildMainMenu(HWND parent) {
    for (const MainButtonLayout& item :
         MainPageButtons(launcher.discSku, launcher.productSku, launcher.languageBase)) {
        const CircleButtonLayout& b = item.button;
        auto button = std::make_unique<VemoLauncherButton>(
            parent, b.imageIndex, b.id, b.labelOffset, b.place.x, b.place.y, b.place.width,
            b.place.height, false, kActiveLanguage);
        button->SetCircle(b.circle.centerX, b.circle.centerY, b.circle.radius);
        // Install and Play share one place: only one of them is ever wanted.
        if (item.role == MainButtonRole::Install && installed) button->SetWanted(false);
        if (item.role == MainButtonRole::Play && !installed) button->SetWanted(false);
        const std::int32_t position = Register(MainPage, std::move(button));
        switch (item.role) {
            case MainButtonRole::Install:
                installIndex = position;
                break;
            case MainButtonRole::Play:
                playIndex = position;
                break;
            case MainButtonRole::MoreGames:
                gamesIndex = position;
                break;
            case MainButtonRole::InfoPlace:
                infoIndex = position;
                break;
            default:
                break;
        }
    }
    // Built in every case, also when the Readme button took the More Information place.
    for (const PanelButtonLayout& item : InfoPanelButtons()) {
        AddPanelButton(parent, item.page, item.slot, item.id, item.labelOffset);
    }
    WriteLocale();
    if (launcher.discSku != 2) BuildGamesPanel(parent);
    BuildPlayPanel(parent);
}

void MenuController::AddPanelButton(HWND parent, std::int32_t page, std::int32_t slot,
                                    std::uint32_t id, std::uint32_t labelOffset) {
    const std::optional<PanelSlotLayout> place = PanelSlotFor(page, slot);
    if (!place) return;
    Register(page, std::make_unique<LauncherButton>(parent, place->imageIndex, id, labelOffset,
                                                    place->x, place->y, kPanelPlateWidth,
                                                    kPanelPlateHeight, false, kActiveLanguage));
}

void MenuController::BuildGamesPanel(HWND parent) {
    for (const PanelButtonLayout& item : GamesPanelButtons()) {
        AddPanelButton(parent, item.page, item.slot, item.id, item.labelOffset);
    }
}

void MenuController::BuildPlayPanel(HWND parent) {
    for (const PanelButtonLayout& item : PlayPanelButtons()) {
        AddPanelButton(parent, item.page, item.slot, item.id, item.labelOffset);
    }
}
