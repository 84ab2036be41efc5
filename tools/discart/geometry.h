#pragma once

#include <algorithm>
#include <cmath>
#include <vector>

namespace discart {

constexpr float kPi = 3.14159265358979f;

struct Vec2 {
    float x = 0.0f;
    float y = 0.0f;
};

inline Vec2 operator+(Vec2 a, Vec2 b) {
    return {a.x + b.x, a.y + b.y};
}
inline Vec2 operator-(Vec2 a, Vec2 b) {
    return {a.x - b.x, a.y - b.y};
}
inline Vec2 operator*(Vec2 a, float s) {
    return {a.x * s, a.y * s};
}
inline float Dot(Vec2 a, Vec2 b) {
    return a.x * b.x + a.y * b.y;
}
inline float Length(Vec2 a) {
    return std::sqrt(Dot(a, a));
}

inline float Clamp(float v, float lo, float hi) {
    return std::min(hi, std::max(lo, v));
}
inline float Clamp01(float v) {
    return Clamp(v, 0.0f, 1.0f);
}
inline float Lerp(float a, float b, float t) {
    return a + (b - a) * t;
}

inline float Smoothstep(float edge0, float edge1, float x) {
    const float t = Clamp01((x - edge0) / (edge1 - edge0));
    return t * t * (3.0f - 2.0f * t);
}

// Polynomial smooth minimum: unions that melt into each other over k pixels.
inline float SmoothMin(float a, float b, float k) {
    const float h = Clamp01(0.5f + 0.5f * (b - a) / k);
    return Lerp(b, a, h) - k * h * (1.0f - h);
}

inline float SdCircle(Vec2 p, Vec2 centre, float radius) {
    return Length(p - centre) - radius;
}

// Box given by its centre and half extents, corners rounded by radius.
inline float SdRoundBox(Vec2 p, Vec2 centre, Vec2 half, float radius) {
    const float qx = std::fabs(p.x - centre.x) - half.x + radius;
    const float qy = std::fabs(p.y - centre.y) - half.y + radius;
    const float outside = Length({std::max(qx, 0.0f), std::max(qy, 0.0f)});
    return outside + std::min(std::max(qx, qy), 0.0f) - radius;
}

// Capsule around the segment a-b.
inline float SdSegment(Vec2 p, Vec2 a, Vec2 b, float halfWidth) {
    const Vec2 pa = p - a;
    const Vec2 ba = b - a;
    const float h = Clamp01(Dot(pa, ba) / Dot(ba, ba));
    return Length(pa - ba * h) - halfWidth;
}

inline float SdRing(Vec2 p, Vec2 centre, float radius, float halfWidth) {
    return std::fabs(Length(p - centre) - radius) - halfWidth;
}

// Exact distance to a simple polygon (even-odd inside test).
inline float SdPolygon(Vec2 p, const std::vector<Vec2>& points) {
    float distance = Dot(p - points[0], p - points[0]);
    float sign = 1.0f;
    const size_t n = points.size();
    for (size_t i = 0, j = n - 1; i < n; j = i, ++i) {
        const Vec2 e = points[j] - points[i];
        const Vec2 w = p - points[i];
        const Vec2 b = w - e * Clamp01(Dot(w, e) / Dot(e, e));
        distance = std::min(distance, Dot(b, b));
        const bool c0 = p.y >= points[i].y;
        const bool c1 = p.y < points[j].y;
        const bool c2 = e.x * w.y > e.y * w.x;
        if ((c0 && c1 && c2) || (!c0 && !c1 && !c2)) sign = -sign;
    }
    return sign * std::sqrt(distance);
}

// Ellipse distance, close enough for anti-aliasing when the axes are not too unequal.
inline float SdEllipse(Vec2 p, Vec2 centre, Vec2 radii) {
    const Vec2 q = {(p.x - centre.x) / radii.x, (p.y - centre.y) / radii.y};
    const float k = Length(q);
    const Vec2 gradient = {q.x / radii.x, q.y / radii.y};
    const float g = Length(gradient);
    return g > 0.0f ? (k - 1.0f) * k / g : -std::min(radii.x, radii.y);
}

inline std::vector<Vec2> StarPoints(Vec2 centre, float outer, float inner, int points,
                                    float rotation) {
    std::vector<Vec2> result;
    for (int i = 0; i < points * 2; ++i) {
        const float angle = rotation + kPi * static_cast<float>(i) / static_cast<float>(points);
        const float r = (i % 2 == 0) ? outer : inner;
        result.push_back({centre.x + r * std::sin(angle), centre.y - r * std::cos(angle)});
    }
    return result;
}

}  // namespace discart
