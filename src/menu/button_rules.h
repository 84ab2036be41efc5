// The rules a picture button follows that need no window: which face a draw request shows,
// and whether a point lies on a circular button.
#ifndef AUTOPLAY_MENU_BUTTON_RULES_H
#define AUTOPLAY_MENU_BUTTON_RULES_H

#include <cstdint>

#include "menu/screen_layout.h"

enum ButtonState : std::int32_t {
    kNotDrawn = -1,
    kNormal = 0,
    kPressed = 1,
    kFocused = 2,  // the hover look: the mouse hook gives the button under the mouse the focus
    kLatched = 3,  // the button whose fold-out panel is open
};

// The owner-draw item state bits a button is drawn from (ODS_SELECTED, ODS_FOCUS).
constexpr std::uint32_t kItemSelected = 0x0001;
constexpr std::uint32_t kItemFocused = 0x0010;

// A latched button keeps its latched face whatever the mouse does; otherwise a pressed button
// wins over a focused one.
ButtonState StateForItem(std::uint32_t itemState, bool latched);

// Strictly inside: a point at exactly the radius is outside.
bool InsideHitCircle(const HitCircle& circle, std::int32_t x, std::int32_t y);

#endif
