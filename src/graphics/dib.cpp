#include "graphics/dib.h"

#include <cstdlib>
#include <cstring>

namespace {

// The length word in front of every block.
constexpr std::size_t kLengthWordSize = 4;
constexpr std::size_t kMaxBlockSize = 0xFFFFFFFFu - kLengthWordSize;

std::uint8_t* Bytes(DibBitmap* picture) {
    return reinterpret_cast<std::uint8_t*>(picture);
}
const std::uint8_t* Bytes(const DibBitmap* picture) {
    return reinterpret_cast<const std::uint8_t*>(picture);
}

std::uint16_t ReadU16(const void* at, std::size_t offset) {
    std::uint16_t value;
    std::memcpy(&value, static_cast<const std::uint8_t*>(at) + offset, sizeof value);
    return value;
}

std::uint32_t ReadU32(const void* at, std::size_t offset) {
    std::uint32_t value;
    std::memcpy(&value, static_cast<const std::uint8_t*>(at) + offset, sizeof value);
    return value;
}

void WriteU16(void* at, std::size_t offset, std::uint16_t value) {
    std::memcpy(static_cast<std::uint8_t*>(at) + offset, &value, sizeof value);
}

void WriteU32(void* at, std::size_t offset, std::uint32_t value) {
    std::memcpy(static_cast<std::uint8_t*>(at) + offset, &value, sizeof value);
}

// The colour table size before the 16-bit truncation. The block checks refuse a table that does
// not fit 16 bits, so that this program and Windows agree on where the rows start.
std::uint32_t FullColorTableSize(const void* header) {
    std::uint32_t count = DibColorCount(header);
    DibHeaderFields fields = DibReadHeader(header);
    if (fields.headerSize == kDibCoreHeaderSize) return count * 3;
    return count * 4 + (fields.compression == kDibBitFields ? 12 : 0);
}

bool IsPixelDepth(std::uint16_t bitCount) {
    return bitCount == 1 || bitCount == 4 || bitCount == 8 || bitCount == 16 || bitCount == 24 ||
           bitCount == 32;
}

// Reads the header of a block only when the block holds a whole header of a known kind.
bool ReadBlockHeader(const DibBitmap* picture, DibHeaderFields& fields) {
    if (picture == nullptr) return false;
    std::size_t blockSize = DibBlockSize(picture);
    if (blockSize < 4) return false;
    std::uint32_t headerSize = ReadU32(picture, 0);
    if (headerSize != kDibCoreHeaderSize && headerSize != kDibInfoHeaderSize) return false;
    if (blockSize < headerSize) return false;
    fields = DibReadHeader(picture);
    return true;
}

// Bytes of header, colour table and rows that a picture of these fields needs, or 0 when the
// fields do not describe an uncompressed picture whose rows the stride can hold.
std::uint64_t NeededBlockSize(const DibHeaderFields& fields, std::uint32_t colorTableSize) {
    if (fields.width <= 0 || fields.height <= 0 || !IsPixelDepth(fields.bitCount)) return 0;
    if (fields.compression != kDibRgb && fields.compression != kDibBitFields) return 0;
    if (colorTableSize > 0xFFFF) return 0;
    std::uint64_t stride = DibRowStride(fields.width, fields.bitCount);
    // The stride formula keeps 16 bits of the row length, so a very wide row would wrap.
    std::uint64_t rowBytes = (static_cast<std::uint64_t>(fields.width) * fields.bitCount + 7) / 8;
    if (stride < rowBytes) return 0;
    return fields.headerSize + std::uint64_t{colorTableSize} +
           stride * static_cast<std::uint64_t>(fields.height);
}

}  // namespace

DibBitmap* DibAlloc(std::uint32_t /*flags*/, std::size_t size) {
    if (size > kMaxBlockSize) return nullptr;
    auto* base = static_cast<std::uint8_t*>(std::malloc(size + kLengthWordSize));
    if (base == nullptr) return nullptr;
    WriteU32(base, 0, static_cast<std::uint32_t>(size));
    return reinterpret_cast<DibBitmap*>(base + kLengthWordSize);
}

void DibFree(DibBitmap* picture) {
    if (picture != nullptr) std::free(Bytes(picture) - kLengthWordSize);
}

std::size_t DibBlockSize(const DibBitmap* picture) {
    if (picture == nullptr) return 0;
    return ReadU32(Bytes(picture) - kLengthWordSize, 0);
}

DibBitmap* DibRealloc(DibBitmap* picture, std::size_t size) {
    if (picture == nullptr) return DibAlloc(0, size);
    if (size > kMaxBlockSize) return nullptr;
    // realloc keeps min(old, new) bytes and leaves the old allocation alone when it fails.
    auto* base = static_cast<std::uint8_t*>(
        std::realloc(Bytes(picture) - kLengthWordSize, size + kLengthWordSize));
    if (base == nullptr) return nullptr;
    WriteU32(base, 0, static_cast<std::uint32_t>(size));
    return reinterpret_cast<DibBitmap*>(base + kLengthWordSize);
}

DibHeaderFields DibReadHeader(const void* header) {
    DibHeaderFields fields;
    fields.headerSize = ReadU32(header, 0);
    if (fields.headerSize == kDibCoreHeaderSize) {
        fields.width = ReadU16(header, 4);
        fields.height = ReadU16(header, 6);
        fields.bitCount = ReadU16(header, 10);
        return fields;
    }
    fields.width = static_cast<std::int32_t>(ReadU32(header, 4));
    fields.height = static_cast<std::int32_t>(ReadU32(header, 8));
    fields.bitCount = ReadU16(header, 14);
    fields.compression = ReadU32(header, 16);
    fields.colorsUsed = ReadU32(header, 32);
    return fields;
}

std::uint16_t DibColorCount(const void* header) {
    DibHeaderFields fields = DibReadHeader(header);
    if (fields.headerSize != kDibCoreHeaderSize && fields.colorsUsed != 0) {
        return static_cast<std::uint16_t>(fields.colorsUsed & 0xFFFF);
    }
    if (fields.bitCount > 8) return 0;
    return static_cast<std::uint16_t>(1u << fields.bitCount);
}

std::uint16_t DibColorTableSize(const void* header) {
    return static_cast<std::uint16_t>(FullColorTableSize(header) & 0xFFFF);
}

std::uint32_t DibRowStride(std::int32_t width, std::uint16_t bitCount) {
    // Unsigned arithmetic: only bits 5 to 20 of the product survive, so the wrap is harmless.
    std::uint32_t bits = static_cast<std::uint32_t>(width) * bitCount + 31;
    return ((bits >> 5) & 0xFFFF) * 4;
}

bool DibIsConsistent(const DibBitmap* picture) {
    DibHeaderFields fields;
    if (!ReadBlockHeader(picture, fields)) return false;
    std::uint64_t needed = NeededBlockSize(fields, FullColorTableSize(picture));
    return needed != 0 && needed <= DibBlockSize(picture);
}

DibBitmap* CreateDib(std::int32_t width, std::int32_t height, std::uint16_t bitCount) {
    DibHeaderFields fields;
    fields.headerSize = kDibInfoHeaderSize;
    fields.width = width;
    fields.height = height;
    fields.bitCount = bitCount;
    std::uint32_t colorCount = bitCount <= 8 ? 1u << bitCount : 0;
    std::uint64_t size = NeededBlockSize(fields, colorCount * 4);
    if (size == 0 || size > kMaxBlockSize) return nullptr;
    DibBitmap* picture = DibAlloc(0, static_cast<std::size_t>(size));
    if (picture == nullptr) return nullptr;

    std::uint8_t* bytes = Bytes(picture);
    std::memset(bytes, 0, static_cast<std::size_t>(size));
    WriteU32(bytes, 0, kDibInfoHeaderSize);
    WriteU32(bytes, 4, static_cast<std::uint32_t>(width));
    WriteU32(bytes, 8, static_cast<std::uint32_t>(height));
    WriteU16(bytes, 12, 1);
    WriteU16(bytes, 14, bitCount);
    WriteU32(bytes, 20, DibRowStride(width, bitCount) * static_cast<std::uint32_t>(height));
    std::uint8_t* table = bytes + kDibInfoHeaderSize;
    for (std::uint32_t i = 0; i < colorCount; ++i) {
        auto level = static_cast<std::uint8_t>(i * 255 / (colorCount - 1));
        std::uint8_t entry[4] = {level, level, level, 0};
        std::memcpy(table + i * 4, entry, 4);
    }
    return picture;
}

std::optional<StoredPictureLayout> StoredPictureLayoutOf(const std::uint8_t* info,
                                                         std::size_t available, std::size_t size,
                                                         std::size_t pixelOffset) {
    constexpr std::uint32_t kFullTable = 256;
    constexpr std::size_t kFullTableBytes = kFullTable * 4;
    if (info == nullptr || available > size || available < kDibInfoHeaderSize) return std::nullopt;
    DibHeaderFields fields = DibReadHeader(info);
    if (fields.headerSize != kDibInfoHeaderSize || fields.compression != kDibRgb ||
        ReadU16(info, 12) != 1 || fields.width <= 0 || fields.height <= 0) {
        return std::nullopt;
    }
    StoredPictureLayout layout{};
    if (fields.bitCount == 8) {
        // GetDIBits hands back the section's table at full length; a shorter one would leave
        // entries this cannot know.
        if (fields.colorsUsed != 0 && fields.colorsUsed != kFullTable) return std::nullopt;
        layout.tableBytes = kFullTableBytes;
        if (available < kDibInfoHeaderSize + kFullTableBytes) return std::nullopt;
        for (std::size_t entry = 0; entry < kFullTable; ++entry) {
            if (info[kDibInfoHeaderSize + entry * 4 + 3] != 0) return std::nullopt;
        }
    } else if (fields.bitCount != 24 || fields.colorsUsed != 0) {
        return std::nullopt;
    }
    std::uint64_t stride = DibRowStride(fields.width, fields.bitCount);
    std::uint64_t rowBytes = stride * static_cast<std::uint64_t>(fields.height);
    // The stride keeps 16 bits of the row length, so a very wide row would wrap.
    if (stride < (static_cast<std::uint64_t>(fields.width) * fields.bitCount + 7) / 8 ||
        pixelOffset < kDibInfoHeaderSize + layout.tableBytes || pixelOffset > size ||
        rowBytes > size - pixelOffset ||
        rowBytes > kMaxBlockSize - kDibInfoHeaderSize - layout.tableBytes) {
        return std::nullopt;
    }
    layout.pixelOffset = pixelOffset;
    layout.rowBytes = static_cast<std::size_t>(rowBytes);
    return layout;
}

DibBitmap* DibForStoredPicture(const std::uint8_t* info, const StoredPictureLayout& layout) {
    DibBitmap* picture = DibAlloc(0, kDibInfoHeaderSize + layout.tableBytes + layout.rowBytes);
    if (picture == nullptr) return nullptr;
    // GetDIBits fills in the image size and leaves the fields it was given as zero.
    DibHeaderFields fields = DibReadHeader(info);
    std::uint8_t* bytes = Bytes(picture);
    std::memset(bytes, 0, kDibInfoHeaderSize);
    WriteU32(bytes, 0, kDibInfoHeaderSize);
    WriteU32(bytes, 4, static_cast<std::uint32_t>(fields.width));
    WriteU32(bytes, 8, static_cast<std::uint32_t>(fields.height));
    WriteU16(bytes, 12, 1);
    WriteU16(bytes, 14, fields.bitCount);
    WriteU32(bytes, 20, static_cast<std::uint32_t>(layout.rowBytes));
    std::memcpy(bytes + kDibInfoHeaderSize, info + kDibInfoHeaderSize, layout.tableBytes);
    return picture;
}

DibBitmap* DibFromStoredPicture(const std::uint8_t* info, std::size_t size,
                                std::size_t pixelOffset) {
    std::optional<StoredPictureLayout> layout =
        StoredPictureLayoutOf(info, size, size, pixelOffset);
    if (!layout) return nullptr;
    DibBitmap* picture = DibForStoredPicture(info, *layout);
    if (picture == nullptr) return nullptr;
    std::memcpy(Bytes(picture) + kDibInfoHeaderSize + layout->tableBytes, info + pixelOffset,
                layout->rowBytes);
    return picture;
}

DibBitmap* CloneDib(const DibBitmap* picture) {
    if (picture == nullptr) return nullptr;
    std::size_t size = DibBlockSize(picture);
    DibBitmap* clone = DibAlloc(0, size);
    if (clone == nullptr) return nullptr;
    std::memcpy(clone, picture, size);
    return clone;
}

bool CopyDibPixels(DibBitmap* destination, const DibBitmap* source) {
    DibHeaderFields to;
    DibHeaderFields from;
    if (!ReadBlockHeader(destination, to) || !ReadBlockHeader(source, from)) return false;
    if (DibBlockSize(destination) != DibBlockSize(source)) return false;
    if (to.width != from.width || to.height != from.height || to.bitCount != from.bitCount) {
        return false;
    }
    std::memmove(destination, source, DibBlockSize(source));
    return true;
}

bool DibDimensions(const DibBitmap* picture, std::int32_t& width, std::int32_t& height) {
    DibHeaderFields fields;
    if (!ReadBlockHeader(picture, fields)) return false;
    width = fields.width;
    height = fields.height;
    return true;
}

bool DibParts(const DibBitmap* picture, const void*& header, const void*& colorTable,
              const std::uint8_t*& pixels) {
    if (!DibIsConsistent(picture)) return false;
    const std::uint8_t* bytes = Bytes(picture);
    std::uint32_t headerSize = ReadU32(bytes, 0);
    header = bytes;
    colorTable = bytes + headerSize;
    pixels = bytes + headerSize + DibColorTableSize(bytes);
    return true;
}

bool DibParts(DibBitmap* picture, void*& header, void*& colorTable, std::uint8_t*& pixels) {
    const void* constHeader;
    const void* constTable;
    const std::uint8_t* constPixels;
    if (!DibParts(static_cast<const DibBitmap*>(picture), constHeader, constTable, constPixels)) {
        return false;
    }
    // Same block, reached through the writable pointer the caller holds.
    std::uint8_t* bytes = Bytes(picture);
    header = bytes;
    colorTable = bytes + (static_cast<const std::uint8_t*>(constTable) - Bytes(picture));
    pixels = bytes + (constPixels - Bytes(picture));
    return true;
}

bool DibRowInfo(const DibBitmap* picture, const std::uint8_t*& pixels, std::uint32_t& stride,
                std::uint16_t& bitCount) {
    const void* header;
    const void* colorTable;
    const std::uint8_t* rows;
    if (!DibParts(picture, header, colorTable, rows)) return false;
    DibHeaderFields fields = DibReadHeader(header);
    pixels = rows;
    stride = DibRowStride(fields.width, fields.bitCount);
    bitCount = fields.bitCount;
    return true;
}

bool DibRowInfo(DibBitmap* picture, std::uint8_t*& pixels, std::uint32_t& stride,
                std::uint16_t& bitCount) {
    const std::uint8_t* rows;
    if (!DibRowInfo(static_cast<const DibBitmap*>(picture), rows, stride, bitCount)) return false;
    pixels = Bytes(picture) + (rows - Bytes(picture));
    return true;
}
