#include "canvas.h"

#include <algorithm>
#include <cmath>

namespace discart {

namespace {

float Clamp01(float v) {
    return std::min(1.0f, std::max(0.0f, v));
}

Box Clip(Box box, int width, int height) {
    return {std::max(0, box.x0), std::max(0, box.y0), std::min(width, box.x1),
            std::min(height, box.y1)};
}

// One pass of a running box filter along rows or columns, edges clamped.
void BoxPass(std::vector<float>& values, int width, int height, int radius, bool alongRows) {
    const int length = alongRows ? width : height;
    const int lines = alongRows ? height : width;
    std::vector<float> line(static_cast<size_t>(length));
    const float scale = 1.0f / static_cast<float>(2 * radius + 1);
    for (int l = 0; l < lines; ++l) {
        auto index = [&](int i) {
            return alongRows ? static_cast<size_t>(l) * width + i
                             : static_cast<size_t>(i) * width + l;
        };
        for (int i = 0; i < length; ++i) line[i] = values[index(i)];
        auto sample = [&](int i) { return line[std::min(length - 1, std::max(0, i))]; };
        float sum = 0.0f;
        for (int i = -radius; i <= radius; ++i) sum += sample(i);
        for (int i = 0; i < length; ++i) {
            values[index(i)] = sum * scale;
            sum += sample(i + radius + 1) - sample(i - radius);
        }
    }
}

}  // namespace

float Luma(Rgb c) {
    return 0.2126f * c.r + 0.7152f * c.g + 0.0722f * c.b;
}

Box Grow(Box box, int margin) {
    return {box.x0 - margin, box.y0 - margin, box.x1 + margin, box.y1 + margin};
}

Canvas::Canvas(int w, int h, Rgb fill)
    : width(w), height(h), pixels(static_cast<size_t>(w) * h, Rgba{fill.r, fill.g, fill.b, 1.0f}) {}

Rgb Canvas::ColorAt(int x, int y) const {
    const Rgba& p = At(x, y);
    if (p.a <= 0.0f) return {};
    return {p.r / p.a, p.g / p.a, p.b / p.a};
}

Shader Solid(Rgb color, float alpha) {
    return [color, alpha](float, float) { return Tint{color, alpha}; };
}

Shader VerticalGradient(float y0, Rgb top, float y1, Rgb bottom) {
    return [=](float, float y) { return Tint{Mix(top, bottom, Clamp01((y - y0) / (y1 - y0)))}; };
}

void LayDown(Rgba& dst, Rgb color, float alpha, Blend mode) {
    if (alpha <= 0.0f) return;
    alpha = std::min(alpha, 1.0f);
    switch (mode) {
        case Blend::Over:
            dst.r = color.r * alpha + dst.r * (1.0f - alpha);
            dst.g = color.g * alpha + dst.g * (1.0f - alpha);
            dst.b = color.b * alpha + dst.b * (1.0f - alpha);
            dst.a = alpha + dst.a * (1.0f - alpha);
            break;
        case Blend::Add:
            dst.r += color.r * alpha * dst.a;
            dst.g += color.g * alpha * dst.a;
            dst.b += color.b * alpha * dst.a;
            break;
        case Blend::Screen:
            // Screening lightens what is there without adding coverage of its own.
            dst.r += (dst.a - dst.r) * color.r * alpha;
            dst.g += (dst.a - dst.g) * color.g * alpha;
            dst.b += (dst.a - dst.b) * color.b * alpha;
            break;
        case Blend::Multiply:
            dst.r *= 1.0f - alpha + color.r * alpha;
            dst.g *= 1.0f - alpha + color.g * alpha;
            dst.b *= 1.0f - alpha + color.b * alpha;
            break;
    }
}

void FillSdf(Canvas& canvas, const Sdf& sdf, const Shader& shader, Box box, float opacity,
             Blend mode, float edgeWidth) {
    box = Clip(box, canvas.width, canvas.height);
    for (int y = box.y0; y < box.y1; ++y) {
        for (int x = box.x0; x < box.x1; ++x) {
            const float px = static_cast<float>(x) + 0.5f;
            const float py = static_cast<float>(y) + 0.5f;
            const float coverage = Clamp01(0.5f - sdf(px, py) / edgeWidth);
            if (coverage <= 0.0f) continue;
            const Tint tint = shader(px, py);
            LayDown(canvas.At(x, y), tint.color, tint.alpha * coverage * opacity, mode);
        }
    }
}

void FillSdf(Canvas& canvas, const Sdf& sdf, Rgb color, Box box, float opacity, Blend mode,
             float edgeWidth) {
    FillSdf(canvas, sdf, Solid(color), box, opacity, mode, edgeWidth);
}

void PaintMask(Canvas& canvas, const Mask& mask, int ox, int oy, const Shader& shader,
               float opacity, Blend mode) {
    const Box box = Clip({ox, oy, ox + mask.width, oy + mask.height}, canvas.width, canvas.height);
    for (int y = box.y0; y < box.y1; ++y) {
        for (int x = box.x0; x < box.x1; ++x) {
            const float coverage = mask.At(x - ox, y - oy);
            if (coverage <= 0.0f) continue;
            const Tint tint = shader(static_cast<float>(x) + 0.5f, static_cast<float>(y) + 0.5f);
            LayDown(canvas.At(x, y), tint.color, tint.alpha * coverage * opacity, mode);
        }
    }
}

void PaintMask(Canvas& canvas, const Mask& mask, int ox, int oy, Rgb color, float opacity,
               Blend mode) {
    PaintMask(canvas, mask, ox, oy, Solid(color), opacity, mode);
}

void PaintBox(Canvas& canvas, Box box, const Shader& shader, Blend mode) {
    box = Clip(box, canvas.width, canvas.height);
    for (int y = box.y0; y < box.y1; ++y) {
        for (int x = box.x0; x < box.x1; ++x) {
            const Tint tint = shader(static_cast<float>(x) + 0.5f, static_cast<float>(y) + 0.5f);
            LayDown(canvas.At(x, y), tint.color, tint.alpha, mode);
        }
    }
}

Mask MaskFromSdf(int width, int height, const Sdf& sdf, float edgeWidth) {
    Mask mask(width, height);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            const float d = sdf(static_cast<float>(x) + 0.5f, static_cast<float>(y) + 0.5f);
            mask.At(x, y) = Clamp01(0.5f - d / edgeWidth);
        }
    }
    return mask;
}

Mask AlphaOf(const Canvas& canvas) {
    Mask mask(canvas.width, canvas.height);
    for (size_t i = 0; i < canvas.pixels.size(); ++i) mask.values[i] = canvas.pixels[i].a;
    return mask;
}

void Blur(Mask& mask, float radius) {
    // Three box passes approximate a Gaussian of this standard deviation.
    if (radius <= 0.0f) return;
    const int r = std::max(1, static_cast<int>(std::lround(radius * 0.9f)));
    for (int pass = 0; pass < 3; ++pass) {
        BoxPass(mask.values, mask.width, mask.height, r, true);
        BoxPass(mask.values, mask.width, mask.height, r, false);
    }
}

Mask Dilate(const Mask& mask, float radius) {
    Mask out(mask.width, mask.height);
    const int r = static_cast<int>(std::ceil(radius)) + 1;
    for (int y = 0; y < mask.height; ++y) {
        for (int x = 0; x < mask.width; ++x) {
            float best = 0.0f;
            for (int dy = -r; dy <= r && best < 1.0f; ++dy) {
                for (int dx = -r; dx <= r; ++dx) {
                    const float v = mask.Sample(x + dx, y + dy);
                    if (v <= 0.0f) continue;
                    // A partly covered pixel has its edge that much nearer to its centre.
                    const float distance = std::sqrt(static_cast<float>(dx * dx + dy * dy));
                    best = std::max(best, Clamp01(v + radius - distance));
                }
            }
            out.At(x, y) = best;
        }
    }
    return out;
}

void MultiplyMask(Mask& mask, const Mask& by) {
    for (size_t i = 0; i < mask.values.size(); ++i) mask.values[i] *= by.values[i];
}

void DrawLayer(Canvas& dst, const Canvas& layer, int ox, int oy, float opacity) {
    const Box box = Clip({ox, oy, ox + layer.width, oy + layer.height}, dst.width, dst.height);
    for (int y = box.y0; y < box.y1; ++y) {
        for (int x = box.x0; x < box.x1; ++x) {
            const Rgba& s = layer.At(x - ox, y - oy);
            Rgba& d = dst.At(x, y);
            const float a = s.a * opacity;
            d.r = s.r * opacity + d.r * (1.0f - a);
            d.g = s.g * opacity + d.g * (1.0f - a);
            d.b = s.b * opacity + d.b * (1.0f - a);
            d.a = a + d.a * (1.0f - a);
        }
    }
}

void ClearBoxes(Canvas& layer, const std::vector<Box>& boxes) {
    for (const Box& raw : boxes) {
        const Box box = Clip(raw, layer.width, layer.height);
        for (int y = box.y0; y < box.y1; ++y) {
            for (int x = box.x0; x < box.x1; ++x) layer.At(x, y) = Rgba{};
        }
    }
}

void Darken(Canvas& canvas, float factor) {
    for (Rgba& p : canvas.pixels) {
        p.r *= factor;
        p.g *= factor;
        p.b *= factor;
    }
}

Canvas Crop(const Canvas& canvas, Box box) {
    Canvas out(box.x1 - box.x0, box.y1 - box.y0);
    for (int y = 0; y < out.height; ++y) {
        for (int x = 0; x < out.width; ++x) out.At(x, y) = canvas.At(box.x0 + x, box.y0 + y);
    }
    return out;
}

Canvas Downsample(const Canvas& canvas, int factor) {
    Canvas out(canvas.width / factor, canvas.height / factor);
    const float scale = 1.0f / static_cast<float>(factor * factor);
    for (int y = 0; y < out.height; ++y) {
        for (int x = 0; x < out.width; ++x) {
            Rgba sum;
            for (int sy = 0; sy < factor; ++sy) {
                for (int sx = 0; sx < factor; ++sx) {
                    const Rgba& p = canvas.At(x * factor + sx, y * factor + sy);
                    sum.r += p.r;
                    sum.g += p.g;
                    sum.b += p.b;
                    sum.a += p.a;
                }
            }
            out.At(x, y) = {sum.r * scale, sum.g * scale, sum.b * scale, sum.a * scale};
        }
    }
    return out;
}

}  // namespace discart
