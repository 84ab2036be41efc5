// The one compositing step of the launcher: picture A over picture B through an 8-bit mask,
// written into picture D. Buttons and panels composite themselves into the working background
// with it, in place (D and B the same picture at the same origin).
#ifndef AUTOPLAY_GRAPHICS_MASKED_BLEND_H
#define AUTOPLAY_GRAPHICS_MASKED_BLEND_H

#include <cstdint>

#include "graphics/dib.h"

// Origins are top-left corners counted from the top of each picture.
struct DibPoint {
    std::int32_t x;
    std::int32_t y;
};

struct DibSize {
    std::int32_t width;
    std::int32_t height;
};

// For each pixel of the rectangle, with m the mask byte: m = 0 gives B, m = 255 gives A, and
// any other value gives (A × m + B × (255 − m)) >> 8 for each byte of the pixel.
// Does nothing when a picture is null or not consistent, when A, B and D differ in depth, when
// the mask is not 8-bit or when the depth is neither 8 nor 24 bits. Rows and columns are taken
// from the origin on only while they lie inside all four pictures, so nothing outside a picture
// is ever read or written; a negative origin therefore blends nothing.
void MaskedBlend(const DibBitmap* a, DibPoint pa, const DibBitmap* b, DibPoint pb,
                 const DibBitmap* mask, DibPoint pm, DibBitmap* d, DibPoint pd, DibSize size);

// Puts A back into D wherever the mask is not 0, whole pixels, clipped like MaskedBlend. A face
// that is taken away this way leaves nothing of itself behind, not even in its soft edge, where
// blending the background back in would keep part of the old face.
void MaskedRestore(const DibBitmap* a, DibPoint pa, const DibBitmap* mask, DibPoint pm,
                   DibBitmap* d, DibPoint pd, DibSize size);

#endif
