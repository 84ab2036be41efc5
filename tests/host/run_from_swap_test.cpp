#include <gtest/gtest.h>

#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

#include "pe_header.h"

namespace {

using runfromswap::AddCharacteristics;
using runfromswap::ImageChecksum;

constexpr std::size_t kPe = 0x80;  // where the test images put their PE header

// The smallest image the tool accepts: headers that reach just past the checksum field.
std::vector<std::uint8_t> TinyImage(std::uint16_t magic, std::uint16_t characteristics) {
    std::vector<std::uint8_t> image(kPe + 4 + 20 + 68, 0x5A);
    std::memcpy(&image[0], "MZ", 2);
    std::memcpy(&image[0x3C], "\x80\0\0\0", 4);  // kPe
    std::memcpy(&image[kPe], "PE\0\0", 4);
    image[kPe + 22] = static_cast<std::uint8_t>(characteristics);
    image[kPe + 23] = static_cast<std::uint8_t>(characteristics >> 8);
    image[kPe + 24] = static_cast<std::uint8_t>(magic);
    image[kPe + 25] = static_cast<std::uint8_t>(magic >> 8);
    return image;
}

std::uint32_t Read32(const std::vector<std::uint8_t>& image, std::size_t at) {
    return image[at] | image[at + 1] << 8 | image[at + 2] << 16 |
           static_cast<std::uint32_t>(image[at + 3]) << 24;
}

// The checksum arithmetic is checked end to end against MapFileAndCheckSum.
TEST(RunFromSwap, SetsBothFlagsKeepsTheOthersAndFixesTheChecksum) {
    for (std::uint16_t magic : {0x10B, 0x20B}) {
        SCOPED_TRACE(magic == 0x10B ? "PE32" : "PE32+");
        std::vector<std::uint8_t> image = TinyImage(magic, 0x0122);
        std::string error;
        ASSERT_TRUE(AddCharacteristics(image, 0x0C00, error)) << error;
        EXPECT_EQ(image[kPe + 22] | image[kPe + 23] << 8, 0x0D22);
        const std::size_t checksum = kPe + 24 + 64;
        EXPECT_EQ(Read32(image, checksum), ImageChecksum(image, checksum));
        EXPECT_NE(Read32(image, checksum), 0x5A5A5A5Au);
        // A second run changes nothing.
        std::vector<std::uint8_t> again = image;
        ASSERT_TRUE(AddCharacteristics(again, 0x0C00, error));
        EXPECT_EQ(again, image);
    }
}

TEST(RunFromSwap, RefusesWhatIsNotAProgramAndLeavesItAlone) {
    struct Row {
        const char* what;
        std::size_t at;
        std::vector<std::uint8_t> bytes;
    };
    const Row rows[] = {
        {"no MZ", 0, {'Z', 'M'}},
        {"header beyond the file", 0x3C, {0x00, 0x10, 0x00, 0x00}},
        {"header pointer that would wrap", 0x3C, {0xF0, 0xFF, 0xFF, 0xFF}},
        {"header too near the end", 0x3C, {kPe + 1, 0x00, 0x00, 0x00}},
        {"no PE signature", kPe, {'P', 'F'}},
        {"ROM optional header", kPe + 24, {0x07, 0x01}},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.what);
        std::vector<std::uint8_t> image = TinyImage(0x10B, 0x0102);
        std::copy(row.bytes.begin(), row.bytes.end(), image.begin() + row.at);
        const std::vector<std::uint8_t> before = image;
        std::string error;
        EXPECT_FALSE(AddCharacteristics(image, 0x0C00, error));
        EXPECT_FALSE(error.empty());
        EXPECT_EQ(image, before);
    }
    std::vector<std::uint8_t> tooShort(0x20, 0);
    std::string error;
    EXPECT_FALSE(AddCharacteristics(tooShort, 0x0C00, error));
}

}  // namespace
