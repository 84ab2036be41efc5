#pragma once

#include "canvas.h"
#include "text.h"

namespace discart {

// The About box's picture (400 x 488): emblem, name, version, credits and copyright.
Canvas PaintAboutPicture(const FontLibrary& fonts);

}  // namespace discart
