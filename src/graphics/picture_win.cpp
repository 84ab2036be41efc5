#include "graphics/picture_win.h"

#include <cstdlib>
#include <cstring>
#include <optional>
#include <vector>

#include "graphics/bmp_file.h"
#include "platform/handles_win.h"
#include "shell/launcher_state.h"

namespace {

constexpr std::size_t kPaletteEntries = 256;
constexpr std::size_t kPaletteTableBytes = kPaletteEntries * 4;
constexpr std::size_t kSystemColorsAtEachEnd = 10;

// Shows the wait cursor until it goes, keeping the previous cursor for the launcher.
class WaitCursor {
public:
    WaitCursor() { launcher.savedCursor = SetCursor(LoadCursorW(nullptr, IDC_WAIT)); }
    ~WaitCursor() { SetCursor(launcher.savedCursor); }
    WaitCursor(const WaitCursor&) = delete;
    WaitCursor& operator=(const WaitCursor&) = delete;
};

const BITMAPINFO* InfoOf(const DibBitmap* picture) {
    return reinterpret_cast<const BITMAPINFO*>(picture);
}

}  // namespace

DibBitmap* DibFromBitmap(HBITMAP bitmap, std::uint32_t compression, std::uint16_t bitCount,
                         HPALETTE palette) {
    if (!bitmap) return nullptr;
    if (!palette) palette = static_cast<HPALETTE>(GetStockObject(DEFAULT_PALETTE));
    BITMAP info{};
    if (GetObjectW(bitmap, sizeof(info), &info) == 0) return nullptr;
    if (bitCount == 0) bitCount = static_cast<std::uint16_t>(info.bmPlanes * info.bmBitsPixel);

    BITMAPINFOHEADER header{};
    header.biSize = sizeof(header);
    header.biWidth = info.bmWidth;
    header.biHeight = info.bmHeight;
    header.biPlanes = 1;
    header.biBitCount = bitCount;
    header.biCompression = compression;

    WindowDc screen(nullptr);
    if (!screen.Get()) return nullptr;
    // Both GetDIBits calls see the colours through the palette, so it stays selected for both.
    HPALETTE previous = SelectPalette(screen.Get(), palette, FALSE);
    RealizePalette(screen.Get());

    std::size_t tableSize = DibColorTableSize(&header);
    DibPtr block(DibAlloc(0x42, sizeof(header) + tableSize));
    bool ok = static_cast<bool>(block);
    if (ok) {
        std::memcpy(block.get(), &header, sizeof(header));
        // First pass: no pixel buffer; GDI fills in the image size and the colour table.
        ok = GetDIBits(screen.Get(), bitmap, 0, static_cast<UINT>(info.bmHeight), nullptr,
                       reinterpret_cast<BITMAPINFO*>(block.get()), DIB_RGB_COLORS) != 0;
    }
    if (ok) {
        std::memcpy(&header, block.get(), sizeof(header));
        if (header.biSizeImage == 0) {
            header.biSizeImage = DibRowStride(header.biWidth, bitCount) *
                                 static_cast<std::uint32_t>(std::abs(header.biHeight));
            if (compression != BI_RGB) header.biSizeImage = header.biSizeImage * 3 / 2;
            std::memcpy(block.get(), &header, sizeof(header));
        }
        DibBitmap* grown = DibRealloc(block.get(), sizeof(header) + tableSize + header.biSizeImage);
        if (grown) {
            block.release();
            block.reset(grown);
        } else {
            ok = false;
        }
    }
    if (ok) {
        auto* bytes = reinterpret_cast<std::uint8_t*>(block.get());
        ok = GetDIBits(screen.Get(), bitmap, 0, static_cast<UINT>(info.bmHeight),
                       bytes + sizeof(header) + tableSize,
                       reinterpret_cast<BITMAPINFO*>(block.get()), DIB_RGB_COLORS) != 0;
    }
    SelectPalette(screen.Get(), previous, FALSE);
    return ok ? block.release() : nullptr;
}

HBITMAP BitmapFromDib(const DibBitmap* picture, HPALETTE palette) {
    WaitCursor wait;
    const void* header = nullptr;
    const void* table = nullptr;
    const std::uint8_t* pixels = nullptr;
    if (!DibParts(picture, header, table, pixels)) return nullptr;
    WindowDc screen(nullptr);
    if (!screen.Get()) return nullptr;
    PaletteGuard selected(screen.Get(), palette);
    return CreateDIBitmap(screen.Get(), static_cast<const BITMAPINFOHEADER*>(header), CBM_INIT,
                          pixels, InfoOf(picture), DIB_RGB_COLORS);
}

int StretchDibBlt(HDC dc, int x, int y, int width, int height, const DibBitmap* picture,
                  int sourceX, int sourceY, int sourceWidth, int sourceHeight, DWORD rop) {
    const void* header = nullptr;
    const void* table = nullptr;
    const std::uint8_t* pixels = nullptr;
    if (!DibParts(picture, header, table, pixels)) return PatBlt(dc, x, y, width, height, rop);
    return StretchDIBits(dc, x, y, width, height, sourceX, sourceY, sourceWidth, sourceHeight,
                         pixels, InfoOf(picture), DIB_RGB_COLORS, rop);
}

namespace {

DibBitmap* PictureFromLoadedImage(HANDLE image) {
    UniqueGdi<HBITMAP> bitmap(static_cast<HBITMAP>(image));
    if (!bitmap) return nullptr;
    DibBitmap* picture = DibFromBitmap(bitmap.Get(), BI_RGB, 0, launcher.palette.Get());
    // A block GDI made but that does not hold a whole picture is as good as none.
    if (picture && !DibIsConsistent(picture)) {
        DibFree(picture);
        return nullptr;
    }
    return picture;
}

// Whether LoadImage into a DIB section and GetDIBits give back a picture's stored bytes:
// only when no palette stands between them, on displays of more than 8 bits per pixel.
// The display's depth does not change while the launcher loads its pictures.
bool StoredBytesSurviveGdi(UINT flags) {
    static const bool deepDisplay = [] {
        WindowDc screen(nullptr);
        return screen.Get() && GetDeviceCaps(screen.Get(), BITSPIXEL) > 8;
    }();
    return deepDisplay && (flags & ~static_cast<UINT>(LR_LOADFROMFILE)) == LR_CREATEDIBSECTION;
}

constexpr DWORD kLargestPictureFile = 64 * 1024 * 1024;
constexpr std::size_t kBmpFileHeaderSize = 14;
// The file header, an info header and an 8-bit colour table: all the check and the start of
// a block need; the rows are read straight into the block.
constexpr std::size_t kBmpHeadSize = kBmpFileHeaderSize + kDibInfoHeaderSize + 256 * 4;

bool ReadExactly(HANDLE file, void* into, std::size_t size) {
    DWORD read = 0;
    return ReadFile(file, into, static_cast<DWORD>(size), &read, nullptr) && read == size;
}

}  // namespace

DibBitmap* LoadPictureResourceThroughGdi(WORD id, UINT flags) {
    return PictureFromLoadedImage(
        LoadImageW(launcher.instance, MAKEINTRESOURCEW(id), IMAGE_BITMAP, 0, 0, flags));
}

DibBitmap* PictureFromResourceBytes(WORD id) {
    HRSRC found = FindResourceW(launcher.instance, MAKEINTRESOURCEW(id), RT_BITMAP);
    if (!found) return nullptr;
    HGLOBAL loaded = LoadResource(launcher.instance, found);
    const auto* bytes = static_cast<const std::uint8_t*>(loaded ? LockResource(loaded) : nullptr);
    DWORD size = SizeofResource(launcher.instance, found);
    if (!bytes || size < kDibInfoHeaderSize) return nullptr;
    // In a packed DIB the rows follow the colour table.
    return DibFromStoredPicture(bytes, size, kDibInfoHeaderSize + DibColorTableSize(bytes));
}

DibBitmap* LoadPictureResource(WORD id, UINT flags) {
    if (StoredBytesSurviveGdi(flags)) {
        if (DibBitmap* picture = PictureFromResourceBytes(id)) return picture;
    }
    return LoadPictureResourceThroughGdi(id, flags);
}

DibBitmap* LoadPictureFileThroughGdi(const wchar_t* path, UINT flags) {
    return PictureFromLoadedImage(LoadImageW(nullptr, path, IMAGE_BITMAP, 0, 0, flags));
}

namespace {

// A picture file opened and its head checked: the system's loader trusts the file's header, so
// a file from the disc is looked at first, and a truncated or corrupt one counts as missing.
struct CheckedPictureFile {
    UniqueHandle file;
    std::size_t size = 0;
    std::uint8_t head[kBmpHeadSize];
    std::size_t headSize = 0;
};

bool OpenCheckedPictureFile(const wchar_t* path, CheckedPictureFile& checked) {
    checked.file.Reset(CreateFileW(path, GENERIC_READ, FILE_SHARE_READ, nullptr, OPEN_EXISTING,
                                   FILE_ATTRIBUTE_NORMAL | FILE_FLAG_SEQUENTIAL_SCAN, nullptr));
    if (!checked.file) return false;
    LARGE_INTEGER fileSize{};
    if (!GetFileSizeEx(checked.file.Get(), &fileSize) || fileSize.QuadPart > kLargestPictureFile) {
        return false;
    }
    checked.size = static_cast<std::size_t>(fileSize.QuadPart);
    checked.headSize = checked.size < kBmpHeadSize ? checked.size : kBmpHeadSize;
    return ReadExactly(checked.file.Get(), checked.head, checked.headSize) &&
           BmpFileIsWhole(checked.head, checked.headSize, checked.size);
}

}  // namespace

DibBitmap* ReadStoredPictureFile(const wchar_t* path, bool& gdiNeeded) {
    gdiNeeded = false;
    CheckedPictureFile checked;
    if (!OpenCheckedPictureFile(path, checked)) return nullptr;
    std::uint32_t pixelOffset = 0;
    std::memcpy(&pixelOffset, checked.head + 10, sizeof(pixelOffset));
    // The check has made sure the rows start after the headers and end inside the file.
    std::optional<StoredPictureLayout> layout = StoredPictureLayoutOf(
        checked.head + kBmpFileHeaderSize, checked.headSize - kBmpFileHeaderSize,
        checked.size - kBmpFileHeaderSize, pixelOffset - kBmpFileHeaderSize);
    if (!layout) {
        gdiNeeded = true;
        return nullptr;
    }
    DibPtr picture(DibForStoredPicture(checked.head + kBmpFileHeaderSize, *layout));
    LARGE_INTEGER rows{};
    rows.QuadPart = pixelOffset;
    if (!picture || !SetFilePointerEx(checked.file.Get(), rows, nullptr, FILE_BEGIN)) {
        return nullptr;
    }
    auto* block = reinterpret_cast<std::uint8_t*>(picture.get());
    // Whole a moment ago and unreadable now is as good as missing.
    if (!ReadExactly(checked.file.Get(), block + DibBlockSize(picture.get()) - layout->rowBytes,
                     layout->rowBytes)) {
        return nullptr;
    }
    return picture.release();
}

DibBitmap* LoadPictureFile(const wchar_t* path, UINT flags) {
    if (StoredBytesSurviveGdi(flags)) {
        bool gdiNeeded = false;
        DibBitmap* picture = ReadStoredPictureFile(path, gdiNeeded);
        return gdiNeeded ? LoadPictureFileThroughGdi(path, flags) : picture;
    }
    CheckedPictureFile checked;
    if (!OpenCheckedPictureFile(path, checked)) return nullptr;
    checked.file.Reset();
    return LoadPictureFileThroughGdi(path, flags);
}

// Whether stored bytes are taken as they are for pictures loaded with these flags.
bool PicturesKeepTheirStoredBytes(UINT flags) { return StoredBytesSurviveGdi(flags); }

bool LoadPaletteResource(WORD id, LOGPALETTE* palette) {
    constexpr std::size_t kHeaderBytes = 24;
    constexpr std::size_t kRoomForEntries = 257;
    HRSRC found = FindResourceW(launcher.instance, MAKEINTRESOURCEW(id), L"IDR_PALETTE");
    if (!found) return false;
    HGLOBAL loaded = LoadResource(launcher.instance, found);
    const auto* bytes = static_cast<const std::uint8_t*>(loaded ? LockResource(loaded) : nullptr);
    DWORD size = SizeofResource(launcher.instance, found);
    if (!bytes || size < kHeaderBytes) return false;
    std::uint16_t version = 0;
    std::uint16_t count = 0;
    std::memcpy(&version, bytes + 20, 2);
    std::memcpy(&count, bytes + 22, 2);
    // Never more entries than the buffer holds or the resource carries.
    std::size_t entries = count;
    if (entries > kRoomForEntries) entries = kRoomForEntries;
    if (entries > (size - kHeaderBytes) / 4) entries = (size - kHeaderBytes) / 4;
    palette->palVersion = version;
    palette->palNumEntries = static_cast<WORD>(entries);
    std::memcpy(palette->palPalEntry, bytes + kHeaderBytes, entries * 4);
    return true;
}

HPALETTE CreateLauncherPalette() {
    WindowDc screen(nullptr);
    if (!screen.Get()) return nullptr;
    if (GetDeviceCaps(screen.Get(), BITSPIXEL) > 8) return nullptr;

    // LOGPALETTE holds one entry itself; room for 257 in all.
    std::vector<std::uint8_t> buffer(sizeof(LOGPALETTE) + 256 * sizeof(PALETTEENTRY), 0);
    auto* logical = reinterpret_cast<LOGPALETTE*>(buffer.data());
    logical->palVersion = 0x300;
    logical->palNumEntries = kPaletteEntries;
    LoadPaletteResource(kPaletteResource, logical);
    logical->palNumEntries = kPaletteEntries;
    GetSystemPaletteEntries(screen.Get(), 0, kSystemColorsAtEachEnd, logical->palPalEntry);
    GetSystemPaletteEntries(screen.Get(), kPaletteEntries - kSystemColorsAtEachEnd,
                            kSystemColorsAtEachEnd,
                            logical->palPalEntry + kPaletteEntries - kSystemColorsAtEachEnd);

    DibPtr table(DibAlloc(0x42, kPaletteTableBytes));
    if (table) {
        auto* quads = reinterpret_cast<RGBQUAD*>(table.get());
        for (std::size_t i = 0; i < kPaletteEntries; ++i) {
            quads[i].rgbBlue = logical->palPalEntry[i].peBlue;
            quads[i].rgbGreen = logical->palPalEntry[i].peGreen;
            quads[i].rgbRed = logical->palPalEntry[i].peRed;
            quads[i].rgbReserved = 0;
        }
    }
    launcher.paletteTable = std::move(table);
    return CreatePalette(logical);
}

bool ApplyLauncherPalette(DibBitmap* picture) {
    if (!picture) return false;
    void* header = nullptr;
    void* table = nullptr;
    std::uint8_t* pixels = nullptr;
    if (!DibParts(picture, header, table, pixels) || !launcher.paletteTable) return true;
    std::size_t tableBytes = DibColorTableSize(header);
    // Only a full 256-entry table of RGBQUADs takes the palette's colours.
    if (DibReadHeader(header).headerSize != kDibInfoHeaderSize || tableBytes < kPaletteTableBytes) {
        return true;
    }
    std::memcpy(table, launcher.paletteTable.get(), kPaletteTableBytes);
    return true;
}
