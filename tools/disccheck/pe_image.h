// Reads a Windows program file without Windows: its machine and the resources the launcher
// loads by number (bitmaps, string blocks, the palette's custom type). Every offset the file
// names is checked against the file before it is followed, so a damaged program gives missing
// resources, never a read outside the bytes.
#ifndef AUTOPLAY_TOOLS_DISCCHECK_PE_IMAGE_H
#define AUTOPLAY_TOOLS_DISCCHECK_PE_IMAGE_H

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <utility>
#include <vector>

constexpr std::uint16_t kMachineI386 = 0x014C;
constexpr std::uint16_t kMachineAmd64 = 0x8664;
constexpr std::uint16_t kResourceBitmap = 2;  // RT_BITMAP
constexpr std::uint16_t kResourceString = 6;  // RT_STRING

// Where a resource's data lies in the file.
struct ResourceBytes {
    std::size_t offset = 0;
    std::size_t size = 0;
    std::size_t idEntry = 0;  // file offset of the directory entry that names the resource
};

// A numbered type is "#" and its number ("#2"), a named type its name in upper case, as
// FindResource compares names.
using ResourceKey = std::pair<std::string, std::uint16_t>;
std::string NumberedType(std::uint16_t type);

struct PeImage {
    std::uint16_t machine = 0;
    bool pe32Plus = false;  // the 64-bit optional header
    // One language per resource: US English (1033) when the file has it, else the first.
    std::map<ResourceKey, ResourceBytes> resources;
};

// Nothing when the bytes are not a Windows program; a damaged resource directory only loses
// the entries it no longer names.
std::optional<PeImage> ReadPeImage(const std::vector<std::uint8_t>& file);

// The string LoadString finds for `id` (block id / 16 + 1, entry id % 16): nothing when the
// block is missing or too short to reach the entry. An empty result is an empty string.
std::optional<std::u16string> FindResourceString(const std::vector<std::uint8_t>& file,
                                                 const PeImage& image, std::uint32_t id);

#endif
