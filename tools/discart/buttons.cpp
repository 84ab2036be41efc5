#include "buttons.h"

#include <algorithm>
#include <cmath>

namespace discart {

namespace {

constexpr Rgb kShadow = Hex(0x0A1030);

Box Around(Vec2 centre, float radius) {
    return Grow({static_cast<int>(centre.x), static_cast<int>(centre.y), static_cast<int>(centre.x),
                 static_cast<int>(centre.y)},
                static_cast<int>(std::ceil(radius)) + 2);
}

// Blends from a to b across edge, over one pixel's width w (in the same units as v).
Rgb Edge(Rgb a, Rgb b, float v, float edge, float w) {
    return Mix(a, b, Clamp01((v - edge) / w + 0.5f));
}

// The flag colours across a sash at unit position p (x across, t 0..1 down the sash); px and pt
// are one pixel in those units.
Rgb SashColor(Sash sash, Vec2 p, float t, float px, float pt) {
    switch (sash) {
        case Sash::German:
            return Edge(Edge(Hex(0x1E1E1E), Hex(0xDD1C1C), t, 1.0f / 3.0f, pt), Hex(0xFFCE00), t,
                        2.0f / 3.0f, pt);
        case Sash::French:
            return Edge(Edge(Hex(0x1F4FA8), Hex(0xFAFAFA), p.x, -0.26f, px), Hex(0xEF4135), p.x,
                        0.26f, px);
        case Sash::Spanish:
            return Edge(Edge(Hex(0xC21A22), Hex(0xF8C400), t, 0.25f, pt), Hex(0xC21A22), t, 0.75f,
                        pt);
        case Sash::Japanese:
            return Edge(Hex(0xC8102E), Hex(0xFAFAFA), Length(p - Vec2{0.0f, 0.62f}), 0.12f, px);
        case Sash::None:
            break;
    }
    return {};
}

void PaintSash(Canvas& layer, Vec2 centre, float bodyRadius, Sash sash, float brightness) {
    const float top = 0.44f;
    const float bottom = 0.8f;
    const float bend = 0.14f;
    auto unit = [=](float x, float y) {
        return Vec2{(x - centre.x) / bodyRadius, (y - centre.y) / bodyRadius};
    };
    auto band = [=](Vec2 p) {
        const float lift = bend * p.x * p.x;
        return std::max(top + lift - p.y, p.y - (bottom + lift));
    };
    const Box box = Around(centre, bodyRadius);
    FillSdf(
        layer,
        [&](float x, float y) {
            const Vec2 p = unit(x, y);
            return std::max(band(p), Length(p) - 1.0f) * bodyRadius;
        },
        [&](float x, float y) {
            const Vec2 p = unit(x, y);
            const float t = Clamp01((p.y - top - bend * p.x * p.x) / (bottom - top));
            // Curved shading gives the sash its roundness on the orb.
            const float shade = 0.82f + 0.18f * std::cos((t - 0.35f) * kPi * 0.8f);
            const float px = 1.0f / bodyRadius;
            const float pt = px / (bottom - top);
            return Tint{SashColor(sash, p, t, px, pt) * (shade * brightness)};
        },
        box);
    FillSdf(
        layer,
        [&](float x, float y) {
            const Vec2 p = unit(x, y);
            const float lift = bend * p.x * p.x;
            const float edges =
                std::min(std::fabs(p.y - top - lift), std::fabs(p.y - bottom - lift)) - 0.028f;
            return std::max(edges, Length(p) - 1.0f) * bodyRadius;
        },
        Hex(0xFFE08A) * brightness, box, 0.9f);
}

}  // namespace

void FadeEdges(Canvas& layer, float width) {
    for (int y = 0; y < layer.height; ++y) {
        for (int x = 0; x < layer.width; ++x) {
            const float edge = static_cast<float>(
                std::min(std::min(x, y), std::min(layer.width - 1 - x, layer.height - 1 - y)));
            const float keep = Clamp01(edge / width);
            Rgba& p = layer.At(x, y);
            p.r *= keep;
            p.g *= keep;
            p.b *= keep;
            p.a *= keep;
        }
    }
}

Canvas PaintOrb(const OrbDesign& design, FaceState state) {
    Canvas layer(design.width, design.height);
    const bool pressed = state == FaceState::Pressed;
    const bool focused = state == FaceState::Focused;
    const bool latched = state == FaceState::Latched;
    const Vec2 c = design.centre + (pressed ? Vec2{1.0f, 2.0f} : Vec2{});
    const float r = design.radius;
    const float room = std::min(std::min(design.centre.x, design.centre.y),
                                std::min(static_cast<float>(design.width) - design.centre.x,
                                         static_cast<float>(design.height) - design.centre.y)) -
                       r;
    const Box all = layer.Bounds();

    if (!focused) {
        const Vec2 offset = pressed ? Vec2{0.3f, 0.8f} : Vec2{1.2f, 2.4f};
        Mask shadow = MaskFromSdf(design.width, design.height, [&](float x, float y) {
            return SdCircle({x, y}, c + offset, r - 0.5f);
        });
        Blur(shadow, pressed ? 1.2f : 2.2f);
        PaintMask(layer, shadow, 0, 0, kShadow, pressed ? 0.35f : 0.42f);
    }
    if (focused) {
        PaintBox(layer, all, [&](float x, float y) {
            const float t = Clamp01((Length(Vec2{x, y} - c) - r + 1.0f) / room);
            return Tint{Mix(Hex(0xFFE680), Hex(0xFFA820), t), 0.95f * std::pow(1.0f - t, 1.5f)};
        });
    }
    if (latched) {
        PaintBox(layer, all, [&](float x, float y) {
            const float t = Clamp01((Length(Vec2{x, y} - c) - r - 2.0f) / (room - 1.0f));
            return Tint{Hex(0x7EEBFF), 0.75f * std::pow(1.0f - t, 2.0f)};
        });
        FillSdf(
            layer,
            [&](float x, float y) {
                return SdRing({x, y}, c, r + 1.8f, 1.7f);
            },
            Hex(0xE6FDFF), all);
    }

    // Gold rim, lit from the upper left like everything in the scene.
    const float brightness = pressed ? 0.78f : focused ? 1.1f : 1.0f;
    FillSdf(
        layer,
        [&](float x, float y) {
            return SdCircle({x, y}, c, r);
        },
        [&](float x, float y) {
            const Vec2 n = (Vec2{x, y} - c) * (1.0f / r);
            const float light = Clamp01(Dot(n, Vec2{-0.6f, -0.8f}) * 0.5f + 0.5f);
            Rgb color = Mix(Hex(0x8C5A16), Hex(0xFFF0B4), light);
            if (latched) color = Mix(color, Hex(0xBDF6FF), 0.45f);
            return Tint{color * brightness};
        },
        all);
    const float rimWidth = std::max(2.2f, r * 0.1f);
    const float body = r - rimWidth;
    const Vec2 hot = c + Vec2{-0.3f, -0.38f} * body;
    const Rgb accent = design.accent;
    FillSdf(
        layer,
        [&](float x, float y) {
            return SdCircle({x, y}, c, body);
        },
        [&](float x, float y) {
            const float d = Clamp01(Length(Vec2{x, y} - hot) / (1.45f * body));
            Rgb color = Mix(Lighten(accent, 0.4f), accent * 0.42f, std::pow(d, 1.1f));
            if (focused) color = Lighten(color, 0.12f);
            return Tint{color * brightness};
        },
        all);
    // Light through the glass gathers at the bottom of the orb.
    FillSdf(
        layer,
        [&](float x, float y) {
            return std::max(
                SdEllipse({x, y}, c + Vec2{0.0f, 0.55f} * body, {0.7f * body, 0.42f * body}),
                SdCircle({x, y}, c, body));
        },
        Lighten(accent, 0.6f), all, pressed ? 0.25f : 0.45f, Blend::Screen, body * 0.35f);
    FillSdf(
        layer,
        [&](float x, float y) {
            return SdRing({x, y}, c, body - 1.0f, 1.4f);
        },
        [&](float x, float y) {
            const Vec2 n = (Vec2{x, y} - c) * (1.0f / body);
            return Tint{kShadow, 0.45f * Clamp01(0.2f - n.y)};
        },
        all);

    if (design.sash != Sash::None) PaintSash(layer, c, body, design.sash, brightness);

    if (design.symbol) {
        Canvas symbol(design.width, design.height);
        SymbolPen pen(symbol, c, body);
        design.symbol(pen);
        Mask ink = AlphaOf(symbol);
        if (focused) {
            Mask glow = Dilate(ink, 1.5f);
            Blur(glow, 2.5f);
            PaintMask(layer, glow, 0, 0, Hex(0xFFE59A), 0.85f, Blend::Screen);
        }
        Mask shadow = ink;
        Blur(shadow, 1.0f);
        const int dx = static_cast<int>(std::lround(std::max(1.0f, body * 0.04f)));
        PaintMask(layer, shadow, dx, dx + 1, kShadow, 0.5f);
        if (pressed) Darken(symbol, 0.85f);
        DrawLayer(layer, symbol, 0, 0);
    }

    const Vec2 shineCentre = c + Vec2{0.0f, -0.5f} * body;
    const Vec2 shineRadii = {0.68f * body, 0.4f * body};
    const float shine = pressed ? 0.22f : focused ? 0.62f : 0.5f;
    FillSdf(
        layer,
        [&](float x, float y) {
            return std::max(SdEllipse({x, y}, shineCentre, shineRadii),
                            SdCircle({x, y}, c, body - 1.5f));
        },
        [&](float, float y) {
            const float t = Clamp01((y - (shineCentre.y - shineRadii.y)) / (2.0f * shineRadii.y));
            return Tint{Hex(0xFFFFFF), shine * std::pow(1.0f - t, 1.6f)};
        },
        all, 1.0f, Blend::Over, 1.5f);
    const Vec2 glint = c + Vec2{-0.52f, -0.5f} * body;
    const std::vector<Vec2> star =
        StarPoints(glint, focused ? body * 0.2f : body * 0.13f, body * 0.03f, 4, 0.0f);
    FillSdf(
        layer,
        [&](float x, float y) {
            return SdPolygon({x, y}, star);
        },
        Hex(0xFFFFFF), all, pressed ? 0.4f : 0.9f);

    FadeEdges(layer, 2.0f);
    return layer;
}

}  // namespace discart
