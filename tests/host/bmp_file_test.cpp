#include "graphics/bmp_file.h"

#include <gtest/gtest.h>

#include <cstring>
#include <vector>

namespace {

std::vector<std::uint8_t> BmpFile(std::int32_t width, std::int32_t height, std::uint16_t bitCount,
                                  std::uint32_t headerSize = 40) {
    const std::uint32_t stride = ((static_cast<std::uint32_t>(width) * bitCount + 31) / 32) * 4;
    const std::uint32_t colors = bitCount <= 8 ? (1u << bitCount) : 0;
    const std::uint32_t entry = headerSize == 12 ? 3 : 4;
    const std::uint32_t offset = 14 + headerSize + colors * entry;
    std::vector<std::uint8_t> file(offset + stride * static_cast<std::uint32_t>(std::abs(height)), 0);
    auto put32 = [&](std::size_t at, std::uint32_t v) { std::memcpy(&file[at], &v, 4); };
    auto put16 = [&](std::size_t at, std::uint16_t v) { std::memcpy(&file[at], &v, 2); };
    file[0] = 'B';
    file[1] = 'M';
    put32(2, static_cast<std::uint32_t>(file.size()));
    put32(10, offset);
    put32(14, headerSize);
    if (headerSize == 12) {
        put16(18, static_cast<std::uint16_t>(width));
        put16(20, static_cast<std::uint16_t>(height));
        put16(22, 1);
        put16(24, bitCount);
    } else {
        put32(18, static_cast<std::uint32_t>(width));
        put32(22, static_cast<std::uint32_t>(height));
        put16(26, 1);
        put16(28, bitCount);
    }
    return file;
}

TEST(BmpFile, WholeFilesOfEveryKindAreAccepted) {
    EXPECT_TRUE(BmpFileIsWhole(BmpFile(640, 480, 24).data(), BmpFile(640, 480, 24).size()));
    for (std::uint16_t depth : {1, 4, 8, 16, 24, 32}) {
        SCOPED_TRACE(depth);
        auto file = BmpFile(209, 49, depth);
        EXPECT_TRUE(BmpFileIsWhole(file.data(), file.size()));
        auto core = BmpFile(33, 7, depth, 12);
        EXPECT_TRUE(BmpFileIsWhole(core.data(), core.size()));
    }
    auto topDown = BmpFile(10, -10, 24);
    EXPECT_TRUE(BmpFileIsWhole(topDown.data(), topDown.size()));
}

TEST(BmpFile, TruncatedFilesAreRejectedAtEveryLength) {
    auto file = BmpFile(21, 5, 8);
    for (std::size_t length = 0; length < file.size(); ++length) {
        SCOPED_TRACE(length);
        ASSERT_FALSE(BmpFileIsWhole(file.data(), length));
    }
    EXPECT_FALSE(BmpFileIsWhole(nullptr, 100));
}

TEST(BmpFile, HeadersThatPromiseTooMuchAreRejected) {
    struct Corruption {
        const char* what;
        std::size_t at;
        std::uint32_t value;
        bool wide;
    };
    const Corruption cases[] = {
        {"huge width", 18, 100000, true},       {"huge height", 22, 70000, true},
        {"zero width", 18, 0, true},            {"negative width", 18, 0xFFFFFFF0u, true},
        {"pixels past the end", 10, 5000, true}, {"unknown header size", 14, 64, true},
        {"two planes", 26, 2, false},           {"depth 7", 28, 7, false},
        {"unknown compression", 30, 9, true},   {"RLE without image size", 30, 1, true},
        {"too many colours", 46, 300, true},
    };
    for (const Corruption& corruption : cases) {
        SCOPED_TRACE(corruption.what);
        auto file = BmpFile(16, 16, 8);
        if (corruption.wide) {
            std::memcpy(&file[corruption.at], &corruption.value, 4);
        } else {
            std::uint16_t narrow = static_cast<std::uint16_t>(corruption.value);
            std::memcpy(&file[corruption.at], &narrow, 2);
        }
        EXPECT_FALSE(BmpFileIsWhole(file.data(), file.size()));
    }
    auto notBitmap = BmpFile(4, 4, 24);
    notBitmap[0] = 'P';
    EXPECT_FALSE(BmpFileIsWhole(notBitmap.data(), notBitmap.size()));
}

}  // namespace
