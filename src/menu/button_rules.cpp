#include "menu/button_rules.h"

#include <algorithm>
#include <cmath>
#include <numeric>
#include <tuple>

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

std::vector<std::size_t> KeyboardOrder(const std::vector<KeyboardStop>& stops) {
    std::vector<std::size_t> order(stops.size());
    std::iota(order.begin(), order.end(), std::size_t{0});
    std::stable_sort(order.begin(), order.end(), [&stops](std::size_t a, std::size_t b) {
        return std::make_tuple(stops[a].inPanel, stops[a].y, stops[a].x) <
               std::make_tuple(stops[b].inPanel, stops[b].y, stops[b].x);
    });
    return order;
}

std::size_t StepInOrder(std::size_t count, std::size_t current, int step) {
    if (count == 0) return 0;
    if (current >= count) return step > 0 ? 0 : count - 1;
    const auto n = static_cast<long long>(count);
    const long long next = (static_cast<long long>(current) + step) % n;
    return static_cast<std::size_t>(next < 0 ? next + n : next);
}
