#include "menu/screen_layout.h"

#include "actions/command_ids.h"
#include "graphics/main_menu_layout.h"
#include "locale/picture_ids.h"
#include "locale/string_offsets.h"

namespace {

constexpr ButtonPlace kAboutPlace{9, 346, 162, 117};
constexpr HitCircle kAboutCircle{74, 54, 60};
constexpr ButtonPlace kInstallPlace{186, 162, 85, 96};
constexpr HitCircle kInstallCircle{40, 50, 35};

struct CommandLanguage {
    std::uint32_t id;
    LanguageBase base;
};

// 507 and 516 name no language; 517 (Japanese) is carried by no list.
constexpr CommandLanguage kCommandLanguages[] = {
    {500, kUsEnglish},  {501, kFrench},   {502, kGerman},     {503, kSwedish},
    {504, kDutch},      {505, kPortuguese}, {506, kSpanish},  {508, kPolish},
    {509, kTraditionalChinese}, {510, kSimplifiedChinese}, {511, kThai}, {512, kItalian},
    {513, kDanish},     {514, kNorwegian}, {515, kFinnish},   {517, kJapanese},
    {518, kKorean},     {519, kUkEnglish},
};

LanguageButtonLayout ListButton(std::uint32_t id, std::int32_t x, std::int32_t y) {
    return {id, *LanguageOfCommand(id), x, y};
}

}  // namespace

const CircleButtonLayout kListAboutButton{kListAboutIconKey, kCmdAbout, kStrCreator,
                                        kAboutPlace, kAboutCircle};

std::uint32_t OpenPanelValueFor(std::int32_t page) {
    switch (page) {
        case PlayPanel:
            return 0;
        case InfoPanel:
            return 1;
        case GamesPanel:
            return 2;
        default:
            return kNoPanel;
    }
}

std::optional<LanguageBase> LanguageOfCommand(std::uint32_t id) {
    for (const CommandLanguage& entry : kCommandLanguages) {
        if (entry.id == id) return entry.base;
    }
    return std::nullopt;
}

LanguageListLayout LanguageListFor(std::uint32_t discSku) {
    LanguageListLayout list;
    switch (discSku) {
        case 1:
            list.productSku = 1;
            list.buttons = {ListButton(500, 84, 151), ListButton(506, 84, 202)};
            break;
        case 2:
            list.productSku = 2;
            list.buttons = {ListButton(508, 84, 151),  ListButton(501, 84, 202),
                            ListButton(502, 84, 253),  ListButton(512, 84, 304),
                            ListButton(503, 300, 151), ListButton(504, 300, 202),
                            ListButton(506, 300, 253), ListButton(505, 300, 304),
                            ListButton(519, 300, 355), ListButton(514, 84, 355),
                            ListButton(515, 84, 100),  ListButton(513, 300, 100)};
            break;
        case 3:
            list.productSku = 8;
            list.buttons = {ListButton(509, 84, 151), ListButton(511, 84, 202),
                            ListButton(518, 84, 253), ListButton(500, 84, 304)};
            break;
        case 4:
            list.productSku = 9;
            list.buttons = {ListButton(510, 84, 151), ListButton(500, 84, 202)};
            break;
        case 5:
            list.productSku = 5;
            list.settledLanguage = kJapanese;
            break;
        case 6:
            list.productSku = 1;
            list.buttons = {ListButton(514, 84, 151), ListButton(515, 84, 202),
                            ListButton(513, 84, 253), ListButton(519, 84, 304)};
            break;
        default:
            list.settledLanguage = kUsEnglish;
            break;
    }
    return list;
}

std::int32_t PlayImageIndexFor(LanguageBase base) {
    switch (base) {
        case kFrench:
            return 4;
        case kGerman:
            return 2;
        case kSpanish:
            return 5;
        case kJapanese:
            return 3;
        default:
            return 1;
    }
}

std::vector<MainButtonLayout> MainPageButtons(std::uint32_t discSku, std::uint32_t productSku,
                                            LanguageBase base) {
    std::vector<MainButtonLayout> buttons;
    // The About button carries the Install label.
    buttons.push_back({MainButtonRole::About, {11, kCmdAbout, kStrInstall, kAboutPlace, kAboutCircle}});
    buttons.push_back(
        {MainButtonRole::Install, {0, kCmdInstall, kStrInstall, kInstallPlace, kInstallCircle}});
    buttons.push_back({MainButtonRole::Play,
                       {PlayImageIndexFor(base), kCmdPlayPanel, kStrPlay, kInstallPlace,
                        kInstallCircle}});
    if (discSku != 2) {
        buttons.push_back({MainButtonRole::MoreGames,
                           {7, kCmdGamesPanel, kStrMoreGames, {330, 268, 73, 79}, {33, 42, 29}}});
    }
    buttons.push_back({MainButtonRole::WebSite,
                       {6, kCmdWebSite, kStrVisitWebSite, {272, 225, 66, 67}, {29, 31, 31}}});
    const bool readme = ReadmeReplacesMoreInformation(productSku, base);
    buttons.push_back({MainButtonRole::InfoPlace,
                       {9, readme ? kCmdReadme : kCmdInfoPanel,
                        readme ? kStrReadme : kStrMoreInformation, {372, 323, 73, 87},
                        {37, 48, 26}}});
    buttons.push_back(
        {MainButtonRole::Exit, {10, kCmdExit, kStrExit, {405, 411, 54, 54}, {26, 25, 23}}});
    return buttons;
}

std::optional<PanelSlotLayout> PanelSlotFor(std::int32_t page, std::int32_t slot) {
    // Slot 3 of the information and games panels has a picture but no button.
    static constexpr PanelSlotLayout kInfo[] = {{4, 416, 28}, {5, 416, 81}, {6, 416, 133}, {7, 416, 185}};
    static constexpr PanelSlotLayout kGames[] = {{0, 416, 29}, {1, 416, 81}, {2, 416, 133}, {3, 416, 185}};
    static constexpr PanelSlotLayout kPlay[] = {{9, 295, 19}, {8, 295, 71}, {10, 295, 123}};
    if (slot < 0) return std::nullopt;
    switch (page) {
        case InfoPanel:
            if (slot < 4) return kInfo[slot];
            break;
        case GamesPanel:
            if (slot < 4) return kGames[slot];
            break;
        case PlayPanel:
            if (slot < 3) return kPlay[slot];
            break;
        default:
            break;
    }
    return std::nullopt;
}

std::vector<PanelButtonLayout> InfoPanelButtons() {
    return {{InfoPanel, 0, kCmdRegistration, kStrRegistration},
            {InfoPanel, 1, kCmdSupport, kStrSupportTool},
            {InfoPanel, 2, kCmdReadme, kStrReadme}};
}

std::vector<PanelButtonLayout> GamesPanelButtons() {
    return {{GamesPanel, 0, kCmdDemoPc, kStrDemoPc},
            {GamesPanel, 1, kCmdDemoDuskaro, kStrDemoDuskaro},
            {GamesPanel, 2, kCmdDemoLorrel, kStrDemoLorrel}};
}

std::vector<PanelButtonLayout> PlayPanelButtons() {
    std::vector<PanelButtonLayout> buttons;
    for (std::int32_t slot = 0; slot < 3; ++slot) {
        buttons.push_back({PlayPanel, slot, kCmdPlay + static_cast<std::uint32_t>(slot),
                           kStrPlay800 + static_cast<std::uint32_t>(slot)});
    }
    return buttons;
}
