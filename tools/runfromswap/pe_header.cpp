#include "pe_header.h"

namespace runfromswap {

namespace {

constexpr std::size_t kNewHeaderPointer = 0x3C;  // e_lfanew of the MS-DOS header
constexpr std::size_t kFileHeaderSize = 20;
constexpr std::size_t kCharacteristicsInFileHeader = 18;
constexpr std::size_t kChecksumInOptionalHeader = 64;  // the same in PE32 and PE32+
constexpr std::uint16_t kPe32Magic = 0x10B;
constexpr std::uint16_t kPe32PlusMagic = 0x20B;

std::uint16_t Read16(const std::vector<std::uint8_t>& bytes, std::size_t at) {
    return static_cast<std::uint16_t>(bytes[at] | bytes[at + 1] << 8);
}

std::uint32_t Read32(const std::vector<std::uint8_t>& bytes, std::size_t at) {
    return static_cast<std::uint32_t>(Read16(bytes, at)) |
           static_cast<std::uint32_t>(Read16(bytes, at + 2)) << 16;
}

void Write16(std::vector<std::uint8_t>& bytes, std::size_t at, std::uint16_t value) {
    bytes[at] = static_cast<std::uint8_t>(value);
    bytes[at + 1] = static_cast<std::uint8_t>(value >> 8);
}

void Write32(std::vector<std::uint8_t>& bytes, std::size_t at, std::uint32_t value) {
    Write16(bytes, at, static_cast<std::uint16_t>(value));
    Write16(bytes, at + 2, static_cast<std::uint16_t>(value >> 16));
}

}  // namespace

bool FindHeader(const std::vector<std::uint8_t>& image, HeaderOffsets& offsets,
                std::string& error) {
    if (image.size() < kNewHeaderPointer + 4 || image[0] != 'M' || image[1] != 'Z') {
        error = "no MS-DOS header";
        return false;
    }
    const std::size_t pe = Read32(image, kNewHeaderPointer);
    const std::size_t optionalHeader = pe + 4 + kFileHeaderSize;
    // Compared as sizes so that a pointer near the end of the address space cannot wrap.
    if (pe > image.size() ||
        image.size() - pe < 4 + kFileHeaderSize + kChecksumInOptionalHeader + 4) {
        error = "the PE header lies outside the file";
        return false;
    }
    if (image[pe] != 'P' || image[pe + 1] != 'E' || image[pe + 2] != 0 || image[pe + 3] != 0) {
        error = "no PE signature";
        return false;
    }
    const std::uint16_t magic = Read16(image, optionalHeader);
    if (magic != kPe32Magic && magic != kPe32PlusMagic) {
        error = "neither a PE32 nor a PE32+ optional header";
        return false;
    }
    offsets.characteristics = pe + 4 + kCharacteristicsInFileHeader;
    offsets.checksum = optionalHeader + kChecksumInOptionalHeader;
    return true;
}

std::uint32_t ImageChecksum(const std::vector<std::uint8_t>& image, std::size_t checksumOffset) {
    std::uint64_t sum = 0;
    for (std::size_t at = 0; at < image.size(); at += 2) {
        if (at == checksumOffset || at == checksumOffset + 2) continue;
        // An odd last byte counts as a word with a zero high byte.
        std::uint16_t word = image[at];
        if (at + 1 < image.size()) word = static_cast<std::uint16_t>(word | image[at + 1] << 8);
        sum += word;
        sum = (sum & 0xFFFF) + (sum >> 16);
    }
    sum = (sum & 0xFFFF) + (sum >> 16);
    return static_cast<std::uint32_t>(sum + image.size());
}

bool AddCharacteristics(std::vector<std::uint8_t>& image, std::uint16_t flags, std::string& error) {
    HeaderOffsets offsets{};
    if (!FindHeader(image, offsets, error)) return false;
    Write16(image, offsets.characteristics,
            static_cast<std::uint16_t>(Read16(image, offsets.characteristics) | flags));
    Write32(image, offsets.checksum, ImageChecksum(image, offsets.checksum));
    return true;
}

}  // namespace runfromswap
