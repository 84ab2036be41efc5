#pragma once

#include <vector>

#include "buttons.h"
#include "canvas.h"
#include "formats.h"
#include "text.h"

namespace discart {

// The product's emblem: a gold-rimmed sapphire medallion with the V of Vemo under a morning star.
// glow lights it from inside (the About button's hover look) without changing its outline.
// supersampling says how many canvas pixels make one pixel of the final picture.
void PaintMedallion(Canvas& canvas, Vec2 centre, float radius, float glow = 0.0f,
                    float brightness = 1.0f, float supersampling = 1.0f);

// A gold banner across the medallion with the product's name on it.
void PaintBanner(Canvas& canvas, const FontLibrary& fonts, Vec2 centre, float halfWidth,
                 float halfHeight, float textSize, float brightness = 1.0f);

// The About button's outline (162 x 117) without its shadow.
Mask AboutSilhouette(const FontLibrary& fonts);

// The About button (162 x 117): medallion and banner on a transparent layer.
Canvas PaintAboutButton(const FontLibrary& fonts, FaceState state);

// The program icon at the given size, straight alpha.
IconImage PaintIcon(int size);

}  // namespace discart
