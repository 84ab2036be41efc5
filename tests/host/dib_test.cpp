#include "graphics/dib.h"

#include <gtest/gtest.h>

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
        {"4-bit", Header(40, 4), 16, 64},
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

TEST(DibStorage, LengthWordInFrontAndReallocKeepsTheCommonBytes) {
    DibPtr block(DibRealloc(nullptr, 64));
    ASSERT_TRUE(block);
    EXPECT_EQ(reinterpret_cast<std::uintptr_t>(block.get()) % 4, 0u);
    std::uint32_t lengthWord = 0;
    std::memcpy(&lengthWord, Bytes(block.get()) - 4, 4);
    EXPECT_EQ(lengthWord, 64u);
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

TEST(DibPictures, CreatedPicturesAreWholeWithAGreyTable) {
    DibPtr mask(CreateDib(350, 350, 8));
    ASSERT_TRUE(mask);
    EXPECT_EQ(DibBlockSize(mask.get()), 40u + 1024 + 352 * 350);
    const void* header = nullptr;
    const void* table = nullptr;
    const std::uint8_t* pixels = nullptr;
    ASSERT_TRUE(DibParts(mask.get(), header, table, pixels));
    EXPECT_EQ(table, Bytes(mask.get()) + 40);
    EXPECT_EQ(pixels, Bytes(mask.get()) + 40 + 1024);
    EXPECT_EQ(Bytes(mask.get())[40 + 4 * 200 + 1], 200);  // green of grey level 200

    std::int32_t width = 0;
    std::int32_t height = 0;
    DibPtr plate(CreateDib(209, 49, 24));
    ASSERT_TRUE(DibDimensions(plate.get(), width, height));
    EXPECT_EQ(width, 209);
    EXPECT_EQ(height, 49);
    EXPECT_EQ(DibBlockSize(plate.get()), 40u + 628 * 49);

    struct Refused {
        std::int32_t width, height;
        std::uint16_t bitCount;
    } refused[] = {{0, 1, 24}, {1, 0, 24}, {-5, 5, 24}, {5, 5, 7}, {100000, 1, 24}};
    for (const Refused& row : refused) {
        SCOPED_TRACE(testing::Message() << row.width << "x" << row.height << "x" << row.bitCount);
        EXPECT_EQ(CreateDib(row.width, row.height, row.bitCount), nullptr);
    }
}

TEST(DibPictures, CoreHeaderReadsItsSixteenBitFields) {
    DibPtr picture(DibAlloc(0, 12 + 768 + 8 * 2));
    std::vector<std::uint8_t> header = Header(12, 8);
    Put(header.data(), 4, std::uint16_t{5});
    Put(header.data(), 6, std::uint16_t{2});
    std::memcpy(picture.get(), header.data(), header.size());
    std::int32_t width = 0;
    std::int32_t height = 0;
    EXPECT_TRUE(DibDimensions(picture.get(), width, height));
    EXPECT_EQ(width, 5);
    EXPECT_EQ(height, 2);
    std::uint8_t* pixels = nullptr;
    std::uint32_t stride = 0;
    std::uint16_t bitCount = 0;
    ASSERT_TRUE(DibRowInfo(picture.get(), pixels, stride, bitCount));
    EXPECT_EQ(pixels, Bytes(picture.get()) + 12 + 768);
    EXPECT_EQ(stride, 8u);
    EXPECT_EQ(bitCount, 8);
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

TEST(DibCopies, CloneIsIndependent) {
    EXPECT_EQ(CloneDib(nullptr), nullptr);
    DibPtr original(CreateDib(4, 3, 24));
    DibPtr clone(CloneDib(original.get()));
    ASSERT_EQ(DibBlockSize(clone.get()), DibBlockSize(original.get()));
    EXPECT_EQ(std::memcmp(clone.get(), original.get(), DibBlockSize(original.get())), 0);
    Bytes(clone.get())[45] = 99;
    EXPECT_EQ(Bytes(original.get())[45], 0);
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
