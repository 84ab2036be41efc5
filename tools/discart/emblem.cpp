#include "emblem.h"

#include <algorithm>
#include <cmath>

namespace discart {

namespace {

constexpr Rgb kNavy = Hex(0x141A50);

// Centre and radius of the About button's medallion: its hit circle is centred at (74, 54).
constexpr Vec2 kAboutCentre = {74.0f, 51.0f};
constexpr float kAboutRadius = 47.0f;
constexpr Vec2 kBannerCentre = {74.0f, 88.0f};

}  // namespace

void PaintMedallion(Canvas& canvas, Vec2 c, float r, float glow, float brightness,
                    float supersampling) {
    const Box box = Grow({static_cast<int>(c.x), static_cast<int>(c.y), static_cast<int>(c.x),
                          static_cast<int>(c.y)},
                         static_cast<int>(r) + 3);
    const float finalRadius = r / supersampling;
    // Small icons drop the fine details and thicken the strokes.
    const float small = finalRadius < 12.0f ? 1.0f : 0.0f;
    FillSdf(
        canvas,
        [&](float x, float y) {
            return SdCircle({x, y}, c, r);
        },
        [&](float x, float y) {
            const Vec2 n = (Vec2{x, y} - c) * (1.0f / r);
            const float light = Clamp01(Dot(n, Vec2{-0.6f, -0.8f}) * 0.5f + 0.5f);
            const Rgb color = Mix(Hex(0x8C5A16), Hex(0xFFF0B4), light);
            return Tint{Lighten(color, glow * 0.3f) * brightness};
        },
        box);
    const float rim = std::max(1.2f * supersampling, r * (0.11f + 0.04f * small));
    const float body = r - rim;
    if (finalRadius >= 30.0f) {
        // Beads around the rim, as on a struck medal.
        for (int i = 0; i < 28; ++i) {
            const float angle = 2.0f * kPi * static_cast<float>(i) / 28.0f;
            const Vec2 bead = c + Vec2{std::cos(angle), std::sin(angle)} * (r - rim * 0.5f);
            FillSdf(
                canvas,
                [&](float x, float y) {
                    return SdCircle({x, y}, bead, rim * 0.22f);
                },
                Hex(0xFFF6D2) * brightness, box, 0.7f);
        }
    }
    const Vec2 hot = c + Vec2{-0.25f, -0.4f} * body;
    FillSdf(
        canvas,
        [&](float x, float y) {
            return SdCircle({x, y}, c, body);
        },
        [&](float x, float y) {
            const float d = Clamp01(Length(Vec2{x, y} - hot) / (1.5f * body));
            Rgb color = Mix(Hex(0x4A86E8), Hex(0x0C1A5C), std::pow(d, 0.9f));
            // Morning light rising from the bottom of the medal.
            const float dawn = Clamp01(((y - c.y) / body - 0.1f) / 0.9f);
            color = Mix(color, Hex(0xFFB870), dawn * dawn * 0.55f);
            color = Lighten(color, glow * 0.25f);
            return Tint{color * brightness};
        },
        box);
    if (glow > 0.0f) {
        FillSdf(
            canvas,
            [&](float x, float y) {
                return SdCircle({x, y}, c, body);
            },
            [&](float x, float y) {
                const float t = Clamp01(Length(Vec2{x, y} - c) / body);
                return Tint{Hex(0xFFF2C0), glow * Smoothstep(0.6f, 1.0f, t) * 0.8f};
            },
            box, 1.0f, Blend::Screen);
    }

    const float s = body;
    const float stroke = (0.13f + 0.05f * small) * s;
    auto monogram = [&](float x, float y) {
        const Vec2 p = {x, y};
        const float left =
            SdSegment(p, c + Vec2{-0.42f, -0.42f} * s, c + Vec2{0.0f, 0.42f} * s, stroke);
        const float right =
            SdSegment(p, c + Vec2{0.42f, -0.42f} * s, c + Vec2{0.0f, 0.42f} * s, stroke * 0.75f);
        float v = std::min(left, right);
        if (small == 0.0f) {
            v = std::min(v, SdSegment(p, c + Vec2{-0.6f, -0.44f} * s, c + Vec2{-0.26f, -0.44f} * s,
                                      stroke * 0.45f));
            v = std::min(v, SdSegment(p, c + Vec2{0.28f, -0.44f} * s, c + Vec2{0.56f, -0.44f} * s,
                                      stroke * 0.4f));
        }
        return v;
    };
    if (small == 0.0f) {
        FillSdf(
            canvas,
            [&](float x, float y) { return monogram(x + s * 0.05f, y - s * 0.07f) - s * 0.04f; },
            kNavy, box, 0.5f * brightness);
    }
    FillSdf(
        canvas,
        [&](float x, float y) {
            return monogram(x, y) - std::max(0.6f * supersampling, s * 0.05f);
        },
        kNavy, box);
    FillSdf(
        canvas, [&](float x, float y) { return monogram(x, y); },
        [&](float, float y) {
            const float t = Clamp01((y - (c.y - 0.5f * s)) / s);
            return Tint{Lighten(Mix(Hex(0xFFF4B0), Hex(0xF29A22), t), glow * 0.3f) * brightness};
        },
        box);
    const Vec2 star = c + Vec2{0.4f, -0.36f} * s;
    const std::vector<Vec2> points =
        StarPoints(star, s * (0.3f + 0.08f * glow), s * 0.06f, 4, 0.0f);
    FillSdf(
        canvas,
        [&](float x, float y) {
            return SdPolygon({x, y}, points);
        },
        Hex(0xFFFFFF), box, brightness);
    const Vec2 shine = c + Vec2{0.0f, -0.52f} * body;
    FillSdf(
        canvas,
        [&](float x, float y) {
            return std::max(SdEllipse({x, y}, shine, {0.7f * body, 0.38f * body}),
                            SdCircle({x, y}, c, body - 1.0f));
        },
        [&](float, float y) {
            const float t = Clamp01((y - (shine.y - 0.38f * body)) / (0.76f * body));
            return Tint{Hex(0xFFFFFF),
                        (0.4f + 0.15f * glow) * std::pow(1.0f - t, 1.6f) * brightness};
        },
        box, 1.0f, Blend::Over, 1.5f);
}

void PaintBanner(Canvas& canvas, const FontLibrary& fonts, Vec2 c, float halfWidth,
                 float halfHeight, float textSize, float brightness) {
    const float lift = halfHeight * 0.5f;
    auto curve = [&](float x) {
        const float u = (x - c.x) / halfWidth;
        return -lift * u * u;
    };
    const Box box = {static_cast<int>(c.x - halfWidth * 1.25f) - 2,
                     static_cast<int>(c.y - halfHeight * 2.0f) - 2,
                     static_cast<int>(c.x + halfWidth * 1.25f) + 3,
                     static_cast<int>(c.y + halfHeight * 2.0f) + 3};
    // Folded tails behind both ends, with a notch cut into each.
    for (float side : {-1.0f, 1.0f}) {
        const float inner = c.x + side * halfWidth * 0.84f;
        const float outer = c.x + side * halfWidth * 1.2f;
        const float y0 = c.y + curve(inner) - halfHeight * 0.55f;
        const float y1 = c.y + curve(inner) + halfHeight * 1.45f;
        const std::vector<Vec2> tail = {
            {inner, y0},
            {outer, y0 + halfHeight * 0.1f},
            {outer - side * halfHeight * 0.7f, (y0 + y1) * 0.5f + halfHeight * 0.05f},
            {outer, y1 + halfHeight * 0.1f},
            {inner, y1}};
        FillSdf(
            canvas,
            [&](float x, float y) {
                return SdPolygon({x, y}, tail) - 0.6f;
            },
            [&](float, float y) {
                return Tint{Mix(Hex(0xD8962E), Hex(0x9A5E16), Clamp01((y - y0) / (y1 - y0))) *
                            brightness};
            },
            box);
        FillSdf(
            canvas,
            [&](float x, float y) {
                return std::fabs(SdPolygon({x, y}, tail) - 0.6f) - 0.7f;
            },
            kNavy, box, 0.8f);
    }
    auto band = [&](float x, float y) {
        const float middle = c.y + curve(x);
        return std::max(std::fabs(y - middle) - halfHeight, std::fabs(x - c.x) - halfWidth);
    };
    FillSdf(
        canvas, [&](float x, float y) { return band(x, y) - 1.2f; }, kNavy, box);
    FillSdf(
        canvas, band,
        [&](float x, float y) {
            const float t = Clamp01((y - (c.y + curve(x) - halfHeight)) / (2.0f * halfHeight));
            Rgb color = Mix(Hex(0xFFF6CC), Hex(0xE6A83E), t);
            color = color * (0.94f + 0.06f * std::cos(t * kPi));
            return Tint{color * brightness};
        },
        box);
    FillSdf(
        canvas,
        [&](float x, float y) {
            const float middle = c.y + curve(x);
            return std::max(std::fabs(std::fabs(y - middle) - halfHeight * 0.78f) - 0.45f,
                            std::fabs(x - c.x) - halfWidth + 2.0f);
        },
        Hex(0xB07420) * brightness, box, 0.6f);
    TextStyle style;
    style.fillTop = Hex(0x26307A) * brightness;
    style.fillBottom = Hex(0x121848) * brightness;
    style.glow = Hex(0xFFFFFF);
    style.glowAlpha = 0.35f;
    style.glowRadius = 2.0f;
    const TextMask text = fonts.Render(Face::ComicBold, "THE VEMO", textSize, textSize * 0.12f, 8);
    const float capHeight = static_cast<float>(text.baseline - text.ink.y0);
    DrawText(canvas, text, CentredPenX(text, c.x), c.y + capHeight * 0.5f - 0.5f, style);
}

namespace {

Mask Silhouette(const FontLibrary& fonts, Vec2 shift) {
    Canvas shape(162, 117);
    FillSdf(
        shape,
        [&](float x, float y) {
            return SdCircle({x, y}, kAboutCentre + shift, kAboutRadius);
        },
        Hex(0x000000), shape.Bounds());
    PaintBanner(shape, fonts, kBannerCentre + shift, 58.0f, 11.0f, 17.0f);
    return AlphaOf(shape);
}

}  // namespace

Mask AboutSilhouette(const FontLibrary& fonts) {
    return Silhouette(fonts, {});
}

Canvas PaintAboutButton(const FontLibrary& fonts, FaceState state) {
    Canvas layer(162, 117);
    const bool pressed = state == FaceState::Pressed;
    const float glow = state == FaceState::Focused ? 1.0f : 0.0f;
    const float brightness = pressed ? 0.8f : 1.0f;
    const Vec2 shift = pressed ? Vec2{1.0f, 2.0f} : Vec2{};
    const Vec2 centre = kAboutCentre + shift;
    const Vec2 bannerCentre = kBannerCentre + shift;
    // The hover look shares the normal face's mask, so the shadow and outline stay put and the
    // glow lives inside them.
    Mask shadow = Silhouette(fonts, shift);
    Blur(shadow, pressed ? 1.2f : 2.2f);
    const int offset = pressed ? 1 : 2;
    PaintMask(layer, shadow, offset - 1, offset, Hex(0x0A1030), 0.42f);
    PaintMedallion(layer, centre, kAboutRadius, glow, brightness);
    PaintBanner(layer, fonts, bannerCentre, 58.0f, 11.0f, 17.0f, brightness + glow * 0.06f);
    if (glow > 0.0f) {
        const Vec2 sparkles[] = {{42.0f, 28.0f}, {110.0f, 32.0f}, {100.0f, 62.0f}};
        for (const Vec2& at : sparkles) {
            const std::vector<Vec2> star = StarPoints(at, 5.0f, 1.0f, 4, 0.0f);
            FillSdf(
                layer,
                [&](float x, float y) {
                    return SdPolygon({x, y}, star);
                },
                Hex(0xFFFFFF), layer.Bounds(), 0.9f);
        }
    }
    FadeEdges(layer, 2.0f);
    return layer;
}

IconImage PaintIcon(int size) {
    // Drawn four times larger and averaged down, so fine parts keep their shape when small.
    const int factor = 4;
    Canvas big(size * factor, size * factor);
    const float centre = static_cast<float>(size * factor) * 0.5f;
    PaintMedallion(big, {centre, centre}, centre - static_cast<float>(factor) * 0.5f, 0.0f, 1.0f,
                   static_cast<float>(factor));
    const Canvas small = Downsample(big, factor);
    IconImage image;
    image.size = size;
    image.rgba.resize(static_cast<size_t>(size) * size * 4);
    for (int y = 0; y < size; ++y) {
        for (int x = 0; x < size; ++x) {
            const Rgb c = small.ColorAt(x, y);
            const float a = small.At(x, y).a;
            uint8_t* p = &image.rgba[(static_cast<size_t>(y) * size + x) * 4];
            p[0] = static_cast<uint8_t>(std::lround(Clamp01(c.r) * 255.0f));
            p[1] = static_cast<uint8_t>(std::lround(Clamp01(c.g) * 255.0f));
            p[2] = static_cast<uint8_t>(std::lround(Clamp01(c.b) * 255.0f));
            p[3] = static_cast<uint8_t>(std::lround(Clamp01(a) * 255.0f));
        }
    }
    return image;
}

}  // namespace discart
