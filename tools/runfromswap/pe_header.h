// The few fields of a Windows program's file header that the build changes after linking.
#ifndef AUTOPLAY_TOOLS_RUNFROMSWAP_PE_HEADER_H
#define AUTOPLAY_TOOLS_RUNFROMSWAP_PE_HEADER_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace runfromswap {

// File header characteristics: Windows copies such a program to the page file before it runs
// it from removable or network media, so the medium may go away while it runs.
constexpr std::uint16_t kRemovableRunFromSwap = 0x0400;
constexpr std::uint16_t kNetRunFromSwap = 0x0800;

// Where the file header's characteristics and the optional header's checksum lie.
struct HeaderOffsets {
    std::size_t characteristics;
    std::size_t checksum;
};

// The offsets in a PE image (PE32 or PE32+); false with `error` set when `image` is not one.
bool FindHeader(const std::vector<std::uint8_t>& image, HeaderOffsets& offsets, std::string& error);

// The image checksum as the loader and MapFileAndCheckSum compute it: the 16-bit one's
// complement sum of the file with the checksum field taken as zero, plus the file length.
std::uint32_t ImageChecksum(const std::vector<std::uint8_t>& image, std::size_t checksumOffset);

// Sets `flags` in the characteristics and brings the checksum up to date. False, with the
// image untouched and `error` set, when it is not a PE image.
bool AddCharacteristics(std::vector<std::uint8_t>& image, std::uint16_t flags, std::string& error);

}  // namespace runfromswap

#endif
