#include "graphics/bmp_file.h"

#include <cstring>
#include <vector>

namespace {

constexpr std::size_t kFileHeaderSize = 14;
constexpr std::uint32_t kCoreHeaderSize = 12;
// Of the larger info headers only the fields of the 40-byte one are read.
constexpr std::size_t kInfoFieldsRead = 40;
// Pictures larger than this on either side are not launcher pictures.
constexpr std::int64_t kLargestSide = 16384;
// Leaves room for a file header in front within the 32-bit sizes of bitmap files.
constexpr std::size_t kLargestPackedDib = 0x7FFFFFFF;

std::uint32_t Read32(const std::uint8_t* at) {
    std::uint32_t value;
    std::memcpy(&value, at, 4);
    return value;
}

std::uint16_t Read16(const std::uint8_t* at) {
    std::uint16_t value;
    std::memcpy(&value, at, 2);
    return value;
}

}  // namespace

bool BmpFileIsWhole(const std::uint8_t* data, std::size_t size) {
    return BmpFileIsWhole(data, size, size);
}

bool BmpFileIsWhole(const std::uint8_t* data, std::size_t available, std::uint64_t size) {
    if (data == nullptr || available > size || available < kFileHeaderSize + kCoreHeaderSize) {
        return false;
    }
    if (data[0] != 'B' || data[1] != 'M') return false;
    const std::uint64_t pixelOffset = Read32(data + 10);
    const std::uint8_t* info = data + kFileHeaderSize;
    const std::uint32_t headerSize = Read32(info);

    std::int64_t width = 0;
    std::int64_t height = 0;
    std::uint16_t planes = 0;
    std::uint16_t bitCount = 0;
    std::uint32_t compression = 0;
    std::uint32_t imageSize = 0;
    std::uint64_t colors = 0;
    std::uint64_t entrySize = 4;
    if (headerSize == kCoreHeaderSize) {
        width = Read16(info + 4);
        height = Read16(info + 6);
        planes = Read16(info + 8);
        bitCount = Read16(info + 10);
        entrySize = 3;
    } else if (headerSize == 40 || headerSize == 52 || headerSize == 56 || headerSize == 108 ||
               headerSize == 124) {
        if (size < kFileHeaderSize + headerSize) return false;
        if (available < kFileHeaderSize + kInfoFieldsRead) return false;
        width = static_cast<std::int32_t>(Read32(info + 4));
        height = static_cast<std::int32_t>(Read32(info + 8));
        planes = Read16(info + 12);
        bitCount = Read16(info + 14);
        compression = Read32(info + 16);
        imageSize = Read32(info + 20);
        colors = Read32(info + 32);
    } else {
        return false;
    }
    if (height < 0) height = -height;  // top-down rows
    if (planes != 1 || width <= 0 || height <= 0 || width > kLargestSide || height > kLargestSide) {
        return false;
    }
    switch (bitCount) {
        case 1: case 4: case 8: case 16: case 24: case 32:
            break;
        default:
            return false;
    }
    if (colors == 0 && bitCount <= 8) colors = std::uint64_t{1} << bitCount;
    if (colors > 256 && bitCount <= 8) return false;
    std::uint64_t tableEnd = kFileHeaderSize + headerSize + colors * entrySize;
    // Bit-field masks follow a 40-byte header; larger headers carry them inside.
    if (compression == 3 && headerSize == 40) tableEnd += 12;
    if (tableEnd > size || pixelOffset < kFileHeaderSize + headerSize || pixelOffset > size) {
        return false;
    }

    const std::uint64_t stride = ((static_cast<std::uint64_t>(width) * bitCount + 31) / 32) * 4;
    std::uint64_t pixelBytes = stride * static_cast<std::uint64_t>(height);
    switch (compression) {
        case 0:  // uncompressed
        case 3:  // bit fields
            break;
        case 1:  // RLE8
        case 2:  // RLE4
            if ((compression == 1 && bitCount != 8) || (compression == 2 && bitCount != 4)) {
                return false;
            }
            if (imageSize == 0) return false;
            pixelBytes = imageSize;
            break;
        default:
            return false;
    }
    return pixelOffset + pixelBytes <= size;
}

std::optional<DibHeaderFields> WholeBmpFileHeader(const std::uint8_t* data, std::size_t size) {
    if (!BmpFileIsWhole(data, size)) return std::nullopt;
    return DibReadHeader(data + kFileHeaderSize);
}

std::optional<DibHeaderFields> WholePackedDibHeader(const std::uint8_t* data, std::size_t size) {
    // DibReadHeader reads the 40-byte layout for every header but the 12-byte core one.
    if (data == nullptr || size < 4 || size > kLargestPackedDib) return std::nullopt;
    const std::uint32_t headerSize = Read32(data);
    if (headerSize > size ||
        size < (headerSize == kCoreHeaderSize ? kCoreHeaderSize : kDibInfoHeaderSize)) {
        return std::nullopt;
    }
    // The rows follow the colour table, as Windows reads a packed bitmap: in front of a file
    // header saying so, the block gets the very check a file from the disc gets.
    const std::uint32_t pixelOffset = kFileHeaderSize + headerSize + DibColorTableSize(data);
    std::vector<std::uint8_t> file(kFileHeaderSize);
    file[0] = 'B';
    file[1] = 'M';
    const auto fileSize = static_cast<std::uint32_t>(kFileHeaderSize + size);
    std::memcpy(&file[2], &fileSize, 4);
    std::memcpy(&file[10], &pixelOffset, 4);
    file.insert(file.end(), data, data + size);
    return WholeBmpFileHeader(file.data(), file.size());
}
