#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "canvas.h"

namespace discart {

// A finished picture as it is stored: top-down rows without padding, RGB triples at 24 bits or
// one grey level per pixel at 8 bits.
struct Picture {
    int width = 0;
    int height = 0;
    int bitsPerPixel = 24;
    std::vector<uint8_t> bytes;

    Picture() = default;
    Picture(int w, int h, int bits)
        : width(w),
          height(h),
          bitsPerPixel(bits),
          bytes(static_cast<size_t>(w) * h * (bits / 8), 0) {}
    uint8_t* Pixel(int x, int y) {
        return &bytes[(static_cast<size_t>(y) * width + x) * (bitsPerPixel / 8)];
    }
    const uint8_t* Pixel(int x, int y) const {
        return &bytes[(static_cast<size_t>(y) * width + x) * (bitsPerPixel / 8)];
    }
};

struct Rgb8 {
    uint8_t r = 0;
    uint8_t g = 0;
    uint8_t b = 0;
};

// 24-bit picture of a canvas; partly covered pixels keep their own (unpremultiplied) colour, as a
// picture drawn through a separate mask needs. Dithering hides banding in wide gradients.
Picture ToPicture(const Canvas& canvas, bool dither = false);
// 8-bit grey picture of coverage values.
Picture ToGrey(const Mask& mask);
Canvas ToCanvas(const Picture& picture);
Picture Cut(const Picture& picture, int x, int y, int width, int height);

// The launcher's compositing step: D = (A * m + B * (255 - m)) >> 8 per byte, 0 and 255 exact.
void MaskedBlend(const Picture& a, int ax, int ay, const Picture& b, int bx, int by,
                 const Picture& mask, int mx, int my, Picture& d, int dx, int dy, int width,
                 int height);

std::vector<uint8_t> EncodeBmp(const Picture& picture);
bool DecodeBmp(const std::vector<uint8_t>& file, Picture& picture);
std::vector<uint8_t> EncodePalette(const std::array<Rgb8, 256>& entries);
std::vector<uint8_t> EncodeWave(const std::vector<int16_t>& samples, int sampleRate);

struct IconImage {
    int size = 0;
    std::vector<uint8_t> rgba;  // top-down, straight alpha
};
std::vector<uint8_t> EncodeIcon(const std::vector<IconImage>& images);

bool WriteFile(const std::string& path, const std::vector<uint8_t>& bytes);
bool WriteText(const std::string& path, const std::string& text);
bool ReadFile(const std::string& path, std::vector<uint8_t>& bytes);

}  // namespace discart
