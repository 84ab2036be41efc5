#include "graphics/masked_blend.h"

#include <algorithm>
#include <cstring>

namespace {

using Byte = std::uint8_t;

struct Rows {
    const Byte* bottomRow = nullptr;
    std::uint32_t stride = 0;
    std::int32_t width = 0;
    std::int32_t height = 0;
    std::uint16_t bitCount = 0;
};

bool ReadRows(const DibBitmap* picture, Rows& rows) {
    return DibRowInfo(picture, rows.bottomRow, rows.stride, rows.bitCount) &&
           DibDimensions(picture, rows.width, rows.height);
}

// Bottom-up storage: top-down row t is stored row height − 1 − t.
std::size_t TopDownRowOffset(const Rows& rows, std::int32_t t) {
    return static_cast<std::size_t>(rows.height - 1 - t) * rows.stride;
}

// Steps from the origins that stay inside every picture; 0 as soon as one origin is outside.
std::int32_t InsideCount(std::int32_t wanted, const std::int32_t (&origins)[4],
                         const std::int32_t (&extents)[4]) {
    std::int64_t count = wanted;
    for (int i = 0; i < 4; ++i) {
        if (origins[i] < 0) return 0;
        count = std::min<std::int64_t>(count, std::int64_t{extents[i]} - origins[i]);
    }
    return count > 0 ? static_cast<std::int32_t>(count) : 0;
}

bool Overlap(const Byte* x, std::size_t xLength, const Byte* y, std::size_t yLength) {
    auto xStart = reinterpret_cast<std::uintptr_t>(x);
    auto yStart = reinterpret_cast<std::uintptr_t>(y);
    return xStart < yStart + yLength && yStart < xStart + xLength;
}

// The arithmetic runs on 16-bit lanes as (A·wa + B·wb) >> 8. A mask value m between the
// extremes gives wa = m, wb = 255 − m; mask 255 gives wa = 256, wb = 0 (exactly A) and mask 0
// gives wa = 0, wb = 256 (exactly B), so one formula serves every byte. The largest sum,
// 255 · 256, still fits 16 bits. Divisions rather than comparisons keep the vector code in
// 16-bit lanes: (m + 1) / 256 is 1 only for 255, (m + 255) / 256 is 0 only for 0.
std::uint16_t WeightOfA(std::uint16_t m) {
    return static_cast<std::uint16_t>(m + static_cast<std::uint16_t>(m + 1) / 256);
}
std::uint16_t WeightOfB(std::uint16_t m) {
    return static_cast<std::uint16_t>(256 - m - static_cast<std::uint16_t>(m + 255) / 256);
}

Byte Mix(Byte a, Byte b, std::uint16_t wa, std::uint16_t wb) {
    return static_cast<Byte>(static_cast<std::uint16_t>(a * wa + b * wb) >> 8);
}

// One pixel after another, each mask and source byte read just before its result is written:
// what the rule means when D overlaps A, B or the mask at another place.
void BlendRowInOrder(const Byte* a, const Byte* b, const Byte* m, Byte* d, std::int32_t count,
                     int pixelBytes) {
    for (std::int32_t i = 0; i < count; ++i) {
        std::uint16_t wa = WeightOfA(m[i]);
        std::uint16_t wb = WeightOfB(m[i]);
        for (int k = 0; k < pixelBytes; ++k) {
            std::size_t at = static_cast<std::size_t>(i) * pixelBytes + k;
            d[at] = Mix(a[at], b[at], wa, wb);
        }
    }
}

// The blocks below have a length known at compile time, which GCC turns into vector code at
// -O2 (it leaves loops of unknown length scalar). BlendRow sends a row here only when D is B
// itself or shares no byte with A, B and the mask, so no byte is read after another step of
// the loop wrote it; `ivdep` tells GCC so, which spares the overlap checks it would add.
constexpr int kBlockBytes = 96;

// A run of one mask value: both bytes of a 16-bit word have the same weights, so a word is
// blended as two lanes (its low and high byte) without unpacking it, in either byte order.
struct RunWeights {
    std::uint16_t a;
    std::uint16_t b;
};

std::uint16_t LoadWord(const Byte* at) {
    std::uint16_t word;
    std::memcpy(&word, at, sizeof word);
    return word;
}

void StoreWord(Byte* at, std::uint16_t word) {
    std::memcpy(at, &word, sizeof word);
}

std::uint16_t MixWord(std::uint16_t x, std::uint16_t y, RunWeights w) {
    auto low = static_cast<std::uint16_t>((x & 0xFF) * w.a + (y & 0xFF) * w.b) >> 8;
    auto high = static_cast<std::uint16_t>((x >> 8) * w.a + (y >> 8) * w.b) & 0xFF00;
    return static_cast<std::uint16_t>(low | high);
}

template <int kPixels>
bool AllEqual(const Byte* m, Byte value) {
    static_assert(kPixels % 8 == 0, "whole words");
    const std::uint64_t pattern = 0x0101010101010101u * value;
    std::uint64_t differences = 0;
    for (int j = 0; j < kPixels; j += 8) {
        std::uint64_t word;
        std::memcpy(&word, m + j, sizeof word);
        differences |= word ^ pattern;
    }
    return differences == 0;
}

// Blends whole blocks for as long as the mask keeps `value` and returns the pixels done. Each
// block's mask is checked just before the block is blended, beside the pixel reads.
template <int kPixelBytes>
std::int32_t BlendRun(const Byte* a, const Byte* b, Byte* d, const Byte* m, Byte value,
                      std::int32_t count) {
    constexpr std::int32_t kBlockPixels = kBlockBytes / kPixelBytes;
    const RunWeights w{WeightOfA(value), WeightOfB(value)};
    std::int32_t done = 0;
    for (; done + kBlockPixels <= count && AllEqual<kBlockPixels>(m + done, value);
         done += kBlockPixels, a += kBlockBytes, b += kBlockBytes, d += kBlockBytes) {
#pragma GCC ivdep
        for (int j = 0; j < kBlockBytes; j += 2) {
            StoreWord(d + j, MixWord(LoadWord(a + j), LoadWord(b + j), w));
        }
    }
    return done;
}

// Mask values that change from pixel to pixel: one mask byte per pixel byte, from which the
// kernel works out both weights itself.
Byte MixByMask(Byte a, Byte b, Byte m) {
    return Mix(a, b, WeightOfA(m), WeightOfB(m));
}

void BlendMixed(const Byte* a, const Byte* b, Byte* d, const Byte* w, int bytes) {
    if (bytes == kBlockBytes) {
#pragma GCC ivdep
        for (int j = 0; j < kBlockBytes; ++j) d[j] = MixByMask(a[j], b[j], w[j]);
    } else {
        for (int j = 0; j < bytes; ++j) d[j] = MixByMask(a[j], b[j], w[j]);
    }
}

// Each mask byte repeated for the three bytes of its pixel. Every pixel stores four copies (the
// next pixel overwrites the fourth), hence the spare byte.
struct ExpandedMask {
    Byte bytes[kBlockBytes + 1];
};

void ExpandMask(const Byte* m, int pixels, ExpandedMask& expanded) {
    for (int i = 0; i < pixels; ++i) {
        std::uint32_t repeated = m[i] * 0x01010101u;
        std::memcpy(expanded.bytes + 3 * i, &repeated, sizeof repeated);
    }
}

// End of the run of mask bytes equal to `value` that starts at `from`, eight at a time.
std::int32_t RunEnd(const Byte* m, std::int32_t from, std::int32_t count, Byte value) {
    const std::uint64_t pattern = 0x0101010101010101u * value;
    std::int32_t i = from;
    for (; i + 8 <= count; i += 8) {
        std::uint64_t word;
        std::memcpy(&word, m + i, sizeof word);
        if (word != pattern) break;
    }
    while (i < count && m[i] == value) ++i;
    return i;
}

// D is disjoint from A, B and the mask, or is B itself (in-place compositing).
template <int kPixelBytes>
void BlendRowInRuns(const Byte* a, const Byte* b, const Byte* m, Byte* d, std::int32_t count) {
    constexpr std::int32_t kBlockPixels = kBlockBytes / kPixelBytes;
    ExpandedMask expanded;
    std::int32_t i = 0;
    while (i < count) {
        Byte value = m[i];
        std::size_t at = static_cast<std::size_t>(i) * kPixelBytes;
        std::int32_t end = i;
        if (value == 0 || value == 255) {
            // Straight copies; nothing to do when D already is the source.
            end = RunEnd(m, i, count, value);
            const Byte* source = value == 255 ? a : b;
            std::size_t length = static_cast<std::size_t>(end - i) * kPixelBytes;
            if (source != d) std::memcpy(d + at, source + at, length);
            i = end;
            continue;
        }
        // Whole blocks of one value share their weights.
        end += BlendRun<kPixelBytes>(a + at, b + at, d + at, m + i, value, count - i);
        if (end == i) {
            // The mask changes within the next block: each byte gets its own weights.
            end = std::min<std::int32_t>(count, i + kBlockPixels);
            const Byte* weights = m + i;
            if (kPixelBytes == 3) {
                ExpandMask(m + i, end - i, expanded);
                weights = expanded.bytes;
            }
            BlendMixed(a + at, b + at, d + at, weights, (end - i) * kPixelBytes);
        }
        i = end;
    }
}

void BlendRow(const Byte* a, const Byte* b, const Byte* m, Byte* d, std::int32_t count,
              int pixelBytes) {
    std::size_t length = static_cast<std::size_t>(count) * pixelBytes;
    bool shiftedOverlap = Overlap(d, length, m, static_cast<std::size_t>(count)) ||
                          Overlap(d, length, a, length) ||
                          (d != b && Overlap(d, length, b, length));
    if (shiftedOverlap) {
        BlendRowInOrder(a, b, m, d, count, pixelBytes);
    } else if (pixelBytes == 3) {
        BlendRowInRuns<3>(a, b, m, d, count);
    } else {
        BlendRowInRuns<1>(a, b, m, d, count);
    }
}

}  // namespace

void MaskedBlend(const DibBitmap* a, DibPoint pa, const DibBitmap* b, DibPoint pb,
                 const DibBitmap* mask, DibPoint pm, DibBitmap* d, DibPoint pd, DibSize size) {
    Rows ra;
    Rows rb;
    Rows rm;
    Rows rd;
    Byte* dBottom = nullptr;
    if (!ReadRows(a, ra) || !ReadRows(b, rb) || !ReadRows(mask, rm)) return;
    if (!DibRowInfo(d, dBottom, rd.stride, rd.bitCount) || !DibDimensions(d, rd.width, rd.height)) {
        return;
    }
    if (ra.bitCount != rb.bitCount || ra.bitCount != rd.bitCount || rm.bitCount != 8) return;
    if (ra.bitCount != 8 && ra.bitCount != 24) return;
    const int pixelBytes = ra.bitCount / 8;

    std::int32_t rows = InsideCount(size.height, {pa.y, pb.y, pm.y, pd.y},
                                    {ra.height, rb.height, rm.height, rd.height});
    std::int32_t columns =
        InsideCount(size.width, {pa.x, pb.x, pm.x, pd.x}, {ra.width, rb.width, rm.width, rd.width});
    if (rows == 0 || columns == 0) return;

    auto blendRow = [&](std::int32_t r) {
        const Byte* rowA = ra.bottomRow + TopDownRowOffset(ra, pa.y + r) +
                           static_cast<std::size_t>(pa.x) * pixelBytes;
        const Byte* rowB = rb.bottomRow + TopDownRowOffset(rb, pb.y + r) +
                           static_cast<std::size_t>(pb.x) * pixelBytes;
        const Byte* rowM =
            rm.bottomRow + TopDownRowOffset(rm, pm.y + r) + static_cast<std::size_t>(pm.x);
        Byte* rowD =
            dBottom + TopDownRowOffset(rd, pd.y + r) + static_cast<std::size_t>(pd.x) * pixelBytes;
        BlendRow(rowA, rowB, rowM, rowD, columns, pixelBytes);
    };
    // The rows are defined top-down, which matters only when D is also read at another place.
    // Otherwise they go bottom-up, in memory order, which the hardware prefetches far better.
    bool readsOwnOutput = d == a || d == mask || (d == b && (pd.x != pb.x || pd.y != pb.y));
    if (readsOwnOutput) {
        for (std::int32_t r = 0; r < rows; ++r) blendRow(r);
    } else {
        for (std::int32_t r = rows - 1; r >= 0; --r) blendRow(r);
    }
}

void MaskedRestore(const DibBitmap* a, DibPoint pa, const DibBitmap* mask, DibPoint pm,
                   DibBitmap* d, DibPoint pd, DibSize size) {
    Rows ra;
    Rows rm;
    Rows rd;
    Byte* dBottom = nullptr;
    if (!ReadRows(a, ra) || !ReadRows(mask, rm)) return;
    if (!DibRowInfo(d, dBottom, rd.stride, rd.bitCount) || !DibDimensions(d, rd.width, rd.height)) {
        return;
    }
    if (ra.bitCount != rd.bitCount || rm.bitCount != 8) return;
    if (ra.bitCount != 8 && ra.bitCount != 24) return;
    const std::size_t pixelBytes = ra.bitCount / 8;
    const std::int32_t rows = InsideCount(size.height, {pa.y, pm.y, pd.y, pd.y},
                                          {ra.height, rm.height, rd.height, rd.height});
    const std::int32_t columns = InsideCount(size.width, {pa.x, pm.x, pd.x, pd.x},
                                             {ra.width, rm.width, rd.width, rd.width});
    for (std::int32_t r = 0; r < rows; ++r) {
        const Byte* rowA = ra.bottomRow + TopDownRowOffset(ra, pa.y + r) + pa.x * pixelBytes;
        const Byte* rowM = rm.bottomRow + TopDownRowOffset(rm, pm.y + r) + pm.x;
        Byte* rowD = dBottom + TopDownRowOffset(rd, pd.y + r) + pd.x * pixelBytes;
        for (std::int32_t c = 0; c < columns; ++c) {
            if (rowM[c] != 0) std::memcpy(rowD + c * pixelBytes, rowA + c * pixelBytes, pixelBytes);
        }
    }
}
