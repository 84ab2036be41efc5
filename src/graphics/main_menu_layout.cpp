#include "graphics/main_menu_layout.h"

std::optional<PanelPlacement> PanelPlacementFor(std::uint32_t openPanel) {
    switch (openPanel) {
        case 0:
            return PanelPlacement{271, 55, 240, 149};
        case 1:
            return PanelPlacement{403, 67, 237, 256};
        case 2:
            return PanelPlacement{403, 54, 237, 252};
        default:
            return std::nullopt;
    }
}

bool ReadmeReplacesMoreInformation(std::uint32_t productSku, LanguageBase base) {
    return productSku > 3 && !(productSku == 4 && base == kPolish);
}

std::vector<CaptionPlacement> MainMenuCaptions(bool installed, std::uint32_t discSku,
                                               std::uint32_t productSku, LanguageBase base) {
    constexpr std::uint32_t kInstall = 1, kPlay = 2, kMoreGames = 3, kWebSite = 7,
                            kMoreInformation = 8, kExit = 10, kReadme = 12;
    std::vector<CaptionPlacement> captions;
    captions.push_back({installed ? kPlay : kInstall, 187, 237});
    captions.push_back({kWebSite, 262, 278});
    if (discSku != 2) captions.push_back({kMoreGames, 329, 332});
    captions.push_back(
        {ReadmeReplacesMoreInformation(productSku, base) ? kReadme : kMoreInformation, 370, 391});
    captions.push_back({kExit, 398, 443});
    return captions;
}
