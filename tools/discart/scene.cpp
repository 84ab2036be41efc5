#include "scene.h"

#include <algorithm>
#include <cmath>

#include "noise.h"

namespace discart {

namespace {

constexpr int kWidth = 640;
constexpr int kHeight = 480;

struct Stop {
    float at;
    Rgb color;
};

Rgb Gradient(const std::vector<Stop>& stops, float t) {
    if (t <= stops.front().at) return stops.front().color;
    for (size_t i = 1; i < stops.size(); ++i) {
        if (t <= stops[i].at) {
            const float local = (t - stops[i - 1].at) / (stops[i].at - stops[i - 1].at);
            return Mix(stops[i - 1].color, stops[i].color, Smoothstep(0.0f, 1.0f, local));
        }
    }
    return stops.back().color;
}

Vec2 Normalised(Vec2 v) {
    const float length = Length(v);
    return length > 0.0f ? v * (1.0f / length) : Vec2{0.0f, -1.0f};
}

struct Puff {
    Vec2 centre;
    float radius;
};

// Shading follows both the puff and the whole bank, so that a bank reads as one soft mass with
// a lit top and a cool underside rather than as a heap of balls.
void PaintPuff(Canvas& canvas, const SkyLight& light, const Puff& puff, float haze, float top,
               float base, bool flatBottom) {
    const Rgb lit = Hex(0xFFFDF8);
    const Rgb shade = Hex(0xB3B5E0);
    const Rgb rim = Hex(0xFFDDB4);
    const Vec2 toSun = Normalised(light.sun - puff.centre);
    const float sunNear = std::exp(-Length(light.sun - puff.centre) / 260.0f);
    const Vec2 c = puff.centre;
    const float r = puff.radius;
    auto shader = [&](float x, float y) {
        const Vec2 n = {(x - c.x) / r, (y - c.y) / r};
        const float puffT = Clamp01((y - (c.y - r)) / (2.0f * r));
        const float bankT = Clamp01((y - top) / std::max(1.0f, base - top));
        const float t = 0.45f * puffT + 0.55f * bankT;
        Rgb color = Mix(lit, shade, Smoothstep(0.25f, 1.0f, t) * 0.9f);
        const float edge = Smoothstep(0.6f, 1.0f, Length(n));
        color = Mix(color, rim, Clamp01(Dot(n, toSun)) * edge * (0.25f + 0.6f * sunNear));
        // A slightly darker lower rim keeps overlapping puffs apart.
        color = color * (1.0f - 0.05f * edge * Clamp01(n.y + 0.3f));
        color = Mix(color, SkyColor(light, x, y), haze);
        float alpha = 1.0f;
        if (flatBottom) alpha = Smoothstep(base + 1.5f, base - 3.0f, y);
        return Tint{color, alpha};
    };
    const Box box = {static_cast<int>(c.x - r) - 2, static_cast<int>(c.y - r) - 2,
                     static_cast<int>(c.x + r) + 3, static_cast<int>(c.y + r) + 3};
    FillSdf(
        canvas,
        [&](float x, float y) {
            return SdCircle({x, y}, c, r);
        },
        shader, box, 1.0f, Blend::Over, 1.6f);
}

void PaintSparkle(Canvas& canvas, Vec2 at, float size, float alpha, Rgb color) {
    const Box box = {
        static_cast<int>(at.x - size * 2.0f) - 2, static_cast<int>(at.y - size * 2.0f) - 2,
        static_cast<int>(at.x + size * 2.0f) + 3, static_cast<int>(at.y + size * 2.0f) + 3};
    PaintBox(
        canvas, box,
        [&](float x, float y) {
            const float d = Length(Vec2{x, y} - at);
            return Tint{color, alpha * 0.6f * std::exp(-d * d / (size * size * 0.5f))};
        },
        Blend::Screen);
    const std::vector<Vec2> star = StarPoints(at, size, size * 0.2f, 4, 0.0f);
    FillSdf(
        canvas,
        [&](float x, float y) {
            return SdPolygon({x, y}, star);
        },
        Hex(0xFFFFFF), box, alpha);
}

TextStyle GreetingStyle() {
    TextStyle style;
    style.fillTop = Hex(0xFFFFFF);
    style.fillBottom = Hex(0xCFE6FF);
    style.outline = Hex(0x1A2464);
    style.outlineWidth = 3.0f;
    style.shadow = Hex(0x0A0E32);
    style.shadowAlpha = 0.45f;
    style.shadowBlur = 2.5f;
    style.shadowOffset = {2.0f, 3.0f};
    style.glow = Hex(0xFFF0C8);
    style.glowAlpha = 0.25f;
    style.glowRadius = 8.0f;
    style.sheen = 0.15f;
    return style;
}

void PaintGlobe(Canvas& canvas, Vec2 centre, float radius, uint32_t seed) {
    const Box box = {static_cast<int>(centre.x - radius * 2.2f),
                     static_cast<int>(centre.y - radius * 2.0f),
                     static_cast<int>(centre.x + radius * 2.2f) + 1,
                     static_cast<int>(centre.y + radius * 2.0f) + 1};
    PaintBox(
        canvas, box,
        [&](float x, float y) {
            const float d = Length(Vec2{x, y} - centre) / radius;
            return Tint{Hex(0xCFF0FF), 0.55f * std::exp(-(d - 0.9f) * (d - 0.9f) * 2.2f)};
        },
        Blend::Screen);

    // The orbit ring is tilted; its far half passes behind the globe.
    const float tilt = -0.32f;
    const float ca = std::cos(tilt);
    const float sa = std::sin(tilt);
    const Vec2 ringRadii = {radius * 1.28f, radius * 0.34f};
    auto ringFrame = [=](float x, float y) {
        const float dx = x - centre.x;
        const float dy = y - centre.y;
        return Vec2{dx * ca + dy * sa, -dx * sa + dy * ca};
    };
    auto ring = [=](float x, float y) {
        return std::fabs(SdEllipse(ringFrame(x, y), {0.0f, 0.0f}, ringRadii)) - 1.6f;
    };
    auto ringShader = [=](float x, float y) {
        const Vec2 q = ringFrame(x, y);
        return Tint{Mix(Hex(0xFFE9A8), Hex(0xE0A040), Clamp01(q.x / ringRadii.x * 0.5f + 0.5f))};
    };
    FillSdf(
        canvas, [&](float x, float y) { return ringFrame(x, y).y < 0.0f ? ring(x, y) : 1e3f; },
        ringShader, box, 0.8f);

    const float lx = -0.48f;
    const float ly = -0.58f;
    const float lz = 0.66f;
    auto sphere = [&](float x, float y) {
        const float nx = (x - centre.x) / radius;
        const float ny = (y - centre.y) / radius;
        const float rr = nx * nx + ny * ny;
        if (rr >= 1.0f) return Tint{Hex(0x173C8C)};
        const float nz = std::sqrt(1.0f - rr);
        const float lambert = Clamp01(nx * lx + ny * ly + nz * lz);
        const float longitude = std::atan2(nx, nz) + 0.7f;
        const float latitude = std::asin(Clamp(ny, -1.0f, 1.0f));
        Rgb ocean = Mix(Hex(0x10306E), Hex(0x3C8BE0), lambert);
        const float landNoise = Fbm(longitude * 1.6f + 11.0f, latitude * 2.4f + 3.0f, 5, seed);
        const float land = Smoothstep(0.53f, 0.56f, landNoise);
        const Rgb ground = Mix(Hex(0x2E6E4A), Hex(0xA8D878), lambert) *
                           (0.9f + 0.2f * Fbm(longitude * 6.0f, latitude * 6.0f, 3, seed + 9));
        Rgb color = Mix(ocean, ground, land);
        const float meridian = std::fabs(std::fmod(longitude / (kPi / 6.0f) + 100.0f, 1.0f) - 0.5f);
        const float parallel = std::fabs(std::fmod(latitude / (kPi / 6.0f) + 100.0f, 1.0f) - 0.5f);
        const float grid = Smoothstep(0.44f, 0.49f, std::max(meridian, parallel));
        color = Mix(color, Hex(0xDDF4FF), grid * 0.35f * nz);
        color = Mix(color, Hex(0x9CE8FF), Smoothstep(0.75f, 1.0f, std::sqrt(rr)) * 0.55f);
        return Tint{color};
    };
    FillSdf(
        canvas,
        [&](float x, float y) {
            return SdCircle({x, y}, centre, radius);
        },
        sphere, box);
    const Vec2 shine = centre + Vec2{-radius * 0.36f, -radius * 0.42f};
    FillSdf(
        canvas,
        [&](float x, float y) {
            return SdEllipse({x, y}, shine, {radius * 0.42f, radius * 0.26f});
        },
        [&](float, float y) {
            const float t = Clamp01((y - (shine.y - radius * 0.26f)) / (radius * 0.52f));
            return Tint{Hex(0xFFFFFF), 0.55f * (1.0f - t)};
        },
        box, 1.0f, Blend::Over, 3.0f);
    FillSdf(
        canvas, [&](float x, float y) { return ringFrame(x, y).y >= 0.0f ? ring(x, y) : 1e3f; },
        ringShader, box);
    const float starAngle = 2.3f;
    const Vec2 local = {ringRadii.x * std::cos(starAngle), ringRadii.y * std::sin(starAngle)};
    const Vec2 onRing = centre + Vec2{local.x * ca - local.y * sa, local.x * sa + local.y * ca};
    PaintSparkle(canvas, onRing, 7.0f, 1.0f, Hex(0xFFF4C8));
}

}  // namespace

Rgb SkyColor(const SkyLight& light, float x, float y) {
    static const std::vector<Stop> kStops = {
        {0.0f, Hex(0x1E2C6C)},  {0.3f, Hex(0x385CAA)}, {0.55f, Hex(0x7096D4)},
        {0.76f, Hex(0xB2BEE6)}, {0.9f, Hex(0xE8D2E0)}, {1.0f, Hex(0xFFDEC4)},
        {1.2f, Hex(0xFFE8CE)},
    };
    Rgb color = Gradient(kStops, y / light.horizon);
    const float d = Length(Vec2{x, y} - light.sun);
    const float wide = 0.45f * std::exp(-(d / 230.0f) * (d / 230.0f));
    const Rgb warm = Hex(0xFFD6A0);
    color = color + (Rgb{1.0f, 1.0f, 1.0f} - color) * warm * wide;
    return color;
}

void PaintSky(Canvas& canvas, const SkyLight& light) {
    PaintBox(canvas, canvas.Bounds(), [&](float x, float y) {
        Rgb color = SkyColor(light, x, y);
        const Vec2 d = Vec2{x, y} - light.sun;
        const float distance = Length(d);
        const float angle = std::atan2(d.y, d.x);
        const float wave = 0.5f + 0.5f * std::sin(angle * 9.0f + 0.6f * std::sin(angle * 23.0f));
        const float rays = std::pow(wave, 5.0f) * std::exp(-distance / 240.0f) *
                           Smoothstep(20.0f, 90.0f, distance) * 0.16f;
        color = color + (Rgb{1.0f, 1.0f, 1.0f} - color) * Hex(0xFFF0D8) * rays;
        return Tint{color};
    });
}

void PaintStars(Canvas& canvas, Box area, int count, uint32_t seed) {
    Random random(seed);
    for (int i = 0; i < count; ++i) {
        const Vec2 at = {random.Range(static_cast<float>(area.x0), static_cast<float>(area.x1)),
                         random.Range(static_cast<float>(area.y0), static_cast<float>(area.y1))};
        const float fade = std::pow(
            1.0f - (at.y - static_cast<float>(area.y0)) / static_cast<float>(area.y1 - area.y0),
            1.3f);
        const float brightness = random.Range(0.35f, 1.0f) * fade;
        const float size = random.Range(0.45f, 1.1f);
        if (i % 14 == 0) {
            PaintSparkle(canvas, at, 3.5f + 3.0f * brightness, brightness, Hex(0xFFF8E8));
            continue;
        }
        const Box box = {static_cast<int>(at.x) - 3, static_cast<int>(at.y) - 3,
                         static_cast<int>(at.x) + 4, static_cast<int>(at.y) + 4};
        FillSdf(
            canvas,
            [&](float x, float y) {
                return SdCircle({x, y}, at, size);
            },
            Mix(Hex(0xFFFFFF), Hex(0xFFE8B0), random.Unit() * 0.5f), box, brightness,
            Blend::Screen);
    }
}

void PaintSun(Canvas& canvas, const SkyLight& light, float radius) {
    const Vec2 sun = light.sun;
    PaintBox(
        canvas,
        Grow({static_cast<int>(sun.x), static_cast<int>(sun.y), static_cast<int>(sun.x),
              static_cast<int>(sun.y)},
             static_cast<int>(radius * 6.0f)),
        [&](float x, float y) {
            const float d = Length(Vec2{x, y} - sun) / radius;
            return Tint{Hex(0xFFF2D2),
                        0.8f * std::exp(-d * d * 0.35f) + 0.25f * std::exp(-d * 0.6f)};
        },
        Blend::Screen);
    FillSdf(
        canvas,
        [&](float x, float y) {
            return SdCircle({x, y}, sun, radius);
        },
        [&](float x, float y) {
            const float d = Length(Vec2{x, y} - sun) / radius;
            return Tint{Mix(Hex(0xFFFFFA), Hex(0xFFE9B0), d * d)};
        },
        Grow({static_cast<int>(sun.x), static_cast<int>(sun.y), static_cast<int>(sun.x),
              static_cast<int>(sun.y)},
             static_cast<int>(radius) + 3),
        1.0f, Blend::Over, 2.5f);
}

void PaintCirrus(Canvas& canvas, const SkyLight& light, Box area, uint32_t seed) {
    const float middle = static_cast<float>(area.y0 + area.y1) * 0.5f;
    const float half = static_cast<float>(area.y1 - area.y0) * 0.5f;
    PaintBox(
        canvas, area,
        [&](float x, float y) {
            const float band = 1.0f - Smoothstep(0.4f, 1.0f, std::fabs(y - middle) / half);
            const float n = Fbm(x * 0.0065f + y * 0.004f, y * 0.045f, 5, seed);
            const float streak = Smoothstep(0.52f, 0.78f, n) * band;
            const float warmth = Clamp01(1.0f - Length(Vec2{x, y} - light.sun) / 500.0f);
            return Tint{Mix(Hex(0xF4EEFF), Hex(0xFFD8DC), warmth), streak * 0.38f};
        },
        Blend::Screen);
}

void PaintCloudBank(Canvas& canvas, const SkyLight& light, const CloudBankLayout& layout) {
    Random random(layout.seed);
    std::vector<Puff> puffs;
    for (float x = layout.x0; x < layout.x1;) {
        const float t = (x - layout.x0) / (layout.x1 - layout.x0);
        const float bell = std::pow(std::sin(kPi * Clamp01(t)), 0.6f);
        const float r = Lerp(layout.minRadius, layout.maxRadius, bell * random.Range(0.4f, 1.0f));
        const float cy = layout.base - r * random.Range(0.25f, 0.8f);
        puffs.push_back({{x, cy}, r});
        if (bell > 0.5f && random.Unit() < 0.55f) {
            puffs.push_back({{x + random.Range(-0.3f, 0.3f) * r, cy - r * 0.75f}, r * 0.72f});
        }
        x += r * random.Range(0.6f, 0.95f);
    }
    std::stable_sort(puffs.begin(), puffs.end(),
                     [](const Puff& a, const Puff& b) { return a.centre.y < b.centre.y; });
    float top = layout.base;
    for (const Puff& puff : puffs) top = std::min(top, puff.centre.y - puff.radius);
    for (const Puff& puff : puffs) {
        PaintPuff(canvas, light, puff, layout.haze, top, layout.base, layout.flatBottom);
    }
}

void PaintCloudSea(Canvas& canvas, const SkyLight& light, int firstRow, int lastRow,
                   uint32_t seed) {
    if (firstRow == 0) {
        // A floor under the rows, so that no sky shows between puffs.
        const float top = light.horizon + 14.0f;
        PaintBox(canvas, {0, static_cast<int>(top) - 6, canvas.width, canvas.height},
                 [&](float x, float y) {
                     const Rgb color = Mix(SkyColor(light, x, y), Hex(0xF2ECF4),
                                           Smoothstep(top - 6.0f, top + 40.0f, y) * 0.6f);
                     return Tint{color, Smoothstep(top - 6.0f, top + 4.0f, y)};
                 });
    }
    float base = light.horizon + 16.0f;
    for (int row = 0; row <= lastRow; ++row) {
        const float k = static_cast<float>(row);
        CloudBankLayout layout;
        layout.x0 = -50.0f + 13.0f * static_cast<float>((row * 7) % 5);
        layout.x1 = static_cast<float>(canvas.width) + 60.0f;
        layout.base = base;
        layout.minRadius = 9.0f + 5.0f * k;
        layout.maxRadius = 18.0f + 9.0f * k;
        layout.haze = std::max(0.0f, 0.6f - 0.16f * k);
        layout.flatBottom = false;
        layout.seed = seed + static_cast<uint32_t>(row) * 7919u;
        if (row >= firstRow) PaintCloudBank(canvas, light, layout);
        base += 24.0f + 4.0f * k;
    }
}

void PaintIsland(Canvas& canvas, const SkyLight& light, const IslandLayout& layout) {
    Random random(layout.seed);
    const float cx = layout.top.x;
    const float ty = layout.top.y;
    const float hw = layout.halfWidth;
    const float d = layout.depth;
    const float s = hw / 60.0f;
    const Vec2 tip = {cx + hw * 0.12f, ty + d};
    std::vector<Vec2> outline = {{cx - hw, ty}};
    const int steps = 9;
    for (int i = 1; i < steps; ++i) {
        const float t = static_cast<float>(i) / static_cast<float>(steps);
        const float jag = random.Range(-0.07f, 0.07f) * hw * (1.0f - t);
        const float drop = (i % 2 == 0) ? d * 0.035f : 0.0f;
        outline.push_back({Lerp(cx - hw, tip.x, 1.0f - std::pow(1.0f - t, 1.4f)) + jag,
                           ty + d * t * 0.96f + drop});
    }
    outline.push_back(tip);
    for (int i = steps - 1; i >= 1; --i) {
        const float t = static_cast<float>(i) / static_cast<float>(steps);
        const float jag = random.Range(-0.07f, 0.07f) * hw * (1.0f - t);
        outline.push_back(
            {Lerp(cx + hw, tip.x, 1.0f - std::pow(1.0f - t, 1.2f)) + jag, ty + d * t * 0.9f});
    }
    outline.push_back({cx + hw, ty});
    const Box box = {static_cast<int>(cx - hw) - 4, static_cast<int>(ty - 60.0f * s) - 4,
                     static_cast<int>(cx + hw) + 5, static_cast<int>(ty + d) + 5};
    const float sunSide = light.sun.x >= cx ? 1.0f : -1.0f;
    auto haze = [&](Rgb color, float x, float y) {
        return Mix(color, SkyColor(light, x, y), layout.haze);
    };

    if (layout.waterfall) {
        const float wx = cx + hw * 0.48f;
        const float bottom = ty + d * 1.7f;
        const Box fall = {static_cast<int>(wx - 8.0f * s) - 2, static_cast<int>(ty),
                          static_cast<int>(wx + 8.0f * s) + 3, static_cast<int>(bottom) + 2};
        FillSdf(
            canvas,
            [&](float x, float y) {
                const float widen = 1.0f + (y - ty) / (bottom - ty) * 0.8f;
                return std::fabs(x - wx) - 3.2f * s * widen;
            },
            [&](float x, float y) {
                const float streak = Fbm(x * 0.9f, y * 0.07f - 3.0f, 3, layout.seed + 5);
                const float fade = 1.0f - Smoothstep(bottom - d * 0.6f, bottom, y);
                const float across = Clamp01(std::fabs(x - wx) / (4.0f * s));
                const Rgb water = Mix(Mix(Hex(0x8CCBF2), Hex(0xFFFFFF), streak), Hex(0x6FA8E0),
                                      across * across * 0.6f);
                return Tint{haze(water, x, y), (0.7f + 0.3f * streak) * fade};
            },
            fall);
    }

    FillSdf(
        canvas,
        [&](float x, float y) {
            return SdPolygon({x, y}, outline);
        },
        [&](float x, float y) {
            const float t = Clamp01((y - ty) / d);
            Rgb color = Mix(Hex(0xC8977F), Hex(0x54467A), Smoothstep(0.0f, 1.0f, t));
            const float strata = std::sin((y + 3.0f * std::sin(x * 0.09f)) * 0.85f / s);
            color = color * (1.0f - 0.1f * Smoothstep(0.5f, 0.9f, strata));
            const float side = Clamp01((x - cx) / hw * sunSide);
            color = Mix(color, Hex(0xF6C89E), side * 0.45f * (1.0f - t));
            return Tint{haze(color, x, y)};
        },
        box);

    const Vec2 grassRadii = {hw * 1.03f, hw * 0.16f + 2.0f};
    FillSdf(
        canvas,
        [&](float x, float y) {
            return SdEllipse({x, y}, layout.top, grassRadii);
        },
        [&](float x, float y) {
            const float t = Clamp01((y - (ty - grassRadii.y)) / (2.0f * grassRadii.y));
            Rgb color = Mix(Hex(0xB4E07E), Hex(0x4E9A5C), t);
            color = Mix(color, Hex(0xE0F0A0), Clamp01((x - cx) / hw * sunSide) * 0.3f);
            return Tint{haze(color, x, y)};
        },
        box);

    for (int i = 0; i < layout.trees; ++i) {
        const float x = cx + hw * (i % 2 == 0 ? 0.28f + 0.2f * static_cast<float>(i / 2)
                                              : -0.05f - 0.22f * static_cast<float>(i / 2));
        const float size = s * random.Range(0.8f, 1.15f);
        const float ground = ty + random.Range(-1.0f, 2.0f) * s;
        FillSdf(
            canvas,
            [&](float px, float py) {
                return SdRoundBox({px, py}, {x, ground - 5.0f * size}, {1.4f * size, 5.0f * size},
                                  0.8f);
            },
            haze(Hex(0x6A4A3A), x, ground), box);
        const Vec2 crown = {x, ground - 13.0f * size};
        FillSdf(
            canvas,
            [&](float px, float py) {
                const Vec2 p = {px, py};
                const float a = SdCircle(p, crown, 6.5f * size);
                const float b = SdCircle(p, crown + Vec2{-4.5f * size, 3.5f * size}, 4.8f * size);
                const float c = SdCircle(p, crown + Vec2{4.5f * size, 3.5f * size}, 4.8f * size);
                return SmoothMin(SmoothMin(a, b, 2.0f), c, 2.0f);
            },
            [&](float px, float py) {
                const Vec2 n = Normalised(Vec2{px, py} - crown);
                const float lit = Clamp01(n.x * sunSide * 0.7f - n.y * 0.7f);
                return Tint{haze(Mix(Hex(0x2E7450), Hex(0x9CD884), lit), px, py)};
            },
            box);
    }

    if (layout.tower) {
        const float tx = cx - hw * 0.36f;
        const float base = ty + 1.0f;
        const float top = base - 30.0f * s;
        FillSdf(
            canvas,
            [&](float x, float y) {
                const float halfWidth = Lerp(4.2f, 5.8f, Clamp01((y - top) / (base - top))) * s;
                return std::max(std::fabs(x - tx) - halfWidth, std::max(top - y, y - base));
            },
            [&](float x, float y) {
                const float side = Clamp01((x - tx) / (6.0f * s) * sunSide * 0.5f + 0.5f);
                return Tint{haze(Mix(Hex(0xB9B4CF), Hex(0xFFF8EC), side), x, y)};
            },
            box);
        const std::vector<Vec2> roof = {
            {tx, top - 14.0f * s}, {tx + 8.0f * s, top + 1.0f}, {tx - 8.0f * s, top + 1.0f}};
        FillSdf(
            canvas,
            [&](float x, float y) {
                return SdPolygon({x, y}, roof);
            },
            [&](float x, float y) {
                const float side = Clamp01((x - tx) / (8.0f * s) * sunSide * 0.5f + 0.5f);
                return Tint{haze(Mix(Hex(0x2C4C9C), Hex(0x6C96E6), side), x, y)};
            },
            box);
        const Vec2 window = {tx, top + 10.0f * s};
        FillSdf(
            canvas,
            [&](float x, float y) {
                return SdRoundBox({x, y}, window, {1.6f * s, 3.0f * s}, 1.5f * s);
            },
            Hex(0xFFD466), box);
        PaintSparkle(canvas, {tx, top - 16.0f * s}, 6.0f * s, 1.0f - layout.haze, Hex(0xFFE6A0));
    }
}

void PaintBirds(Canvas& canvas, Vec2 at, float scale, uint32_t seed) {
    Random random(seed);
    const Vec2 offsets[] = {{0.0f, 0.0f}, {16.0f, 7.0f}, {-13.0f, 10.0f}};
    for (const Vec2& offset : offsets) {
        const Vec2 c = at + offset * scale;
        const float span = scale * random.Range(5.0f, 6.5f);
        const float lift = random.Range(1.5f, 3.0f) * scale;
        const Box box = {static_cast<int>(c.x - span) - 2, static_cast<int>(c.y - span) - 2,
                         static_cast<int>(c.x + span) + 3, static_cast<int>(c.y + span) + 3};
        FillSdf(
            canvas,
            [&](float x, float y) {
                const Vec2 p = {x, y};
                const Vec2 middle = c + Vec2{0.0f, 1.2f * scale};
                const float left = SdSegment(p, c + Vec2{-span, -lift}, middle, 0.55f * scale);
                const float right =
                    SdSegment(p, middle, c + Vec2{span, -lift * 1.2f}, 0.55f * scale);
                return std::min(left, right);
            },
            Hex(0x3A426E), box, 0.7f);
    }
}

void PaintLogo(Canvas& canvas, const FontLibrary& fonts, Vec2 at, float scale) {
    TextStyle vemoStyle;
    vemoStyle.fillTop = Hex(0xFFF6A8);
    vemoStyle.fillBottom = Hex(0xF89A28);
    vemoStyle.outline = Hex(0x181C54);
    vemoStyle.outlineWidth = 3.6f * scale;
    vemoStyle.shadow = Hex(0x0A0C30);
    vemoStyle.shadowAlpha = 0.55f;
    vemoStyle.shadowBlur = 3.0f * scale;
    vemoStyle.shadowOffset = {2.0f * scale, 4.0f * scale};
    vemoStyle.glow = Hex(0xFFE6A6);
    vemoStyle.glowAlpha = 0.3f;
    vemoStyle.glowRadius = 10.0f * scale;
    vemoStyle.sheen = 0.3f;

    TextStyle smallStyle = vemoStyle;
    smallStyle.fillTop = Hex(0xFFFFFF);
    smallStyle.fillBottom = Hex(0xC4E0FF);
    smallStyle.outlineWidth = 2.6f * scale;
    smallStyle.shadowOffset = {1.0f * scale, 2.0f * scale};
    smallStyle.shadowBlur = 2.0f * scale;
    smallStyle.glowAlpha = 0.15f;
    smallStyle.sheen = 0.0f;

    const TextMask the = fonts.Render(Face::ComicBold, "The", 27.0f * scale, 0.5f * scale, 24);
    const TextMask vemo = fonts.Render(Face::ComicBold, "Vemo", 74.0f * scale, 1.0f * scale, 30);
    const TextMask title =
        fonts.Render(Face::ComicBold, "Vodizuri Virezazida", 23.5f * scale, 0.6f * scale, 24);
    DrawText(canvas, the, at.x + 5.0f * scale, at.y + 24.0f * scale, smallStyle);
    DrawText(canvas, vemo, at.x, at.y + 80.0f * scale, vemoStyle);
    DrawText(canvas, title, at.x + 4.0f * scale, at.y + 106.0f * scale, smallStyle);
    const float vemoRight = at.x + static_cast<float>(vemo.ink.x1 - vemo.originX) + 4.0f * scale;
    PaintSparkle(canvas, {vemoRight, at.y + 30.0f * scale}, 9.0f * scale, 1.0f, Hex(0xFFF6D0));
    PaintSparkle(canvas, {vemoRight + 14.0f * scale, at.y + 46.0f * scale}, 4.5f * scale, 0.9f,
                 Hex(0xFFF6D0));
}

Canvas PaintMainScene(const FontLibrary& fonts) {
    Canvas canvas(kWidth, kHeight, Rgb{});
    SkyLight light;
    light.sun = {480.0f, 298.0f};
    light.horizon = 332.0f;
    PaintSky(canvas, light);
    PaintStars(canvas, {0, 0, kWidth, 175}, 120, 2024);
    PaintCirrus(canvas, light, {0, 120, kWidth, 215}, 31);
    PaintSun(canvas, light, 19.0f);

    IslandLayout far;
    far.top = {352.0f, 120.0f};
    far.halfWidth = 20.0f;
    far.depth = 26.0f;
    far.haze = 0.62f;
    far.trees = 1;
    far.seed = 5;
    PaintIsland(canvas, light, far);
    far.top = {602.0f, 196.0f};
    far.halfWidth = 15.0f;
    far.depth = 20.0f;
    far.haze = 0.55f;
    far.seed = 6;
    PaintIsland(canvas, light, far);
    PaintBirds(canvas, {468.0f, 132.0f}, 1.0f, 3);

    CloudBankLayout bank;
    bank.x0 = 420.0f;
    bank.x1 = 560.0f;
    bank.base = 88.0f;
    bank.minRadius = 6.0f;
    bank.maxRadius = 14.0f;
    bank.haze = 0.55f;
    bank.seed = 17;
    PaintCloudBank(canvas, light, bank);
    bank.x0 = 452.0f;
    bank.x1 = 700.0f;
    bank.base = 262.0f;
    bank.minRadius = 9.0f;
    bank.maxRadius = 24.0f;
    bank.haze = 0.35f;
    bank.seed = 23;
    PaintCloudBank(canvas, light, bank);
    // The Install caption is written across this bank, so its top stays above the caption.
    bank.x0 = -50.0f;
    bank.x1 = 225.0f;
    bank.base = 254.0f;
    bank.minRadius = 26.0f;
    bank.maxRadius = 36.0f;
    bank.haze = 0.25f;
    bank.seed = 41;
    PaintCloudBank(canvas, light, bank);

    IslandLayout left;
    left.top = {50.0f, 300.0f};
    left.halfWidth = 22.0f;
    left.depth = 30.0f;
    left.haze = 0.45f;
    left.trees = 2;
    left.seed = 8;
    PaintIsland(canvas, light, left);

    PaintCloudSea(canvas, light, 0, 3, 97);
    IslandLayout home;
    home.top = {568.0f, 328.0f};
    home.halfWidth = 56.0f;
    home.depth = 82.0f;
    home.tower = true;
    home.waterfall = true;
    home.trees = 3;
    home.seed = 12;
    PaintIsland(canvas, light, home);
    PaintCloudSea(canvas, light, 4, 6, 97);

    PaintLogo(canvas, fonts, {16.0f, 6.0f}, 1.0f);
    return canvas;
}

Canvas PaintLanguageListScene(const FontLibrary& fonts) {
    Canvas canvas(kWidth, kHeight, Rgb{});
    SkyLight light;
    light.sun = {596.0f, 372.0f};
    light.horizon = 398.0f;
    PaintSky(canvas, light);
    PaintStars(canvas, {0, 0, kWidth, 200}, 130, 77);
    PaintCirrus(canvas, light, {0, 150, kWidth, 300}, 13);
    PaintSun(canvas, light, 17.0f);
    CloudBankLayout bank;
    bank.x0 = 500.0f;
    bank.x1 = 700.0f;
    bank.base = 330.0f;
    bank.minRadius = 8.0f;
    bank.maxRadius = 22.0f;
    bank.haze = 0.35f;
    bank.seed = 19;
    PaintCloudBank(canvas, light, bank);
    PaintCloudSea(canvas, light, 0, 5, 211);
    PaintGlobe(canvas, {580.0f, 196.0f}, 44.0f, 4);

    TextStyle wordmark;
    wordmark.fillTop = Hex(0xFFF6A8);
    wordmark.fillBottom = Hex(0xF8A030);
    wordmark.outline = Hex(0x181C54);
    wordmark.outlineWidth = 2.4f;
    wordmark.shadow = Hex(0x0A0C30);
    wordmark.shadowAlpha = 0.5f;
    wordmark.shadowBlur = 2.0f;
    wordmark.shadowOffset = {1.0f, 2.0f};
    const TextMask brand =
        fonts.Render(Face::ComicBold, "The Vemo Vodizuri Virezazida", 21.0f, 0.5f, 20);
    DrawText(canvas, brand, CentredPenX(brand, 298.0f), 32.0f, wordmark);

    const std::vector<TextSpan> invite = {{Face::ComicBold, "Choose your language"}};
    const TextMask title = fonts.Render(invite, 34.0f, 0.4f, 24);
    DrawText(canvas, title, CentredPenX(title, 298.0f), 76.0f, GreetingStyle());

    // "Language" in the languages of the lists, quietly under the plates.
    TextStyle quiet;
    quiet.fillTop = Hex(0x2A347C);
    quiet.fillBottom = Hex(0x1C2464);
    quiet.glow = Hex(0xFFFFFF);
    quiet.glowAlpha = 0.55f;
    quiet.glowRadius = 5.0f;
    const std::vector<TextSpan> latin = {
        {Face::ComicBold,
         "Language \xC2\xB7 Langue \xC2\xB7 Sprache \xC2\xB7 Spr\xC3\xA5k \xC2\xB7 Taal \xC2\xB7 "
         "Idioma \xC2\xB7 Lingua \xC2\xB7 J\xC4\x99zyk \xC2\xB7 Kieli \xC2\xB7 Sprog"}};
    const std::vector<TextSpan> eastern = {
        {Face::TraditionalChinese, "\xE8\xAA\x9E\xE8\xA8\x80"},
        {Face::ComicBold, "  \xC2\xB7  "},
        {Face::SimplifiedChinese, "\xE8\xAF\xAD\xE8\xA8\x80"},
        {Face::ComicBold, "  \xC2\xB7  "},
        {Face::Thai, "\xE0\xB8\xA0\xE0\xB8\xB2\xE0\xB8\xA9\xE0\xB8\xB2"},
        {Face::ComicBold, "  \xC2\xB7  "},
        {Face::Korean, "\xEC\x96\xB8\xEC\x96\xB4"},
        {Face::ComicBold, "  \xC2\xB7  "},
        {Face::Japanese, "\xE8\xA8\x80\xE8\xAA\x9E"},
    };
    const TextMask latinLine = fonts.Render(latin, fonts.FitSize(latin, 16.0f, 520.0f, 0.2f), 0.2f);
    const TextMask easternLine = fonts.Render(eastern, 15.0f, 0.0f);
    DrawText(canvas, latinLine, CentredPenX(latinLine, 298.0f), 436.0f, quiet);
    DrawText(canvas, easternLine, CentredPenX(easternLine, 298.0f), 461.0f, quiet);
    return canvas;
}

const std::vector<BackgroundLanguage>& BackgroundLanguages() {
    static const std::vector<BackgroundLanguage> kLanguages = {
        {"AutoPlayBack.bmp", Face::ComicBold, "Welcome"},
        {"AutoPlayBackFr.bmp", Face::ComicBold, "Bienvenue"},
        {"AutoPlayBackDe.bmp", Face::ComicBold, "Willkommen"},
        {"AutoPlayBackSw.bmp", Face::ComicBold, "V\xC3\xA4lkommen"},
        {"AutoPlayBackDu.bmp", Face::ComicBold, "Welkom"},
        {"AutoPlayBackPr.bmp", Face::ComicBold, "Bem-vindo"},
        {"AutoPlayBackSp.bmp", Face::ComicBold, "Bienvenido"},
        {"AutoPlayBackIt.bmp", Face::ComicBold, "Benvenuto"},
        {"AutoPlayBackPo.bmp", Face::ComicBold, "Witamy"},
        {"AutoPlayBackJp.bmp", Face::Japanese, "\xE3\x82\x88\xE3\x81\x86\xE3\x81\x93\xE3\x81\x9D"},
        {"AutoPlayBackTC.bmp", Face::TraditionalChinese, "\xE6\xAD\xA1\xE8\xBF\x8E"},
        {"AutoPlayBackSC.bmp", Face::SimplifiedChinese, "\xE6\xAC\xA2\xE8\xBF\x8E"},
        {"AutoPlayBackTh.bmp", Face::Thai,
         "\xE0\xB8\xA2\xE0\xB8\xB4\xE0\xB8\x99\xE0\xB8\x94\xE0\xB8\xB5\xE0\xB8\x95\xE0\xB9\x89"
         "\xE0\xB8\xAD\xE0\xB8\x99\xE0\xB8\xA3\xE0\xB8\xB1\xE0\xB8\x9A"},
        {"AutoPlayBackKo.bmp", Face::Korean,
         "\xED\x99\x98\xEC\x98\x81\xED\x95\xA9\xEB\x8B\x88\xEB\x8B\xA4"},
        {"AutoPlayBackUk.bmp", Face::ComicBold, "Welcome"},
        {"AutoPlayBackNO.bmp", Face::ComicBold, "Velkommen"},
        {"AutoPlayBackFI.bmp", Face::ComicBold, "Tervetuloa"},
        {"AutoPlayBackDN.bmp", Face::ComicBold, "Velkommen"},
    };
    return kLanguages;
}

const std::vector<Box>& LanguageNeutralBoxes() {
    static const std::vector<Box> kBoxes = [] {
        struct Rect {
            int x, y, w, h;
        };
        const Rect rects[] = {
            {9, 346, 162, 117},  {186, 162, 85, 96}, {330, 268, 73, 79},  {272, 225, 66, 67},
            {372, 323, 73, 87},  {405, 411, 54, 54}, {271, 55, 240, 149}, {403, 67, 237, 256},
            {403, 54, 237, 252}, {295, 19, 209, 49}, {295, 71, 209, 49},  {295, 123, 209, 49},
            {416, 28, 209, 49},  {416, 81, 209, 49}, {416, 133, 209, 49}, {416, 185, 209, 49},
            {416, 29, 209, 49},
        };
        std::vector<Box> boxes;
        for (const Rect& r : rects) boxes.push_back({r.x, r.y, r.x + r.w, r.y + r.h});
        // Captions end at these points and reach up to some 170 pixels to the left.
        const int captionEnds[][2] = {{187, 237}, {262, 278}, {329, 332}, {370, 391}, {398, 443}};
        for (const auto& end : captionEnds) {
            boxes.push_back({end[0] - 176, end[1] - 24, end[0] + 2, end[1] + 2});
        }
        return boxes;
    }();
    return kBoxes;
}

Canvas PaintLanguageBackground(const Canvas& base, const FontLibrary& fonts,
                               const BackgroundLanguage& language) {
    const std::vector<TextSpan> spans = {{language.face, language.greeting}};
    float size = fonts.FitSize(spans, 36.0f, 236.0f, 0.3f);
    TextMask text = fonts.Render(spans, size, 0.3f, 20);
    // Keep the greeting between the logo and the Install button whatever its script's height.
    const float maxInk = 40.0f;
    const float inkHeight = static_cast<float>(text.ink.y1 - text.ink.y0);
    if (inkHeight > maxInk) {
        size *= maxInk / inkHeight;
        text = fonts.Render(spans, size, 0.3f, 20);
    }
    float baseline = 150.0f;
    const float inkBottom = baseline + static_cast<float>(text.ink.y1 - text.baseline);
    if (inkBottom > 158.0f) baseline -= inkBottom - 158.0f;
    Canvas layer(base.width, base.height);
    DrawText(layer, text, 22.0f, baseline, GreetingStyle());
    std::vector<Box> keepOut;
    for (const Box& box : LanguageNeutralBoxes()) keepOut.push_back(Grow(box, 1));
    ClearBoxes(layer, keepOut);
    Canvas result = base;
    DrawLayer(result, layer, 0, 0);
    return result;
}

}  // namespace discart
