#include "symbols.h"

#include <cmath>

namespace discart {

namespace {

constexpr Rgb kInk = Hex(0x1A2462);

float Union(float a, float b) {
    return std::min(a, b);
}
float Subtract(float a, float b) {
    return std::max(a, -b);
}

// Arc of a ring, open at the top over +-gap radians, with round ends.
float SdOpenRing(Vec2 p, float radius, float halfWidth, float gap) {
    const float angle = std::atan2(p.x, -p.y);
    if (std::fabs(angle) > gap) return std::fabs(Length(p) - radius) - halfWidth;
    const float side = angle < 0.0f ? -1.0f : 1.0f;
    const Vec2 end = {side * radius * std::sin(gap), -radius * std::cos(gap)};
    return Length(p - end) - halfWidth;
}

std::vector<Vec2> Triangle(Vec2 centre, float size) {
    return {centre + Vec2{-0.36f, -0.46f} * size, centre + Vec2{-0.36f, 0.46f} * size,
            centre + Vec2{0.5f, 0.0f} * size};
}

void DrawPlay(SymbolPen& pen, Vec2 centre, float size) {
    const std::vector<Vec2> points = Triangle(centre, size);
    pen.Fill([points, size](Vec2 p) { return SdPolygon(p, points) - 0.09f * size; }, SymbolFace());
}

}  // namespace

SymbolPen::SymbolPen(Canvas& target, Vec2 at, float unit)
    : canvas(target), centre(at), scale(unit) {}

void SymbolPen::Fill(const UnitSdf& sdf, const UnitShader& shader, float alpha) {
    const Vec2 c = centre;
    const float s = scale;
    FillSdf(
        canvas,
        [&](float x, float y) {
            return sdf({(x - c.x) / s, (y - c.y) / s}) * s;
        },
        [&](float x, float y) {
            return shader({(x - c.x) / s, (y - c.y) / s});
        },
        Grow({static_cast<int>(c.x - s), static_cast<int>(c.y - s), static_cast<int>(c.x + s),
              static_cast<int>(c.y + s)},
             3),
        alpha);
}

void SymbolPen::Fill(const UnitSdf& sdf, Rgb color, float alpha) {
    Fill(
        sdf, [color](Vec2) { return Tint{color}; }, alpha);
}

UnitShader SymbolFace() {
    return
        [](Vec2 p) { return Tint{Mix(Hex(0xFFFFFF), Hex(0xFFE4AE), Clamp01(p.y * 0.6f + 0.5f))}; };
}

void InstallSymbol(SymbolPen& pen) {
    const Vec2 disc = {0.0f, -0.3f};
    pen.Fill(
        [disc](Vec2 p) { return Subtract(SdCircle(p, disc, 0.36f), SdCircle(p, disc, 0.08f)); },
        [disc](Vec2 p) {
            // A silvery disc with a rainbow sheen that turns with the angle.
            const Vec2 d = p - disc;
            const float angle = std::atan2(d.y, d.x);
            const Rgb sheen = {0.5f + 0.5f * std::cos(angle * 2.0f),
                               0.5f + 0.5f * std::cos(angle * 2.0f + 2.1f),
                               0.5f + 0.5f * std::cos(angle * 2.0f + 4.2f)};
            Rgb color = Mix(Hex(0xF2F4FA), sheen, 0.35f);
            color = Mix(color, Hex(0x9AA4C4), Smoothstep(0.3f, 0.36f, Length(d)) * 0.6f);
            return Tint{color};
        });
    const auto tray = [](Vec2 p) {
        return Subtract(SdRoundBox(p, {0.0f, 0.42f}, {0.54f, 0.17f}, 0.08f),
                        SdRoundBox(p, {0.0f, 0.33f}, {0.4f, 0.14f}, 0.04f));
    };
    pen.Fill(tray, SymbolFace());
    const std::vector<Vec2> head = {{-0.27f, 0.08f}, {0.27f, 0.08f}, {0.0f, 0.4f}};
    const auto arrow = [head](Vec2 p) {
        return Union(SdRoundBox(p, {0.0f, -0.12f}, {0.1f, 0.24f}, 0.04f),
                     SdPolygon(p, head) - 0.02f);
    };
    pen.Fill([arrow](Vec2 p) { return arrow(p) - 0.06f; }, kInk, 0.85f);
    pen.Fill(arrow, [](Vec2 p) {
        return Tint{Mix(Hex(0xFFF2A0), Hex(0xF5A623), Clamp01(p.y * 1.4f + 0.5f))};
    });
}

void PlaySymbol(SymbolPen& pen) {
    DrawPlay(pen, {0.05f, 0.0f}, 1.0f);
}

void PlaySymbolRaised(SymbolPen& pen) {
    DrawPlay(pen, {0.05f, -0.14f}, 0.84f);
}

void GlobeSymbol(SymbolPen& pen) {
    pen.Fill(
        [](Vec2 p) {
            return SdCircle(p, {0.0f, 0.0f}, 0.58f);
        },
        [](Vec2 p) {
            return Tint{Hex(0xFFFFFF), 0.16f + 0.1f * Clamp01(-p.y)};
        });
    pen.Fill(
        [](Vec2 p) {
            const float inside = SdCircle(p, {0.0f, 0.0f}, 0.56f);
            float lines = std::fabs(Length(p) - 0.56f) - 0.07f;
            float inner = std::fabs(SdEllipse(p, {0.0f, 0.0f}, {0.26f, 0.56f})) - 0.05f;
            inner = Union(inner, std::fabs(p.x) - 0.05f);
            inner = Union(inner, std::fabs(p.y) - 0.05f);
            inner = Union(inner, std::fabs(std::fabs(p.y) - 0.29f) - 0.045f);
            lines = Union(lines, std::max(inner, inside));
            return lines;
        },
        SymbolFace());
}

void GamepadSymbol(SymbolPen& pen) {
    const auto body = [](Vec2 p) {
        const float middle = SdRoundBox(p, {0.0f, -0.02f}, {0.52f, 0.2f}, 0.18f);
        const float left = SdSegment(p, {-0.34f, 0.0f}, {-0.42f, 0.3f}, 0.18f);
        const float right = SdSegment(p, {0.34f, 0.0f}, {0.42f, 0.3f}, 0.18f);
        return SmoothMin(SmoothMin(middle, left, 0.08f), right, 0.08f);
    };
    pen.Fill(body, SymbolFace());
    pen.Fill(
        [](Vec2 p) {
            return Union(SdRoundBox(p, {-0.3f, 0.0f}, {0.14f, 0.045f}, 0.02f),
                         SdRoundBox(p, {-0.3f, 0.0f}, {0.045f, 0.14f}, 0.02f));
        },
        kInk, 0.9f);
    pen.Fill([](Vec2 p) { return SdCircle(p, {0.25f, -0.06f}, 0.065f); }, Hex(0xE8455A));
    pen.Fill([](Vec2 p) { return SdCircle(p, {0.38f, 0.06f}, 0.065f); }, Hex(0x2FA8E0));
    pen.Fill([](Vec2 p) { return SdCircle(p, {0.12f, 0.06f}, 0.065f); }, Hex(0x46B85A));
    pen.Fill([](Vec2 p) { return SdCircle(p, {0.25f, 0.18f}, 0.065f); }, Hex(0xF5B82E));
}

void StarSymbol(SymbolPen& pen) {
    const std::vector<Vec2> star = StarPoints({0.0f, 0.04f}, 0.56f, 0.25f, 5, 0.0f);
    pen.Fill(
        [star](Vec2 p) { return SdPolygon(p, star) - 0.05f; },
        [](Vec2 p) { return Tint{Mix(Hex(0xFFF7C0), Hex(0xF6A21E), Clamp01(p.y * 0.9f + 0.5f))}; });
    pen.Fill([star](Vec2 p) { return std::fabs(SdPolygon(p, star) - 0.05f) - 0.025f; },
             Hex(0xFFFFFF), 0.7f);
}

void BookSymbol(SymbolPen& pen) {
    const std::vector<Vec2> cover = {{-0.64f, -0.26f}, {0.0f, -0.16f}, {0.64f, -0.26f},
                                     {0.64f, 0.44f},   {0.0f, 0.52f},  {-0.64f, 0.44f}};
    pen.Fill([cover](Vec2 p) { return SdPolygon(p, cover) - 0.03f; },
             [](Vec2) { return Tint{Hex(0xF5B23A)}; });
    const std::vector<Vec2> left = {
        {-0.58f, -0.36f}, {-0.03f, -0.25f}, {-0.03f, 0.4f}, {-0.58f, 0.3f}};
    const std::vector<Vec2> right = {
        {0.58f, -0.36f}, {0.03f, -0.25f}, {0.03f, 0.4f}, {0.58f, 0.3f}};
    pen.Fill([left](Vec2 p) { return SdPolygon(p, left) - 0.02f; }, SymbolFace());
    pen.Fill([right](Vec2 p) { return SdPolygon(p, right) - 0.02f; }, SymbolFace());
    pen.Fill(
        [](Vec2 p) {
            float lines = 1e3f;
            for (int i = 0; i < 3; ++i) {
                const float y = -0.14f + 0.16f * static_cast<float>(i);
                lines = Union(lines, SdSegment(p, {-0.48f, y}, {-0.13f, y + 0.07f}, 0.025f));
                lines = Union(lines, SdSegment(p, {0.13f, y + 0.07f}, {0.48f, y}, 0.025f));
            }
            return lines;
        },
        kInk, 0.45f);
}

void PowerSymbol(SymbolPen& pen) {
    const auto shape = [](Vec2 p) {
        return Union(SdOpenRing(p, 0.42f, 0.085f, 0.72f),
                     SdSegment(p, {0.0f, -0.62f}, {0.0f, -0.1f}, 0.085f));
    };
    pen.Fill(shape, SymbolFace());
}

}  // namespace discart
