#pragma once

#include <array>
#include <vector>

#include "formats.h"

namespace discart {

// The launcher's 256-colour palette: the fixed entries it is known by, the usual static colours
// where the display puts its own anyway, and a median-cut set of the pictures' colours in the
// entries 10 to 245 that reach the screen.
std::array<Rgb8, 256> BuildPalette(const std::vector<const Picture*>& pictures);

}  // namespace discart
