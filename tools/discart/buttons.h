#pragma once

#include "canvas.h"
#include "geometry.h"
#include "symbols.h"

namespace discart {

enum class FaceState { Normal = 0, Pressed = 1, Focused = 2, Latched = 3 };

// A language's touch on the Play button: a sash in its flag's colours.
enum class Sash { None, German, Japanese, French, Spanish };

struct OrbDesign {
    int width = 0;
    int height = 0;
    Vec2 centre;
    float radius = 0.0f;
    Rgb accent;
    Symbol symbol = nullptr;
    Sash sash = Sash::None;
};

// A circular button face on a transparent layer: its alpha is the button's mask.
Canvas PaintOrb(const OrbDesign& design, FaceState state);

// Fades whatever reaches the layer's edge, so that no soft shadow or glow ends in a hard cut.
void FadeEdges(Canvas& layer, float width);

}  // namespace discart
