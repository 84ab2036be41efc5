// What the launcher's screens consist of: the language list of each disc edition, the main
// page's circular buttons and the plate buttons of its three fold-out panels, with their
// command ids, pictures, labels, places and hit circles. Platform-neutral: the screens are
// built from these tables, and the disc check reads the edition lists from here too.
#ifndef AUTOPLAY_MENU_SCREEN_LAYOUT_H
#define AUTOPLAY_MENU_SCREEN_LAYOUT_H

#include <cstdint>
#include <optional>
#include <vector>

#include "locale/language_table.h"

// The controller's five pages; the number indexes its page lists.
enum MenuPage : std::int32_t {
    MainPage = 0,
    InfoPanel = 1,
    LanguagePage = 2,
    GamesPanel = 3,
    PlayPanel = 4,
};
constexpr std::int32_t kPageCount = 5;

// LauncherState.openPanel for each panel page, and the value for none.
constexpr std::uint32_t kNoPanel = 3;
std::uint32_t OpenPanelValueFor(std::int32_t page);

// A button window's rectangle in the main window's client area.
struct ButtonPlace {
    std::int32_t x;
    std::int32_t y;
    std::int32_t width;
    std::int32_t height;
};

// A circular button's hit circle, in the button's own client coordinates.
struct HitCircle {
    std::int32_t centerX;
    std::int32_t centerY;
    std::int32_t radius;
};

struct CircleButtonLayout {
    std::int32_t imageIndex;
    std::uint32_t id;
    std::uint32_t labelOffset;
    ButtonPlace place;
    HitCircle circle;
};

// The language list. Each language button is a plate labelled with its language's own name
// (offset 73 of that language's strings) in that language's font; its plate picture is
// 11 + its position in the list, because each plate carries the background of its place.
struct LanguageButtonLayout {
    std::uint32_t id;
    LanguageBase base;
    std::int32_t x;
    std::int32_t y;
};
constexpr std::int32_t kFirstListPlate = 11;
constexpr std::int32_t kListPlateWidth = 212;
constexpr std::int32_t kListPlateHeight = 50;
constexpr std::uint32_t kLanguageNameOffset = 73;

struct LanguageListLayout {
    std::vector<LanguageButtonLayout> buttons;   // in creation order
    std::optional<std::uint32_t> productSku;     // the product edition the list stands for
    LanguageBase settledLanguage = kNoLanguage;  // editions without a list settle it at once
};
LanguageListLayout LanguageListFor(std::uint32_t discSku);

// The language a language command settles; none for the ids that name no language.
std::optional<LanguageBase> LanguageOfCommand(std::uint32_t id);

// The list's own About button: never shown, there only to share the About id.
extern const CircleButtonLayout kListAboutButton;

// The main page, in creation order.
enum class MainButtonRole { About, Install, Play, MoreGames, WebSite, InfoPlace, Exit };
struct MainButtonLayout {
    MainButtonRole role;
    CircleButtonLayout button;
};
std::vector<MainButtonLayout> MainPageButtons(std::uint32_t discSku, std::uint32_t productSku,
                                              LanguageBase base);
// The Play button's picture: a few languages have a picture of their own.
std::int32_t PlayImageIndexFor(LanguageBase base);

// Panel plates: each (page, slot) has its picture and place; all are 209 × 49.
constexpr std::int32_t kPanelPlateWidth = 209;
constexpr std::int32_t kPanelPlateHeight = 49;
struct PanelSlotLayout {
    std::int32_t imageIndex;
    std::int32_t x;
    std::int32_t y;
};
std::optional<PanelSlotLayout> PanelSlotFor(std::int32_t page, std::int32_t slot);

struct PanelButtonLayout {
    std::int32_t page;
    std::int32_t slot;
    std::uint32_t id;
    std::uint32_t labelOffset;
};
std::vector<PanelButtonLayout> InfoPanelButtons();
std::vector<PanelButtonLayout> GamesPanelButtons();
std::vector<PanelButtonLayout> PlayPanelButtons();

#endif
