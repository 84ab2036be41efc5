#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "canvas.h"
#include "geometry.h"
#include "text.h"

namespace discart {

// The one light of the world: a low sun over a sea of clouds.
struct SkyLight {
    Vec2 sun;
    float horizon = 330.0f;  // top of the cloud sea
    float height = 480.0f;   // of the picture the sky fills
};

struct CloudBankLayout {
    float x0 = 0.0f;
    float x1 = 0.0f;
    float base = 0.0f;  // y of the flat underside
    float minRadius = 10.0f;
    float maxRadius = 20.0f;
    float haze = 0.0f;  // 0 near, 1 lost in the sky
    bool flatBottom = true;
    uint32_t seed = 1;
};

struct IslandLayout {
    Vec2 top;  // centre of the grass top
    float halfWidth = 50.0f;
    float depth = 70.0f;
    float haze = 0.0f;
    bool tower = false;
    bool waterfall = false;
    int trees = 0;
    uint32_t seed = 1;
};

Rgb SkyColor(const SkyLight& light, float x, float y);
void PaintSky(Canvas& canvas, const SkyLight& light);
void PaintStars(Canvas& canvas, Box area, int count, uint32_t seed);
void PaintSun(Canvas& canvas, const SkyLight& light, float radius);
void PaintCirrus(Canvas& canvas, const SkyLight& light, Box area, uint32_t seed);
void PaintCloudBank(Canvas& canvas, const SkyLight& light, const CloudBankLayout& layout);
// Rows of clouds from the horizon down to the bottom edge; rows from firstRow on only.
void PaintCloudSea(Canvas& canvas, const SkyLight& light, int firstRow, int lastRow, uint32_t seed);
void PaintIsland(Canvas& canvas, const SkyLight& light, const IslandLayout& layout);
void PaintBirds(Canvas& canvas, Vec2 at, float scale, uint32_t seed);

// The product's word mark: "The Vemo" over "Vodizuri Virezazida"; at is the top-left corner.
void PaintLogo(Canvas& canvas, const FontLibrary& fonts, Vec2 at, float scale);

// Base of every language's main-menu background.
Canvas PaintMainScene(const FontLibrary& fonts);
// Background of the language list.
Canvas PaintLanguageListScene(const FontLibrary& fonts);

struct BackgroundLanguage {
    const char* fileName;
    Face face;
    const char* greeting;  // UTF-8
};

const std::vector<BackgroundLanguage>& BackgroundLanguages();

// Every rectangle of the main window that must look the same in every language: buttons,
// panels with their plates, and the caption areas.
const std::vector<Box>& LanguageNeutralBoxes();

// The base scene with the language's greeting; nothing is drawn inside the neutral boxes.
Canvas PaintLanguageBackground(const Canvas& base, const FontLibrary& fonts,
                               const BackgroundLanguage& language);

}  // namespace discart
