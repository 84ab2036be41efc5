#pragma once

#include <cstdint>
#include <functional>
#include <vector>

namespace discart {

struct Rgb {
    float r = 0.0f;
    float g = 0.0f;
    float b = 0.0f;
};

inline Rgb operator+(Rgb a, Rgb b) {
    return {a.r + b.r, a.g + b.g, a.b + b.b};
}
inline Rgb operator-(Rgb a, Rgb b) {
    return {a.r - b.r, a.g - b.g, a.b - b.b};
}
inline Rgb operator*(Rgb a, float s) {
    return {a.r * s, a.g * s, a.b * s};
}
inline Rgb operator*(Rgb a, Rgb b) {
    return {a.r * b.r, a.g * b.g, a.b * b.b};
}
inline Rgb Mix(Rgb a, Rgb b, float t) {
    return a + (b - a) * t;
}
inline Rgb Lighten(Rgb c, float amount) {
    return Mix(c, Rgb{1.0f, 1.0f, 1.0f}, amount);
}

constexpr Rgb Hex(uint32_t rgb) {
    return {static_cast<float>((rgb >> 16) & 0xFF) / 255.0f,
            static_cast<float>((rgb >> 8) & 0xFF) / 255.0f,
            static_cast<float>(rgb & 0xFF) / 255.0f};
}

float Luma(Rgb c);

// A colour with the opacity it is laid down with (not premultiplied).
struct Tint {
    Rgb color;
    float alpha = 1.0f;
};

// Premultiplied colour, as stored in a canvas.
struct Rgba {
    float r = 0.0f;
    float g = 0.0f;
    float b = 0.0f;
    float a = 0.0f;
};

enum class Blend { Over, Add, Screen, Multiply };

// Pixel bounds, half open: x0 <= x < x1.
struct Box {
    int x0 = 0;
    int y0 = 0;
    int x1 = 0;
    int y1 = 0;
};

Box Grow(Box box, int margin);

// Float coverage values in 0..1, row-major.
struct Mask {
    int width = 0;
    int height = 0;
    std::vector<float> values;

    Mask() = default;
    Mask(int w, int h) : width(w), height(h), values(static_cast<size_t>(w) * h, 0.0f) {}
    float& At(int x, int y) { return values[static_cast<size_t>(y) * width + x]; }
    float At(int x, int y) const { return values[static_cast<size_t>(y) * width + x]; }
    float Sample(int x, int y) const {
        return x < 0 || y < 0 || x >= width || y >= height ? 0.0f : At(x, y);
    }
};

// A picture under construction: premultiplied float colour, so that transparent layers (button
// faces) and opaque scenes share every drawing operation.
struct Canvas {
    int width = 0;
    int height = 0;
    std::vector<Rgba> pixels;

    Canvas() = default;
    Canvas(int w, int h) : width(w), height(h), pixels(static_cast<size_t>(w) * h) {}
    Canvas(int w, int h, Rgb fill);
    Rgba& At(int x, int y) { return pixels[static_cast<size_t>(y) * width + x]; }
    const Rgba& At(int x, int y) const { return pixels[static_cast<size_t>(y) * width + x]; }
    Box Bounds() const { return {0, 0, width, height}; }
    Rgb ColorAt(int x, int y) const;
};

// Signed distance in pixels (negative inside) at a pixel-centre position.
using Sdf = std::function<float(float x, float y)>;
using Shader = std::function<Tint(float x, float y)>;

Shader Solid(Rgb color, float alpha = 1.0f);
Shader VerticalGradient(float y0, Rgb top, float y1, Rgb bottom);

void LayDown(Rgba& dst, Rgb color, float alpha, Blend mode);

// Fills the inside of a distance field; edgeWidth widens the anti-aliased rim for soft shapes.
void FillSdf(Canvas& canvas, const Sdf& sdf, const Shader& shader, Box box, float opacity = 1.0f,
             Blend mode = Blend::Over, float edgeWidth = 1.0f);
void FillSdf(Canvas& canvas, const Sdf& sdf, Rgb color, Box box, float opacity = 1.0f,
             Blend mode = Blend::Over, float edgeWidth = 1.0f);

// Paints a shader everywhere in the box, weighted by a mask placed at (ox, oy).
void PaintMask(Canvas& canvas, const Mask& mask, int ox, int oy, const Shader& shader,
               float opacity = 1.0f, Blend mode = Blend::Over);
void PaintMask(Canvas& canvas, const Mask& mask, int ox, int oy, Rgb color, float opacity = 1.0f,
               Blend mode = Blend::Over);

// Paints a shader over a box with its own per-pixel alpha.
void PaintBox(Canvas& canvas, Box box, const Shader& shader, Blend mode = Blend::Over);

Mask MaskFromSdf(int width, int height, const Sdf& sdf, float edgeWidth = 1.0f);
Mask AlphaOf(const Canvas& canvas);
void Blur(Mask& mask, float radius);
Mask Dilate(const Mask& mask, float radius);
void MultiplyMask(Mask& mask, const Mask& by);

// Composites a whole layer at (ox, oy).
void DrawLayer(Canvas& dst, const Canvas& layer, int ox, int oy, float opacity = 1.0f);
// Removes a layer's coverage inside the given boxes (places other pictures are drawn over).
void ClearBoxes(Canvas& layer, const std::vector<Box>& boxes);
// Multiplies the colours of every pixel (premultiplied alpha is kept).
void Darken(Canvas& canvas, float factor);

Canvas Crop(const Canvas& canvas, Box box);
Canvas Downsample(const Canvas& canvas, int factor);

}  // namespace discart
