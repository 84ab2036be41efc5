#include "graphics/bmp_file.h"

#include <gtest/gtest.h>

#include <cstring>

#include "test_files.h"

namespace {

TEST(BmpFile, WholeFilesOfEveryKindAreAcceptedAndCutOnesAtNoLength) {
    for (std::uint16_t depth : {1, 4, 8, 16, 24, 32}) {
        SCOPED_TRACE(depth);
        auto file = BmpFile(209, 49, depth);
        EXPECT_TRUE(BmpFileIsWhole(file.data(), file.size()));
        auto core = BmpFile(33, 7, depth, 12);
        EXPECT_TRUE(BmpFileIsWhole(core.data(), core.size()));
    }
    auto topDown = BmpFile(10, -10, 24);
    EXPECT_TRUE(BmpFileIsWhole(topDown.data(), topDown.size()));
    auto file = BmpFile(21, 5, 8);
    for (std::size_t length = 0; length < file.size(); ++length) {
        ASSERT_FALSE(BmpFileIsWhole(file.data(), length)) << length << " bytes";
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
        {"huge width", 18, 100000, true},
        {"huge height", 22, 70000, true},
        {"zero width", 18, 0, true},
        {"negative width", 18, 0xFFFFFFF0u, true},
        {"pixels past the end", 10, 5000, true},
        {"unknown header size", 14, 64, true},
        {"two planes", 26, 2, false},
        {"depth 7", 28, 7, false},
        {"unknown compression", 30, 9, true},
        {"RLE without image size", 30, 1, true},
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
