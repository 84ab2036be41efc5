#include "pe_image.h"

#include <cstring>

namespace {

// https://learn.microsoft.com/windows/win32/debug/pe-format
constexpr std::size_t kNewHeaderPointer = 0x3C;
constexpr std::size_t kCoffHeaderSize = 20;
constexpr std::size_t kSectionHeaderSize = 40;
constexpr std::uint16_t kPe32Magic = 0x10B;
constexpr std::uint16_t kPe32PlusMagic = 0x20B;
constexpr std::uint32_t kResourceDirectoryIndex = 2;
constexpr std::uint32_t kSubdirectoryBit = 0x80000000u;
constexpr std::uint16_t kUsEnglish = 1033;
// Directories may point at each other; a real program has a few hundred entries in all.
constexpr std::uint32_t kMostEntries = 1u << 20;

class Bytes {
  public:
    explicit Bytes(const std::vector<std::uint8_t>& file) : file_(file) {}
    bool Has(std::uint64_t offset, std::uint64_t size) const {
        return offset <= file_.size() && size <= file_.size() - offset;
    }
    std::uint16_t U16(std::size_t offset) const {
        std::uint16_t value;
        std::memcpy(&value, file_.data() + offset, 2);
        return value;
    }
    std::uint32_t U32(std::size_t offset) const {
        std::uint32_t value;
        std::memcpy(&value, file_.data() + offset, 4);
        return value;
    }

  private:
    const std::vector<std::uint8_t>& file_;
};

struct Section {
    std::uint32_t virtualAddress;
    std::uint32_t virtualSize;
    std::uint32_t rawSize;
    std::uint32_t rawOffset;
};

class ResourceReader {
  public:
    ResourceReader(const Bytes& bytes, std::vector<Section> sections, std::uint32_t rootRva)
        : bytes_(bytes), sections_(std::move(sections)), rootRva_(rootRva) {}

    // The file offset of `size` bytes at `rva`, when one section's stored bytes hold them all.
    std::optional<std::size_t> FileOffset(std::uint64_t rva, std::uint64_t size) const {
        for (const Section& section : sections_) {
            if (rva < section.virtualAddress) continue;
            const std::uint64_t into = rva - section.virtualAddress;
            if (into + size > section.rawSize) continue;
            const std::uint64_t offset = section.rawOffset + into;
            if (bytes_.Has(offset, size)) return static_cast<std::size_t>(offset);
        }
        return std::nullopt;
    }

    // Calls `visit(nameEntryOffset, nameField, target)` for every entry of the directory at
    // `directory` (relative to the resource root).
    template <typename Visit>
    void Entries(std::uint32_t directory, Visit visit) const {
        auto header = FileOffset(std::uint64_t{rootRva_} + directory, 16);
        if (!header) return;
        const std::uint32_t count =
            std::uint32_t{bytes_.U16(*header + 12)} + bytes_.U16(*header + 14);
        auto entries =
            FileOffset(std::uint64_t{rootRva_} + directory + 16, std::uint64_t{count} * 8);
        if (!entries) return;
        for (std::uint32_t i = 0; i < count && visited_ < kMostEntries; ++i, ++visited_) {
            const std::size_t entry = *entries + i * 8;
            visit(entry, bytes_.U32(entry), bytes_.U32(entry + 4));
        }
    }

    // A type's key: its number, or its name (a counted UTF-16 string) in upper case.
    std::optional<std::string> TypeKey(std::uint32_t nameField) const {
        if (!(nameField & kSubdirectoryBit)) {
            return NumberedType(static_cast<std::uint16_t>(nameField));
        }
        auto length = FileOffset(std::uint64_t{rootRva_} + (nameField & ~kSubdirectoryBit), 2);
        if (!length) return std::nullopt;
        const std::uint16_t count = bytes_.U16(*length);
        auto text = FileOffset(std::uint64_t{rootRva_} + (nameField & ~kSubdirectoryBit) + 2,
                               std::uint64_t{count} * 2);
        if (!text) return std::nullopt;
        std::string name;
        for (std::uint16_t i = 0; i < count; ++i) {
            const std::uint16_t unit = bytes_.U16(*text + i * 2u);
            if (unit > 0x7F) return std::nullopt;  // the launcher names its types in ASCII
            name += static_cast<char>(unit >= 'a' && unit <= 'z' ? unit - 'a' + 'A' : unit);
        }
        return name;
    }

    std::optional<ResourceBytes> Data(std::uint32_t dataEntry, std::size_t idEntry) const {
        auto entry = FileOffset(std::uint64_t{rootRva_} + dataEntry, 16);
        if (!entry) return std::nullopt;
        const std::uint32_t size = bytes_.U32(*entry + 4);
        auto data = FileOffset(bytes_.U32(*entry), size);
        if (!data) return std::nullopt;
        return ResourceBytes{*data, size, idEntry};
    }

  private:
    const Bytes& bytes_;
    std::vector<Section> sections_;
    std::uint32_t rootRva_;
    mutable std::uint32_t visited_ = 0;
};

}  // namespace

std::string NumberedType(std::uint16_t type) {
    return "#" + std::to_string(type);
}

std::optional<PeImage> ReadPeImage(const std::vector<std::uint8_t>& file) {
    const Bytes bytes(file);
    if (!bytes.Has(0, kNewHeaderPointer + 4) || file[0] != 'M' || file[1] != 'Z') {
        return std::nullopt;
    }
    const std::uint64_t pe = bytes.U32(kNewHeaderPointer);
    if (!bytes.Has(pe, 4 + kCoffHeaderSize) || std::memcmp(&file[pe], "PE\0\0", 4) != 0) {
        return std::nullopt;
    }
    const std::size_t coff = static_cast<std::size_t>(pe) + 4;
    PeImage image;
    image.machine = bytes.U16(coff);
    const std::uint16_t sectionCount = bytes.U16(coff + 2);
    const std::uint16_t optionalSize = bytes.U16(coff + 16);
    const std::size_t optional = coff + kCoffHeaderSize;
    if (!bytes.Has(optional, optionalSize) || optionalSize < 2) return std::nullopt;
    const std::uint16_t magic = bytes.U16(optional);
    if (magic != kPe32Magic && magic != kPe32PlusMagic) return std::nullopt;
    image.pe32Plus = magic == kPe32PlusMagic;
    const std::size_t countField = optional + (image.pe32Plus ? 108 : 92);
    const std::size_t directories = countField + 4;

    const std::size_t sectionTable = optional + optionalSize;
    if (!bytes.Has(sectionTable, std::uint64_t{sectionCount} * kSectionHeaderSize)) {
        return std::nullopt;
    }
    std::vector<Section> sections;
    for (std::uint16_t i = 0; i < sectionCount; ++i) {
        const std::size_t header = sectionTable + i * kSectionHeaderSize;
        sections.push_back({bytes.U32(header + 12), bytes.U32(header + 8), bytes.U32(header + 16),
                            bytes.U32(header + 20)});
    }

    // No resource directory: a program without resources.
    const std::size_t resourceField = directories + kResourceDirectoryIndex * 8;
    if (countField + 4 > optional + optionalSize ||
        bytes.U32(countField) <= kResourceDirectoryIndex ||
        resourceField + 8 > optional + optionalSize) {
        return image;
    }
    const ResourceReader reader(bytes, std::move(sections), bytes.U32(resourceField));

    // Three levels: type, then id, then language.
    reader.Entries(0, [&](std::size_t, std::uint32_t typeName, std::uint32_t typeTarget) {
        auto type = reader.TypeKey(typeName);
        if (!type || !(typeTarget & kSubdirectoryBit)) return;
        reader.Entries(typeTarget & ~kSubdirectoryBit, [&](std::size_t idEntry, std::uint32_t id,
                                                           std::uint32_t idTarget) {
            // The launcher asks for every resource by number.
            if ((id & kSubdirectoryBit) || id > 0xFFFF || !(idTarget & kSubdirectoryBit)) return;
            const ResourceKey key{*type, static_cast<std::uint16_t>(id)};
            reader.Entries(idTarget & ~kSubdirectoryBit,
                           [&](std::size_t, std::uint32_t language, std::uint32_t dataEntry) {
                               if (dataEntry & kSubdirectoryBit) return;
                               auto data = reader.Data(dataEntry, idEntry);
                               if (!data) return;
                               if (language == kUsEnglish) {
                                   image.resources[key] = *data;
                               } else {
                                   image.resources.emplace(key, *data);
                               }
                           });
        });
    });
    return image;
}

std::optional<std::u16string> FindResourceString(const std::vector<std::uint8_t>& file,
                                                 const PeImage& image, std::uint32_t id) {
    if (id > 0xFFFF) return std::nullopt;
    auto block = image.resources.find(
        {NumberedType(kResourceString), static_cast<std::uint16_t>(id / 16 + 1)});
    if (block == image.resources.end()) return std::nullopt;
    const Bytes bytes(file);
    std::size_t at = block->second.offset;
    const std::size_t end = at + block->second.size;
    // Each of the block's sixteen strings is a length in UTF-16 units, then the units.
    for (std::uint32_t index = 0;; ++index) {
        if (at + 2 > end) return std::nullopt;
        const std::size_t length = bytes.U16(at);
        at += 2;
        if (at + length * 2 > end) return std::nullopt;
        if (index == id % 16) {
            std::u16string text(length, u'\0');
            std::memcpy(text.data(), &file[at], length * 2);
            return text;
        }
        at += length * 2;
    }
}
