#include "palette.h"

#include <algorithm>

namespace discart {

namespace {

int Channel(const Rgb8& c, int channel) {
    return channel == 0 ? c.r : channel == 1 ? c.g : c.b;
}

struct ColorBox {
    explicit ColorBox(std::vector<Rgb8> all) : colors(std::move(all)) {
        for (int channel = 0; channel < 3; ++channel) {
            int lo = 255;
            int hi = 0;
            for (const Rgb8& c : colors) {
                lo = std::min(lo, Channel(c, channel));
                hi = std::max(hi, Channel(c, channel));
            }
            range[channel] = colors.empty() ? 0 : hi - lo;
        }
    }
    int Range(int channel) const { return range[channel]; }

    std::vector<Rgb8> colors;
    int range[3] = {0, 0, 0};
};

Rgb8 Average(const std::vector<Rgb8>& colors) {
    long r = 0;
    long g = 0;
    long b = 0;
    for (const Rgb8& c : colors) {
        r += c.r;
        g += c.g;
        b += c.b;
    }
    const long n = static_cast<long>(colors.size());
    return {static_cast<uint8_t>((r + n / 2) / n), static_cast<uint8_t>((g + n / 2) / n),
            static_cast<uint8_t>((b + n / 2) / n)};
}

std::vector<Rgb8> MedianCut(std::vector<Rgb8> samples, size_t count) {
    std::vector<ColorBox> boxes;
    boxes.emplace_back(std::move(samples));
    while (boxes.size() < count) {
        // Split the box whose widest channel spread, weighted by its population, is largest.
        size_t best = boxes.size();
        long bestScore = 0;
        int bestChannel = 0;
        for (size_t i = 0; i < boxes.size(); ++i) {
            if (boxes[i].colors.size() < 2) continue;
            for (int channel = 0; channel < 3; ++channel) {
                const long score = static_cast<long>(boxes[i].Range(channel)) * 1000 +
                                   static_cast<long>(std::min<size_t>(boxes[i].colors.size(), 999));
                if (boxes[i].Range(channel) > 0 && score > bestScore) {
                    bestScore = score;
                    best = i;
                    bestChannel = channel;
                }
            }
        }
        if (best == boxes.size()) break;
        std::vector<Rgb8> colors = std::move(boxes[best].colors);
        std::stable_sort(colors.begin(), colors.end(), [&](const Rgb8& a, const Rgb8& b) {
            return Channel(a, bestChannel) < Channel(b, bestChannel);
        });
        const auto middle = colors.begin() + static_cast<long>(colors.size() / 2);
        boxes[best] = ColorBox(std::vector<Rgb8>(colors.begin(), middle));
        boxes.emplace_back(std::vector<Rgb8>(middle, colors.end()));
    }
    std::vector<Rgb8> result;
    for (const ColorBox& box : boxes) result.push_back(Average(box.colors));
    std::stable_sort(result.begin(), result.end(), [](const Rgb8& a, const Rgb8& b) {
        return a.r * 299 + a.g * 587 + a.b * 114 < b.r * 299 + b.g * 587 + b.b * 114;
    });
    return result;
}

}  // namespace

std::array<Rgb8, 256> BuildPalette(const std::vector<const Picture*>& pictures) {
    std::array<Rgb8, 256> entries{};
    // Entries 0-9 and 246-255 are the display's static colours at run time; the usual ones stand
    // in for them, except for the entries the launcher's palette has always carried.
    const Rgb8 kStatic[20] = {
        {177, 5, 35},    {241, 98, 171},  {0, 128, 0},     {128, 128, 0},   {0, 0, 128},
        {128, 0, 128},   {0, 128, 128},   {192, 192, 192}, {192, 220, 192}, {166, 202, 240},
        {255, 251, 240}, {160, 160, 164}, {128, 128, 128}, {255, 0, 0},     {0, 255, 0},
        {255, 255, 0},   {0, 0, 255},     {255, 0, 255},   {0, 255, 255},   {252, 252, 252},
    };
    for (int i = 0; i < 10; ++i) {
        entries[i] = kStatic[i];
        entries[246 + i] = kStatic[10 + i];
    }

    std::vector<Rgb8> samples;
    for (const Picture* picture : pictures) {
        if (picture->bitsPerPixel != 24) continue;
        for (int y = 0; y < picture->height; y += 2) {
            for (int x = (y / 2) % 2; x < picture->width; x += 2) {
                const uint8_t* p = picture->Pixel(x, y);
                samples.push_back({p[0], p[1], p[2]});
            }
        }
    }
    const std::vector<Rgb8> colors = MedianCut(std::move(samples), 235);
    size_t next = 0;
    for (int i = 10; i <= 245; ++i) {
        if (i == 11) {
            entries[i] = {32, 31, 232};
        } else {
            entries[i] = next < colors.size() ? colors[next++] : Rgb8{};
        }
    }
    return entries;
}

}  // namespace discart
