// The two screens: the disc edition's language list, and the main menu with its three
// fold-out panels. Every button is created hidden; the controller shows the pages.
#include "locale/config_win.h"
#include "locale/picture_ids.h"
#include "menu/menu_controller.h"
#include "shell/launcher_state.h"

void MenuController::BuildLanguageList(HWND parent) {
    if (launcher.languageKnown) return;
    launcher.languageBase = kNoLanguage;
    const LanguageListSpec list = LanguageListFor(launcher.discSku);
    if (list.productSku) launcher.productSku = *list.productSku;
    std::int32_t position = 0;
    for (const LanguageButtonSpec& spec : list.buttons) {
        // Each language's name, in its own script and font.
        auto button = std::make_unique<LauncherButton>(
            parent, kFirstListPlate + position, spec.id, kLanguageNameOffset, spec.x, spec.y,
            kListPlateWidth, kListPlateHeight, false, spec.base);
        button->SetWanted(true);
        Register(LanguagePage, std::move(button));
        ++position;
    }
    if (list.settledLanguage != kNoLanguage) {
        launcher.languageBase = list.settledLanguage;
        launcher.languageKnown = true;
    }
    // The list's own About button is never shown; it shares the About id with the main menu's.
    const CircleButtonSpec& about = kListAboutButton;
    auto button = std::make_unique<VemoLauncherButton>(
        parent, about.imageIndex, about.id, about.labelOffset, about.place.x, about.place.y,
        about.place.width, about.place.height, false, kActiveLanguage);
    button->SetCircle(about.circle.centerX, about.circle.centerY, about.circle.radius);
    button->SetWanted(false);
    Register(LanguagePage, std::move(button));
}

void MenuController::BuildMainMenu(HWND parent) {
    for (const MainButtonSpec& spec :
         MainPageButtons(launcher.discSku, launcher.productSku, launcher.languageBase)) {
        const CircleButtonSpec& b = spec.button;
        auto button = std::make_unique<VemoLauncherButton>(
            parent, b.imageIndex, b.id, b.labelOffset, b.place.x, b.place.y, b.place.width,
            b.place.height, false, kActiveLanguage);
        button->SetCircle(b.circle.centerX, b.circle.centerY, b.circle.radius);
        // Install and Play share one place: only one of them is ever wanted.
        if (spec.role == MainButtonRole::Install && installed) button->SetWanted(false);
        if (spec.role == MainButtonRole::Play && !installed) button->SetWanted(false);
        const std::int32_t position = Register(MainPage, std::move(button));
        switch (spec.role) {
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
    for (const PanelButtonSpec& spec : InfoPanelButtons()) {
        AddPanelButton(parent, spec.page, spec.slot, spec.id, spec.labelOffset);
    }
    WriteLocale();
    if (launcher.discSku != 2) BuildGamesPanel(parent);
    BuildPlayPanel(parent);
}

void MenuController::AddPanelButton(HWND parent, std::int32_t page, std::int32_t slot,
                                    std::uint32_t id, std::uint32_t labelOffset) {
    const std::optional<PanelSlotSpec> place = PanelSlotFor(page, slot);
    if (!place) return;
    Register(page, std::make_unique<LauncherButton>(parent, place->imageIndex, id, labelOffset,
                                                    place->x, place->y, kPanelPlateWidth,
                                                    kPanelPlateHeight, false, kActiveLanguage));
}

void MenuController::BuildGamesPanel(HWND parent) {
    for (const PanelButtonSpec& spec : GamesPanelButtons()) {
        AddPanelButton(parent, spec.page, spec.slot, spec.id, spec.labelOffset);
    }
}

void MenuController::BuildPlayPanel(HWND parent) {
    for (const PanelButtonSpec& spec : PlayPanelButtons()) {
        AddPanelButton(parent, spec.page, spec.slot, spec.id, spec.labelOffset);
    }
}
