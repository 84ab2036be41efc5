#include "formats.h"

#include <algorithm>
#include <cmath>
#include <fstream>
#include <iterator>

#include "noise.h"

namespace discart {

namespace {

class ByteWriter {
  public:
    void U8(uint32_t v) { bytes.push_back(static_cast<uint8_t>(v)); }
    void U16(uint32_t v) {
        U8(v & 0xFF);
        U8((v >> 8) & 0xFF);
    }
    void U32(uint32_t v) {
        U16(v & 0xFFFF);
        U16(v >> 16);
    }
    void Tag(const char* four) {
        for (int i = 0; i < 4; ++i) U8(static_cast<uint8_t>(four[i]));
    }
    std::vector<uint8_t> bytes;
};

uint32_t ReadU32(const std::vector<uint8_t>& b, size_t at) {
    return static_cast<uint32_t>(b[at]) | static_cast<uint32_t>(b[at + 1]) << 8 |
           static_cast<uint32_t>(b[at + 2]) << 16 | static_cast<uint32_t>(b[at + 3]) << 24;
}

uint8_t ToByte(float v, float offset) {
    return static_cast<uint8_t>(std::clamp(std::lround(v * 255.0f + offset), 0L, 255L));
}

int RowStride(int width, int bits) {
    return ((width * bits + 31) / 32) * 4;
}

void WriteInfoHeader(ByteWriter& w, int width, int height, int bits, uint32_t imageSize) {
    w.U32(40);
    w.U32(static_cast<uint32_t>(width));
    w.U32(static_cast<uint32_t>(height));
    w.U16(1);
    w.U16(static_cast<uint32_t>(bits));
    w.U32(0);
    w.U32(imageSize);
    w.U32(2835);  // 72 dots per inch
    w.U32(2835);
    w.U32(0);
    w.U32(0);
}

}  // namespace

Picture ToPicture(const Canvas& canvas, bool dither) {
    Picture picture(canvas.width, canvas.height, 24);
    for (int y = 0; y < canvas.height; ++y) {
        for (int x = 0; x < canvas.width; ++x) {
            const Rgb c = canvas.ColorAt(x, y);
            // Triangular noise of under one level either way.
            const float offset =
                dither ? (Hash2(x, y, 71) + Hash2(x, y, 113) - 1.0f) * 0.45f : 0.0f;
            uint8_t* p = picture.Pixel(x, y);
            p[0] = ToByte(c.r, offset);
            p[1] = ToByte(c.g, offset);
            p[2] = ToByte(c.b, offset);
        }
    }
    return picture;
}

Picture ToGrey(const Mask& mask) {
    Picture picture(mask.width, mask.height, 8);
    for (size_t i = 0; i < mask.values.size(); ++i) picture.bytes[i] = ToByte(mask.values[i], 0.0f);
    return picture;
}

Canvas ToCanvas(const Picture& picture) {
    Canvas canvas(picture.width, picture.height);
    for (int y = 0; y < picture.height; ++y) {
        for (int x = 0; x < picture.width; ++x) {
            const uint8_t* p = picture.Pixel(x, y);
            const float r = static_cast<float>(p[0]) / 255.0f;
            const float g = picture.bitsPerPixel == 24 ? static_cast<float>(p[1]) / 255.0f : r;
            const float b = picture.bitsPerPixel == 24 ? static_cast<float>(p[2]) / 255.0f : r;
            canvas.At(x, y) = {r, g, b, 1.0f};
        }
    }
    return canvas;
}

Picture Cut(const Picture& picture, int x, int y, int width, int height) {
    Picture out(width, height, picture.bitsPerPixel);
    const size_t bytesPerPixel = static_cast<size_t>(picture.bitsPerPixel / 8);
    for (int row = 0; row < height; ++row) {
        std::copy_n(picture.Pixel(x, y + row), width * bytesPerPixel, out.Pixel(0, row));
    }
    return out;
}

void MaskedBlend(const Picture& a, int ax, int ay, const Picture& b, int bx, int by,
                 const Picture& mask, int mx, int my, Picture& d, int dx, int dy, int width,
                 int height) {
    const int channels = a.bitsPerPixel / 8;
    for (int r = 0; r < height; ++r) {
        for (int c = 0; c < width; ++c) {
            const int m = mask.Pixel(mx + c, my + r)[0];
            const uint8_t* pa = a.Pixel(ax + c, ay + r);
            const uint8_t* pb = b.Pixel(bx + c, by + r);
            uint8_t* pd = d.Pixel(dx + c, dy + r);
            for (int k = 0; k < channels; ++k) {
                if (m == 0) {
                    pd[k] = pb[k];
                } else if (m == 255) {
                    pd[k] = pa[k];
                } else {
                    pd[k] = static_cast<uint8_t>((pa[k] * m + pb[k] * (255 - m)) >> 8);
                }
            }
        }
    }
}

std::vector<uint8_t> EncodeBmp(const Picture& picture) {
    const int stride = RowStride(picture.width, picture.bitsPerPixel);
    const uint32_t imageSize = static_cast<uint32_t>(stride * picture.height);
    const uint32_t tableSize = picture.bitsPerPixel == 8 ? 1024 : 0;
    const uint32_t offset = 14 + 40 + tableSize;
    ByteWriter w;
    w.U8('B');
    w.U8('M');
    w.U32(offset + imageSize);
    w.U32(0);
    w.U32(offset);
    WriteInfoHeader(w, picture.width, picture.height, picture.bitsPerPixel, imageSize);
    if (picture.bitsPerPixel == 8) {
        for (uint32_t i = 0; i < 256; ++i) {
            w.U8(i);
            w.U8(i);
            w.U8(i);
            w.U8(0);
        }
    }
    for (int y = picture.height - 1; y >= 0; --y) {
        for (int x = 0; x < picture.width; ++x) {
            const uint8_t* p = picture.Pixel(x, y);
            if (picture.bitsPerPixel == 24) {
                w.U8(p[2]);
                w.U8(p[1]);
                w.U8(p[0]);
            } else {
                w.U8(p[0]);
            }
        }
        const int used = picture.width * picture.bitsPerPixel / 8;
        for (int pad = used; pad < stride; ++pad) w.U8(0);
    }
    return w.bytes;
}

bool DecodeBmp(const std::vector<uint8_t>& file, Picture& picture) {
    if (file.size() < 54 || file[0] != 'B' || file[1] != 'M') return false;
    const uint32_t offset = ReadU32(file, 10);
    const int width = static_cast<int>(ReadU32(file, 18));
    const int height = static_cast<int>(ReadU32(file, 22));
    const int bits = file[28];
    if ((bits != 24 && bits != 8) || width <= 0 || height <= 0 || ReadU32(file, 30) != 0) {
        return false;
    }
    const int stride = RowStride(width, bits);
    if (file.size() < offset + static_cast<size_t>(stride) * height) return false;
    picture = Picture(width, height, bits);
    for (int y = 0; y < height; ++y) {
        const uint8_t* row = &file[offset + static_cast<size_t>(stride) * (height - 1 - y)];
        for (int x = 0; x < width; ++x) {
            uint8_t* p = picture.Pixel(x, y);
            if (bits == 24) {
                p[0] = row[x * 3 + 2];
                p[1] = row[x * 3 + 1];
                p[2] = row[x * 3];
            } else {
                p[0] = row[x];
            }
        }
    }
    return true;
}

std::vector<uint8_t> EncodePalette(const std::array<Rgb8, 256>& entries) {
    ByteWriter w;
    w.Tag("RIFF");
    w.U32(1040);
    w.Tag("PAL ");
    w.Tag("data");
    w.U32(1028);
    w.U16(0x0300);
    w.U16(256);
    for (const Rgb8& e : entries) {
        w.U8(e.r);
        w.U8(e.g);
        w.U8(e.b);
        w.U8(0);
    }
    return w.bytes;
}

std::vector<uint8_t> EncodeWave(const std::vector<int16_t>& samples, int sampleRate) {
    const uint32_t dataSize = static_cast<uint32_t>(samples.size() * 2);
    ByteWriter w;
    w.Tag("RIFF");
    w.U32(36 + dataSize);
    w.Tag("WAVE");
    w.Tag("fmt ");
    w.U32(16);
    w.U16(1);  // PCM
    w.U16(1);  // mono
    w.U32(static_cast<uint32_t>(sampleRate));
    w.U32(static_cast<uint32_t>(sampleRate * 2));
    w.U16(2);
    w.U16(16);
    w.Tag("data");
    w.U32(dataSize);
    for (int16_t s : samples) w.U16(static_cast<uint16_t>(s));
    return w.bytes;
}

std::vector<uint8_t> EncodeIcon(const std::vector<IconImage>& images) {
    ByteWriter w;
    w.U16(0);
    w.U16(1);  // icon
    w.U16(static_cast<uint32_t>(images.size()));
    uint32_t offset = 6 + 16 * static_cast<uint32_t>(images.size());
    auto imageBytes = [](const IconImage& image) {
        const uint32_t maskStride = static_cast<uint32_t>(RowStride(image.size, 1));
        return 40 + static_cast<uint32_t>(image.size * image.size * 4) +
               maskStride * static_cast<uint32_t>(image.size);
    };
    for (const IconImage& image : images) {
        w.U8(static_cast<uint32_t>(image.size) & 0xFF);
        w.U8(static_cast<uint32_t>(image.size) & 0xFF);
        w.U8(0);
        w.U8(0);
        w.U16(1);
        w.U16(32);
        w.U32(imageBytes(image));
        w.U32(offset);
        offset += imageBytes(image);
    }
    for (const IconImage& image : images) {
        const int n = image.size;
        const int maskStride = RowStride(n, 1);
        // The height counts the colour rows and the transparency rows together.
        WriteInfoHeader(w, n, n * 2, 32, static_cast<uint32_t>(n * n * 4 + maskStride * n));
        for (int y = n - 1; y >= 0; --y) {
            for (int x = 0; x < n; ++x) {
                const uint8_t* p = &image.rgba[(static_cast<size_t>(y) * n + x) * 4];
                w.U8(p[2]);
                w.U8(p[1]);
                w.U8(p[0]);
                w.U8(p[3]);
            }
        }
        for (int y = n - 1; y >= 0; --y) {
            std::vector<uint8_t> row(static_cast<size_t>(maskStride), 0);
            for (int x = 0; x < n; ++x) {
                if (image.rgba[(static_cast<size_t>(y) * n + x) * 4 + 3] == 0) {
                    row[x / 8] |= static_cast<uint8_t>(0x80 >> (x % 8));
                }
            }
            for (uint8_t v : row) w.U8(v);
        }
    }
    return w.bytes;
}

bool WriteFile(const std::string& path, const std::vector<uint8_t>& bytes) {
    std::ofstream out(path, std::ios::binary | std::ios::trunc);
    out.write(reinterpret_cast<const char*>(bytes.data()),
              static_cast<std::streamsize>(bytes.size()));
    return static_cast<bool>(out);
}

bool WriteText(const std::string& path, const std::string& text) {
    return WriteFile(path, std::vector<uint8_t>(text.begin(), text.end()));
}

bool ReadFile(const std::string& path, std::vector<uint8_t>& bytes) {
    std::ifstream in(path, std::ios::binary);
    if (!in) return false;
    bytes.assign(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
    return true;
}

}  // namespace discart
