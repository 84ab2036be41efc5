#include "menu/button_rules.h"

#include <cmath>

ButtonState StateForItem(std::uint32_t itemState, bool latched) {
    if (latched) return kLatched;
    if (itemState & kItemSelected) return kPressed;
    if (itemState & kItemFocused) return kFocused;
    return kNormal;
}

bool InsideHitCircle(const HitCircle& circle, std::int32_t x, std::int32_t y) {
    // Squares in 64 bits: a point far off the screen must not overflow into a hit.
    const std::int64_t dx = static_cast<std::int64_t>(circle.centerX) - x;
    const std::int64_t dy = static_cast<std::int64_t>(circle.centerY) - y;
    const double distance = std::sqrt(static_cast<double>(dx * dx + dy * dy));
    return circle.radius > distance;
}
