#include "graphics/masked_blend.h"

#include <gtest/gtest.h>

#include <cstring>
#include <random>
#include <vector>

namespace {

// A picture's rows as the tests address them: (x, y) with y counted from the top.
struct View {
    explicit View(DibBitmap* picture) {
        DibRowInfo(picture, rows, stride, bitCount);
        DibDimensions(picture, width, height);
    }
    bool Inside(std::int32_t x, std::int32_t y) const {
        return x >= 0 && y >= 0 && x < width && y < height;
    }
    std::uint8_t* At(std::int32_t x, std::int32_t y) const {
        return rows + static_cast<std::size_t>(height - 1 - y) * stride + x * (bitCount / 8);
    }

    std::uint8_t* rows = nullptr;
    std::uint32_t stride = 0;
    std::uint16_t bitCount = 0;
    std::int32_t width = 0;
    std::int32_t height = 0;
};

DibPtr Filled(std::int32_t width, std::int32_t height, std::uint16_t bitCount, std::uint8_t value) {
    DibPtr picture(CreateDib(width, height, bitCount));
    View view(picture.get());
    std::memset(view.rows, value, static_cast<std::size_t>(view.stride) * height);
    return picture;
}

// The rule as it reads, byte by byte, each row and column only while inside all four pictures.
void PlainBlend(DibBitmap* a, DibPoint pa, DibBitmap* b, DibPoint pb, DibBitmap* m, DibPoint pm,
                DibBitmap* d, DibPoint pd, DibSize size, int pixelBytes) {
    View va(a), vb(b), vm(m), vd(d);
    for (std::int32_t r = 0; r < size.height; ++r) {
        if (!va.Inside(0, pa.y + r) || !vb.Inside(0, pb.y + r) || !vm.Inside(0, pm.y + r) ||
            !vd.Inside(0, pd.y + r)) {
            break;
        }
        for (std::int32_t c = 0; c < size.width; ++c) {
            if (!va.Inside(pa.x + c, 0) || !vb.Inside(pb.x + c, 0) || !vm.Inside(pm.x + c, 0) ||
                !vd.Inside(pd.x + c, 0)) {
                break;
            }
            unsigned weight = *vm.At(pm.x + c, pm.y + r);
            for (int k = 0; k < pixelBytes; ++k) {
                unsigned x = va.At(pa.x + c, pa.y + r)[k];
                unsigned y = vb.At(pb.x + c, pb.y + r)[k];
                vd.At(pd.x + c, pd.y + r)[k] = static_cast<std::uint8_t>(
                    weight == 0     ? y
                    : weight == 255 ? x
                                    : (x * weight + y * (255 - weight)) >> 8);
            }
        }
    }
}

TEST(MaskedBlend, RefusesPicturesThatDoNotFitTogether) {
    struct Row {
        const char* name;
        std::uint16_t aBits, bBits, maskBits, dBits;
        int missing;  // 0 to 3: that picture is null; -1 none; 4: A's block is cut short
    } rows[] = {
        {"D of another depth", 24, 24, 8, 8, -1},
        {"A of another depth", 8, 24, 8, 24, -1},
        {"24-bit mask", 24, 24, 24, 24, -1},
        {"16-bit pictures", 16, 16, 8, 16, -1},
        {"no A", 24, 24, 8, 24, 0},
        {"no B", 24, 24, 8, 24, 1},
        {"no mask", 24, 24, 8, 24, 2},
        {"no D", 24, 24, 8, 24, 3},
        {"A's rows cut short", 24, 24, 8, 24, 4},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        DibPtr pictures[] = {Filled(6, 6, row.aBits, 200), Filled(6, 6, row.bBits, 100),
                             Filled(6, 6, row.maskBits, 128), Filled(6, 6, row.dBits, 7)};
        if (row.missing == 4) {
            std::size_t shorter = DibBlockSize(pictures[0].get()) - 1;
            pictures[0].reset(DibRealloc(pictures[0].release(), shorter));
        } else if (row.missing >= 0) {
            pictures[row.missing].reset();
        }
        DibPtr before(CloneDib(pictures[3].get()));
        MaskedBlend(pictures[0].get(), {0, 0}, pictures[1].get(), {0, 0}, pictures[2].get(), {0, 0},
                    pictures[3].get(), {0, 0}, {6, 6});
        if (before) {
            EXPECT_EQ(std::memcmp(before.get(), pictures[3].get(), DibBlockSize(before.get())), 0);
        }
    }
}

// Any sharing of pictures between the parts must give what the plain rule gives in its own
// order; sizes and origins run past every edge, so this is also where clipping is checked.
enum class Sharing { None, DIsB, DIsBElsewhere, AIsB, DIsA, DIsMask };

TEST(MaskedBlend, MatchesThePlainRuleOnRandomPictures) {
    std::mt19937 random(20240611);
    auto uniform = [&random](int low, int high) {
        return std::uniform_int_distribution<int>(low, high)(random);
    };
    for (int round = 0; round < 1500; ++round) {
        std::uint16_t bits = uniform(0, 1) ? 24 : 8;
        auto sharing = static_cast<Sharing>(uniform(0, bits == 8 ? 5 : 4));
        int maskStyle = uniform(0, 2);
        SCOPED_TRACE(testing::Message()
                     << "round " << round << ", " << bits << " bits, sharing "
                     << static_cast<int>(sharing) << ", mask style " << maskStyle);
        // Four pictures of their own random sizes and contents; index 2 is the mask.
        std::vector<DibPtr> pictures;
        for (int i = 0; i < 4; ++i) {
            std::int32_t width = uniform(1, 200);
            std::int32_t height = uniform(1, 8);
            pictures.emplace_back(CreateDib(width, height, i == 2 ? 8 : bits));
            View view(pictures.back().get());
            int bytes = width * (i == 2 ? 1 : bits / 8);
            for (std::int32_t y = 0; y < height; ++y) {
                for (int x = 0; x < bytes;) {
                    // Style 0: noise; 1: runs of any value; 2: runs of 0 and 255 with a few
                    // partial values between, as round buttons have.
                    int run = i != 2 || maskStyle == 0 ? 1 : uniform(1, 130);
                    int value = uniform(0, 255);
                    if (i == 2 && maskStyle == 2 && uniform(0, 9) != 0) value = uniform(0, 1) * 255;
                    for (; run > 0 && x < bytes; --run) {
                        view.At(0, y)[x++] = static_cast<std::uint8_t>(value);
                    }
                }
            }
        }
        int roles[4] = {0, 1, 2, 3};  // A, B, mask, D
        if (sharing == Sharing::DIsB || sharing == Sharing::DIsBElsewhere) roles[3] = 1;
        if (sharing == Sharing::AIsB) roles[0] = 1;
        if (sharing == Sharing::DIsA) roles[3] = 0;
        if (sharing == Sharing::DIsMask) roles[3] = 2;
        // Origins mostly inside their pictures, now and then just outside.
        DibPoint origins[4];
        for (int i = 0; i < 4; ++i) {
            View view(pictures[roles[i]].get());
            origins[i] = {uniform(0, 19) == 0 ? -1 : uniform(0, view.width / 2),
                          uniform(0, 19) == 0 ? -1 : uniform(0, view.height - 1)};
        }
        // A picture that plays two parts does so at the same place or a little beside it.
        DibPoint shared = origins[roles[3]];
        if (roles[3] != 3) origins[3] = {shared.x + uniform(-3, 3), shared.y + uniform(-2, 2)};
        if (sharing == Sharing::DIsB) origins[3] = origins[1];
        DibSize size{uniform(-1, 210), uniform(-1, 8)};

        std::vector<DibPtr> expected;
        for (const DibPtr& picture : pictures) expected.emplace_back(CloneDib(picture.get()));
        PlainBlend(expected[roles[0]].get(), origins[0], expected[roles[1]].get(), origins[1],
                   expected[roles[2]].get(), origins[2], expected[roles[3]].get(), origins[3], size,
                   bits / 8);
        MaskedBlend(pictures[roles[0]].get(), origins[0], pictures[roles[1]].get(), origins[1],
                    pictures[roles[2]].get(), origins[2], pictures[roles[3]].get(), origins[3],
                    size);
        for (int i = 0; i < 4; ++i) {
            ASSERT_EQ(
                std::memcmp(pictures[i].get(), expected[i].get(), DibBlockSize(expected[i].get())),
                0)
                << "picture " << i;
        }
    }
}

TEST(MaskedRestore, PutsTheSourceBackWhereverTheMaskTouchedAndClipsLikeTheBlend) {
    for (std::uint16_t bits : {8, 24}) {
        SCOPED_TRACE(bits);
        DibPtr pristine = Filled(6, 4, bits, 200);
        DibPtr working = Filled(6, 4, bits, 50);
        DibPtr mask = Filled(4, 4, 8, 0);
        View m(mask.get());
        *m.At(0, 0) = 1;  // the faintest edge of a face counts too
        *m.At(1, 0) = 128;
        *m.At(2, 0) = 255;
        *m.At(3, 3) = 9;
        MaskedRestore(pristine.get(), {2, 0}, mask.get(), {0, 0}, working.get(), {2, 0}, {4, 4});
        View w(working.get());
        for (std::int32_t y = 0; y < 4; ++y) {
            for (std::int32_t x = 0; x < 6; ++x) {
                bool touched = x >= 2 && *m.At(x - 2, y) != 0;
                SCOPED_TRACE(testing::Message() << x << "," << y);
                EXPECT_EQ(*w.At(x, y), touched ? 200 : 50);
            }
        }
        // A rectangle running off D stops at its edge; a depth that differs does nothing.
        MaskedRestore(pristine.get(), {0, 0}, Filled(4, 4, 8, 255).get(), {0, 0}, working.get(),
                      {4, 2}, {4, 4});
        EXPECT_EQ(*w.At(5, 3), 200);
        DibPtr other = Filled(6, 4, bits == 8 ? 24 : 8, 10);
        MaskedRestore(other.get(), {0, 0}, Filled(4, 4, 8, 255).get(), {0, 0}, working.get(),
                      {0, 0}, {4, 4});
        EXPECT_EQ(*w.At(0, 0), 50);
    }
}

}  // namespace
