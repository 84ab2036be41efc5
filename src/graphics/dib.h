// Pictures held as packed device-independent bitmaps: one block with the bitmap header, its
// colour table and the pixel rows (bottom-up, each padded to 4 bytes), laid out as Windows
// reads a packed DIB. Nothing here needs Windows, so the host tests run all of it.
#ifndef AUTOPLAY_GRAPHICS_DIB_H
#define AUTOPLAY_GRAPHICS_DIB_H

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>

// Never defined: a DibBitmap* points at the first byte of the block. Null means no picture.
struct DibBitmap;

constexpr std::uint32_t kDibCoreHeaderSize = 12;  // BITMAPCOREHEADER
constexpr std::uint32_t kDibInfoHeaderSize = 40;  // BITMAPINFOHEADER
constexpr std::uint32_t kDibRgb = 0;              // BI_RGB
constexpr std::uint32_t kDibBitFields = 3;        // BI_BITFIELDS

// Storage: a heap block with its 32-bit length stored just in front of it. The block is 4-byte
// aligned, so Windows can read it as a BITMAPINFO. The flags are the global-memory flags the
// callers pass; they change nothing (the block is neither zero-filled nor movable).
DibBitmap* DibAlloc(std::uint32_t flags, std::size_t size);
void DibFree(DibBitmap* picture);
std::size_t DibBlockSize(const DibBitmap* picture);
// A null picture is allocated anew. Otherwise the first min(old, new) bytes move to the new
// block; on failure the result is null and the old block stays valid and unchanged.
DibBitmap* DibRealloc(DibBitmap* picture, std::size_t size);

struct DibFreeDeleter {
    void operator()(DibBitmap* picture) const { DibFree(picture); }
};
using DibPtr = std::unique_ptr<DibBitmap, DibFreeDeleter>;

// The header fields this program uses, read from either header kind. A core header has no
// compression field (it is always uncompressed).
struct DibHeaderFields {
    std::uint32_t headerSize = 0;
    std::int32_t width = 0;
    std::int32_t height = 0;
    std::uint16_t bitCount = 0;
    std::uint32_t compression = kDibRgb;
    std::uint32_t colorsUsed = 0;
};

// `header` must hold a whole header of the kind its first word names; any size other than
// the 12-byte core header is read with the 40-byte layout.
DibHeaderFields DibReadHeader(const void* header);
std::uint16_t DibColorCount(const void* header);
// Truncated to 16 bits, as the header's colour count is.
std::uint16_t DibColorTableSize(const void* header);
std::uint32_t DibRowStride(std::int32_t width, std::uint16_t bitCount);

// True when the block is an uncompressed picture of a known header kind, a positive size and
// a depth of 1, 4, 8, 16, 24 or 32 bits whose header, colour table and every pixel row lie
// inside the block. Everything that reaches into the rows treats any other block as no picture.
bool DibIsConsistent(const DibBitmap* picture);

// A 40-byte-header picture with zeroed pixels; depths of 8 bits or fewer get a grey ramp as
// colour table (256 levels at 8 bits). Null for a size or depth that cannot be a picture.
DibBitmap* CreateDib(std::int32_t width, std::int32_t height, std::uint16_t bitCount);

// The block a stored picture becomes when the system loads it into a DIB section and it is
// read back at its own depth (DibFromBitmap), made straight from the stored bytes: the header
// rewritten as GetDIBits writes it, the colour table and the rows copied. `info` is the
// picture's info header (a bitmap resource, or a bitmap file after its 14-byte file header),
// `size` bytes are readable from it and the rows start `pixelOffset` bytes after it.
// Null for what this cannot make exactly that way: any header but the 40-byte one, any
// compression, top-down rows, depths other than 8 and 24 bits, a colour table other than 256
// plain entries at 8 bits or any at 24, and rows that are not all there.
DibBitmap* DibFromStoredPicture(const std::uint8_t* info, std::size_t size,
                                std::size_t pixelOffset);

// The same in two steps, for rows that are read straight into the block: where they go, then
// a block with its header and colour table written and its rows left to the caller. Only the
// header and the colour table need be among the `available` bytes from `info` on; `size` is
// the length of the whole stored picture.
struct StoredPictureLayout {
    std::size_t tableBytes;
    std::size_t pixelOffset;  // of the stored rows, from `info`
    std::size_t rowBytes;     // which end the block
};
std::optional<StoredPictureLayout> StoredPictureLayoutOf(const std::uint8_t* info,
                                                         std::size_t available, std::size_t size,
                                                         std::size_t pixelOffset);
DibBitmap* DibForStoredPicture(const std::uint8_t* info, const StoredPictureLayout& layout);

// A new block with the same bytes; null for null or when memory runs out.
DibBitmap* CloneDib(const DibBitmap* picture);
// Copies the whole source block (header, colour table, rows) over the destination. Only
// pictures of identical block size, width, height and depth are copied; otherwise nothing is
// written and the result is false.
bool CopyDibPixels(DibBitmap* destination, const DibBitmap* source);

// False for null or a block too short for its own header; the outputs are then untouched.
bool DibDimensions(const DibBitmap* picture, std::int32_t& width, std::int32_t& height);

// Start of the header, the colour table and the first stored (bottom) row. False, outputs
// untouched, for null or a block that is not consistent.
bool DibParts(const DibBitmap* picture, const void*& header, const void*& colorTable,
              const std::uint8_t*& pixels);
bool DibParts(DibBitmap* picture, void*& header, void*& colorTable, std::uint8_t*& pixels);

// The first stored (bottom) row, the distance between rows and the depth. False, outputs
// untouched, for null or a block that is not consistent.
bool DibRowInfo(const DibBitmap* picture, const std::uint8_t*& pixels, std::uint32_t& stride,
                std::uint16_t& bitCount);
bool DibRowInfo(DibBitmap* picture, std::uint8_t*& pixels, std::uint32_t& stride,
                std::uint16_t& bitCount);

#endif
