#include "graphics/dib.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>
#include <limits>
#include <vector>

namespace {

constexpr std::size_t kTooBig = std::numeric_limits<std::size_t>::max();

std::uint8_t* Bytes(DibBitmap* picture) {
    return reinterpret_cast<std::uint8_t*>(picture);
}

template <typename T>
void Put(void* block, std::size_t offset, T value) {
    std::memcpy(static_cast<std::uint8_t*>(block) + offset, &value, sizeof value);
}

// A header as GetDIBits or a file leaves it: 12-byte core or 40-byte information header.
std::vector<std::uint8_t> Header(std::uint32_t size, std::uint16_t bitCount,
                                 std::uint32_t compression = 0, std::uint32_t colorsUsed = 0) {
    std::vector<std::uint8_t> header(size);
    Put(header.data(), 0, size);
    if (size == 12) {
        Put(header.data(), 10, bitCount);
    } else {
        Put(header.data(), 14, bitCount);
        Put(header.data(), 16, compression);
        Put(header.data(), 32, colorsUsed);
    }
    return header;
}

TEST(DibLayout, ColourTableOfEveryHeaderKind) {
    struct Row {
        const char* name;
        std::vector<std::uint8_t> header;
        std::uint16_t colors, tableBytes;
    } rows[] = {
        {"24-bit has no table", Header(40, 24), 0, 0},
        {"8-bit, biClrUsed 0", Header(40, 8), 256, 1024},
        {"1-bit", Header(40, 1), 2, 8},
        {"biClrUsed wins", Header(40, 8, 0, 16), 16, 64},
        {"biClrUsed keeps its low 16 bits", Header(40, 8, 0, 70000), 4464, 17856},
        {"byte size truncated to 16 bits", Header(40, 8, 0, 0xFFFF), 0xFFFF, 0xFFFC},
        {"16-bit bit fields add three masks", Header(40, 16, 3), 0, 12},
        {"core 8-bit has RGBTRIPLEs", Header(12, 8), 256, 768},
        {"core 24-bit", Header(12, 24), 0, 0},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        EXPECT_EQ(DibColorCount(row.header.data()), row.colors);
        EXPECT_EQ(DibColorTableSize(row.header.data()), row.tableBytes);
    }
}

TEST(DibLayout, RowStrideKeepsSixteenBitsOfDoublewords) {
    struct Row {
        std::int32_t width;
        std::uint16_t bitCount;
        std::uint32_t stride;
    } rows[] = {{209, 24, 628}, {350, 8, 352}, {1, 1, 4},           {33, 1, 8},
                {9, 4, 8},      {5, 16, 12},   {131072, 8, 131072}, {262144, 8, 0}};
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << row.width << " px at " << row.bitCount << " bits");
        EXPECT_EQ(DibRowStride(row.width, row.bitCount), row.stride);
    }
}

TEST(DibStorage, ReallocKeepsTheCommonBytesAndAFailedGrowTheBlock) {
    DibPtr block(DibRealloc(nullptr, 64));
    ASSERT_TRUE(block);
    EXPECT_EQ(reinterpret_cast<std::uintptr_t>(block.get()) % 4, 0u);
    for (int i = 0; i < 64; ++i) Bytes(block.get())[i] = static_cast<std::uint8_t>(i);

    for (std::size_t size : {std::size_t{100000}, std::size_t{10}}) {
        SCOPED_TRACE(size);
        block.reset(DibRealloc(block.release(), size));
        ASSERT_TRUE(block);
        EXPECT_EQ(DibBlockSize(block.get()), size);
        EXPECT_EQ(Bytes(block.get())[9], 9);
    }
    // A failed grow leaves the block as it was.
    EXPECT_EQ(DibRealloc(block.get(), kTooBig), nullptr);
    EXPECT_EQ(DibBlockSize(block.get()), 10u);
    EXPECT_EQ(Bytes(block.get())[9], 9);
    EXPECT_EQ(DibAlloc(0x42, kTooBig), nullptr);
    EXPECT_EQ(DibBlockSize(nullptr), 0u);
    DibFree(nullptr);
}

// Nothing that reaches into the rows may trust a header that claims more than its block holds.
TEST(DibPictures, BlocksThatDoNotHoldWhatTheirHeaderClaimsAreNoPicture) {
    struct Row {
        const char* name;
        std::size_t offset, fieldBytes;  // header field patched with `value`; 0 bytes: none
        std::uint32_t value;
    } rows[] = {
        {"one row more than the block holds", 8, 4, 5},
        {"colour table overstated", 32, 4, 70000},
        {"unknown header size", 0, 4, 108},
        {"run-length compressed", 16, 4, 1},
        {"depth of 7 bits", 14, 2, 7},
        {"negative width", 4, 4, 0xFFFFFFFF},
        {"top-down rows", 8, 4, 0xFFFFFFFC},
        {"block one byte short", 0, 0, 0},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        DibPtr picture(CreateDib(6, 4, 8));
        std::memcpy(Bytes(picture.get()) + row.offset, &row.value, row.fieldBytes);
        if (row.fieldBytes == 0) {
            std::size_t shorter = DibBlockSize(picture.get()) - 1;
            picture.reset(DibRealloc(picture.release(), shorter));
        }
        EXPECT_FALSE(DibIsConsistent(picture.get()));
        std::uint8_t* pixels = nullptr;
        std::uint32_t stride = 77;
        std::uint16_t bitCount = 77;
        EXPECT_FALSE(DibRowInfo(picture.get(), pixels, stride, bitCount));
        EXPECT_EQ(stride, 77u);
        EXPECT_EQ(bitCount, 77);
        void* header = nullptr;
        void* table = nullptr;
        EXPECT_FALSE(DibParts(picture.get(), header, table, pixels));
        EXPECT_EQ(pixels, nullptr);
    }
    DibPtr stub(DibAlloc(0, 20));  // says 40 bytes of header, holds 20
    Put(stub.get(), 0, std::uint32_t{40});
    std::int32_t width = -1;
    std::int32_t height = -1;
    EXPECT_FALSE(DibDimensions(stub.get(), width, height));
    EXPECT_FALSE(DibDimensions(nullptr, width, height));
    EXPECT_EQ(width, -1);
}

// A stored picture as a resource or a file carries it: grey table at 8 bits, distinct bytes.
struct StoredPicture {
    std::vector<std::uint8_t> bytes;
    std::size_t pixelOffset;
};
StoredPicture Stored(std::int32_t width, std::int32_t height, std::uint16_t bitCount) {
    std::size_t table = bitCount == 8 ? 1024 : 0;
    std::size_t rows = DibRowStride(width, bitCount) * static_cast<std::size_t>(std::abs(height));
    StoredPicture picture{Header(40, bitCount), 40 + table};
    picture.bytes.resize(40 + table + rows);
    Put(picture.bytes.data(), 4, width);
    Put(picture.bytes.data(), 8, height);
    Put(picture.bytes.data(), 12, std::uint16_t{1});
    Put(picture.bytes.data(), 24, std::uint32_t{2835});  // 72 dots per inch
    Put(picture.bytes.data(), 28, std::uint32_t{2835});
    for (std::size_t level = 0; level < table / 4; ++level) {
        std::uint8_t entry[4] = {std::uint8_t(level), std::uint8_t(level), std::uint8_t(level), 0};
        std::memcpy(&picture.bytes[40 + level * 4], entry, 4);
    }
    for (std::size_t i = 0; i < rows; ++i) picture.bytes[40 + table + i] = std::uint8_t(i * 7 + 3);
    return picture;
}

DibPtr FromStored(const StoredPicture& picture) {
    return DibPtr(
        DibFromStoredPicture(picture.bytes.data(), picture.bytes.size(), picture.pixelOffset));
}

// Whatever the round trip through GDI would change, or what is not all there, is left to it.
TEST(DibFromStoredBytes, RowsFromTheirOffsetAndNullForWhatOnlyTheRoundTripCanMake) {
    struct Row {
        const char* name;
        void (*change)(StoredPicture&);
    };
    const Row rows[] = {
        {"core header", [](StoredPicture& p) { Put(p.bytes.data(), 0, std::uint32_t{12}); }},
        {"version 5 header", [](StoredPicture& p) { Put(p.bytes.data(), 0, std::uint32_t{124}); }},
        {"run-length compression",
         [](StoredPicture& p) { Put(p.bytes.data(), 16, std::uint32_t{1}); }},
        {"bit fields", [](StoredPicture& p) { Put(p.bytes.data(), 16, std::uint32_t{3}); }},
        {"top-down rows", [](StoredPicture& p) { Put(p.bytes.data(), 8, std::int32_t{-5}); }},
        {"two planes", [](StoredPicture& p) { Put(p.bytes.data(), 12, std::uint16_t{2}); }},
        {"16 bits", [](StoredPicture& p) { Put(p.bytes.data(), 14, std::uint16_t{16}); }},
        {"short colour table",
         [](StoredPicture& p) { Put(p.bytes.data(), 32, std::uint32_t{16}); }},
        {"table entry with a fourth byte", [](StoredPicture& p) { p.bytes[40 + 4 * 9 + 3] = 1; }},
        {"last row cut short", [](StoredPicture& p) { p.bytes.pop_back(); }},
        {"rows past the end", [](StoredPicture& p) { p.pixelOffset += 4; }},
        {"rows inside the table", [](StoredPicture& p) { p.pixelOffset -= 4; }},
        {"no width", [](StoredPicture& p) { Put(p.bytes.data(), 4, std::int32_t{0}); }},
    };
    // A file may leave a gap between the header and its rows, which are read from their offset.
    StoredPicture gap = Stored(4, 2, 24);
    gap.bytes.insert(gap.bytes.begin() + 40, 6, 0xEE);
    gap.pixelOffset += 6;
    DibPtr picture = FromStored(gap);
    ASSERT_TRUE(picture);
    EXPECT_EQ(std::memcmp(Bytes(picture.get()) + 40, gap.bytes.data() + 46, 24), 0);
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        StoredPicture stored = Stored(13, 5, 8);
        row.change(stored);
        EXPECT_FALSE(FromStored(stored));
    }
    StoredPicture colourTable = Stored(13, 5, 24);
    Put(colourTable.bytes.data(), 32, std::uint32_t{2});
    EXPECT_FALSE(FromStored(colourTable)) << "a 24-bit picture with a colour table";
    EXPECT_FALSE(DibFromStoredPicture(nullptr, 100, 40));
}

TEST(DibCopies, CopyDibPixelsOnlyBetweenPicturesOfOneShape) {
    DibPtr source(CreateDib(4, 4, 24));
    std::memset(Bytes(source.get()) + 40, 0xAB, 48);
    DibPtr same(CreateDib(4, 4, 24));
    EXPECT_TRUE(CopyDibPixels(same.get(), source.get()));
    EXPECT_EQ(std::memcmp(same.get(), source.get(), DibBlockSize(source.get())), 0);

    struct Row {
        const char* name;
        DibPtr destination, source;
    } rows[] = {
        {"smaller source", DibPtr(CreateDib(4, 5, 24)), DibPtr(CreateDib(4, 4, 24))},
        {"larger source", DibPtr(CreateDib(4, 3, 24)), DibPtr(CreateDib(4, 4, 24))},
        {"same size, 8 x 2 and 4 x 4", DibPtr(CreateDib(8, 2, 24)), DibPtr(CreateDib(4, 4, 24))},
        {"same size, 32 and 24 bits", DibPtr(CreateDib(1, 1, 32)), DibPtr(CreateDib(1, 1, 24))},
        {"same picture, longer block", DibPtr(DibRealloc(CreateDib(4, 4, 24), 100)),
         DibPtr(CreateDib(4, 4, 24))},
        {"no source", DibPtr(CreateDib(1, 1, 24)), nullptr},
    };
    for (Row& row : rows) {
        SCOPED_TRACE(row.name);
        DibPtr before(CloneDib(row.destination.get()));
        EXPECT_FALSE(CopyDibPixels(row.destination.get(), row.source.get()));
        EXPECT_EQ(std::memcmp(row.destination.get(), before.get(), DibBlockSize(before.get())), 0);
    }
    EXPECT_FALSE(CopyDibPixels(nullptr, source.get()));
}

}  // namespace
