#include "panels.h"

#include <cmath>

#include "geometry.h"
#include "noise.h"
#include "symbols.h"

namespace discart {

namespace {

constexpr Rgb kShadow = Hex(0x080C28);

Vec2 Centre(Box b) {
    return {static_cast<float>(b.x0 + b.x1) * 0.5f, static_cast<float>(b.y0 + b.y1) * 0.5f};
}

Vec2 Half(Box b) {
    return {static_cast<float>(b.x1 - b.x0) * 0.5f, static_cast<float>(b.y1 - b.y0) * 0.5f};
}

void PaintSoftShadow(Canvas& canvas, Box frame, float radius, Vec2 offset, float blur,
                     float alpha) {
    Mask shadow = MaskFromSdf(canvas.width, canvas.height, [&](float x, float y) {
        return SdRoundBox({x - offset.x, y - offset.y}, Centre(frame), Half(frame), radius);
    });
    Blur(shadow, blur);
    PaintMask(canvas, shadow, 0, 0, kShadow, alpha);
}

Rgb Gold(float t) {
    return Mix(Hex(0xFFEDB0), Hex(0xB67A26), Clamp01(t));
}

}  // namespace

Picture PaintOpaqueMask() {
    Picture mask(350, 350, 8);
    for (int y = 0; y < mask.height; ++y) {
        for (int x = 0; x < mask.width; ++x) mask.Pixel(x, y)[0] = ((x + y) % 2 == 0) ? 252 : 251;
    }
    return mask;
}

void PaintGlassFrame(Canvas& canvas, Box frame, float radius, float opacity) {
    const Vec2 centre = Centre(frame);
    const Vec2 half = Half(frame);
    const Box all = canvas.Bounds();
    PaintSoftShadow(canvas, frame, radius, {0.0f, 3.0f}, 3.0f, 0.5f);
    auto outer = [&](float x, float y) { return SdRoundBox({x, y}, centre, half, radius); };
    const float top = static_cast<float>(frame.y0);
    const float height = static_cast<float>(frame.y1 - frame.y0);
    FillSdf(
        canvas, outer,
        [&](float x, float y) {
            const float t = (y - top) / height;
            Rgb color = Mix(Hex(0x22347E), Hex(0x0E1640), Smoothstep(0.0f, 1.0f, t));
            // A faint sheen across the glass, brightest at the top.
            const float sheen = 0.08f * Clamp01(1.0f - t * 5.0f) +
                                0.03f * Clamp01(1.0f - std::fabs((x - centre.x) / half.x));
            color = Lighten(color, sheen);
            return Tint{color, opacity};
        },
        all);
    FillSdf(
        canvas, [&](float x, float y) { return std::fabs(outer(x, y) + 1.8f) - 1.8f; },
        [&](float, float y) { return Tint{Gold((y - top) / height * 1.2f)}; }, all);
    FillSdf(
        canvas, [&](float x, float y) { return std::fabs(outer(x, y) + 6.5f) - 0.5f; },
        Hex(0x7FD8F0), all, 0.45f);
    const float inset = 10.0f;
    const Vec2 corners[] = {{static_cast<float>(frame.x0) + inset, top + inset},
                            {static_cast<float>(frame.x1) - inset, top + inset},
                            {static_cast<float>(frame.x0) + inset, top + height - inset},
                            {static_cast<float>(frame.x1) - inset, top + height - inset}};
    for (const Vec2& corner : corners) {
        const std::vector<Vec2> star = StarPoints(corner, 4.5f, 1.0f, 4, 0.0f);
        FillSdf(
            canvas,
            [&](float x, float y) {
                return SdPolygon({x, y}, star);
            },
            Hex(0xFFE9A8), all, 0.9f);
    }
}

Picture PaintPanel(const Picture& under, PanelMotif motif) {
    Canvas canvas = ToCanvas(under);
    const Box frame = {3, 3, canvas.width - 3, canvas.height - 5};
    PaintGlassFrame(canvas, frame, 16.0f, 0.96f);
    // A few faint stars in the glass.
    Random random(motif == PanelMotif::Play ? 3 : motif == PanelMotif::Information ? 5 : 7);
    for (int i = 0; i < 26; ++i) {
        const Vec2 at = {random.Range(14.0f, static_cast<float>(canvas.width) - 14.0f),
                         random.Range(14.0f, static_cast<float>(canvas.height) - 16.0f)};
        const float size = random.Range(0.5f, 1.0f);
        FillSdf(
            canvas,
            [&](float x, float y) {
                return SdCircle({x, y}, at, size);
            },
            Hex(0xCFE8FF),
            Grow({static_cast<int>(at.x), static_cast<int>(at.y), static_cast<int>(at.x),
                  static_cast<int>(at.y)},
                 3),
            random.Range(0.25f, 0.6f));
    }
    // The lower part of the tall panels holds their sign, barely there, under the plates.
    if (motif != PanelMotif::Play) {
        const Vec2 centre = {static_cast<float>(canvas.width) * 0.5f - 2.0f,
                             static_cast<float>(canvas.height) - 48.0f};
        Canvas sign(canvas.width, canvas.height);
        SymbolPen pen(sign, centre, 34.0f);
        if (motif == PanelMotif::Information) {
            BookSymbol(pen);
        } else {
            GamepadSymbol(pen);
        }
        PaintMask(canvas, AlphaOf(sign), 0, 0, Hex(0xFFE2A0), 0.16f);
    }
    return ToPicture(canvas);
}

Picture PaintPlate(const Picture& under, bool pressed) {
    Canvas canvas = ToCanvas(under);
    const Vec2 shift = pressed ? Vec2{1.0f, 1.0f} : Vec2{};
    const Box frame = {3 + static_cast<int>(shift.x), 2 + static_cast<int>(shift.y),
                       canvas.width - 4 + static_cast<int>(shift.x),
                       canvas.height - 7 + static_cast<int>(shift.y)};
    const Vec2 centre = Centre(frame);
    const Vec2 half = Half(frame);
    const float radius = half.y;
    const Box all = canvas.Bounds();
    PaintSoftShadow(canvas, frame, radius, pressed ? Vec2{0.0f, 1.0f} : Vec2{0.5f, 2.5f},
                    pressed ? 1.2f : 2.0f, pressed ? 0.45f : 0.55f);
    auto body = [&](float x, float y) { return SdRoundBox({x, y}, centre, half, radius); };
    const float top = static_cast<float>(frame.y0);
    const float height = static_cast<float>(frame.y1 - frame.y0);
    const float dim = pressed ? 0.72f : 1.0f;
    FillSdf(
        canvas, body,
        [&](float, float y) {
            const float t = (y - top) / height;
            Rgb color = t < 0.5f ? Mix(Hex(0x3E5CB0), Hex(0x22387E), t * 2.0f)
                                 : Mix(Hex(0x1A2A6C), Hex(0x121C4E), (t - 0.5f) * 2.0f);
            if (pressed) color = Mix(Hex(0x121A48), Hex(0x1C2C6C), t);
            return Tint{color * dim};
        },
        all);
    if (!pressed) {
        // Glass sheen over the upper half, and light caught along the lower edge.
        FillSdf(
            canvas,
            [&](float x, float y) {
                return std::max(body(x, y) + 2.5f, y - (top + height * 0.48f));
            },
            [&](float, float y) {
                return Tint{Hex(0xFFFFFF), 0.16f * (1.0f - Clamp01((y - top) / (height * 0.5f)))};
            },
            all);
        FillSdf(
            canvas,
            [&](float x, float y) {
                return std::max(body(x, y) + 2.5f, (top + height * 0.72f) - y);
            },
            [&](float, float y) {
                return Tint{Hex(0x6FD8F4),
                            0.22f * Clamp01((y - top - height * 0.72f) / (height * 0.28f))};
            },
            all, 1.0f, Blend::Over, 2.0f);
    } else {
        // Pressed in: the upper rim throws its shadow into the plate.
        FillSdf(
            canvas, [&](float x, float y) { return body(x, y) + 2.0f; },
            [&](float, float y) {
                return Tint{kShadow, 0.55f * (1.0f - Clamp01((y - top - 2.0f) / (height * 0.45f)))};
            },
            all);
    }
    FillSdf(
        canvas, [&](float x, float y) { return std::fabs(body(x, y) + 1.1f) - 1.1f; },
        [&](float, float y) { return Tint{Gold((y - top) / height) * (pressed ? 0.8f : 1.0f)}; },
        all);
    FillSdf(
        canvas, [&](float x, float y) { return std::fabs(body(x, y) + 3.0f) - 0.5f; },
        Hex(0x0A1034), all, 0.5f);
    // Gold rivets at both ends, out of the way of even the longest label.
    for (float side : {-1.0f, 1.0f}) {
        const Vec2 rivet = {centre.x + side * (half.x - 6.5f), centre.y};
        FillSdf(
            canvas,
            [&](float x, float y) {
                return SdCircle({x, y}, rivet, 1.9f);
            },
            [&](float x, float y) {
                const float d = Clamp01(Length(Vec2{x, y} - (rivet + Vec2{-0.6f, -0.7f})) / 2.5f);
                return Tint{Mix(Hex(0xFFF6D0), Hex(0xB07A26), d) * (pressed ? 0.75f : 1.0f)};
            },
            all);
    }
    return ToPicture(canvas);
}

}  // namespace discart
