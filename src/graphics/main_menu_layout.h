// Where the main menu's panels and captions go, and which captions it shows.
#ifndef AUTOPLAY_GRAPHICS_MAIN_MENU_LAYOUT_H
#define AUTOPLAY_GRAPHICS_MAIN_MENU_LAYOUT_H

#include <cstdint>
#include <optional>
#include <vector>

#include "locale/language_table.h"

struct PanelPlacement {
    std::int32_t x;
    std::int32_t y;
    std::int32_t width;
    std::int32_t height;
};

// The backdrop's place for an open panel (0 play, 1 information, 2 games); nothing otherwise.
std::optional<PanelPlacement> PanelPlacementFor(std::uint32_t openPanel);

struct CaptionPlacement {
    std::uint32_t stringOffset;
    std::int32_t right;   // the caption's bottom-right corner, in window pixels
    std::int32_t bottom;
};

// Editions above 3 put the Readme button where More Information is, except the Polish
// edition 4.
bool ReadmeReplacesMoreInformation(std::uint32_t productSku, LanguageBase base);

// The captions beside the main menu's buttons, in drawing order.
std::vector<CaptionPlacement> MainMenuCaptions(bool installed, std::uint32_t discSku,
                                               std::uint32_t productSku, LanguageBase base);

#endif
