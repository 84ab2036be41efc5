// The rules a picture button follows that need no window: which face a draw request shows,
// and whether a point lies on a circular button.
#ifndef AUTOPLAY_MENU_BUTTON_RULES_H
#define AUTOPLAY_MENU_BUTTON_RULES_H

#include <cstddef>
#include <cstdint>
#include <vector>

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

// A button the keyboard can reach: whether it belongs to a fold-out panel, and its place.
struct KeyboardStop {
    bool inPanel;
    std::int32_t x;
    std::int32_t y;
};

// The order Tab walks the stops in (indexes into `stops`): the screen's buttons first, then the
// open panel's; within each, as the eye reads them, top to bottom, then left to right.
std::vector<std::size_t> KeyboardOrder(const std::vector<KeyboardStop>& stops);

// The stop `step` places after `current` in that order, wrapping around (`current` past the
// end: no stop has the focus, and stepping forward starts at the first, backward at the last).
std::size_t StepInOrder(std::size_t count, std::size_t current, int step);

#endif
