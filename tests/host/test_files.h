// Files for the host tests: a temporary folder, files in it and bitmap files.
#ifndef AUTOPLAY_TESTS_HOST_TEST_FILES_H
#define AUTOPLAY_TESTS_HOST_TEST_FILES_H

#include <unistd.h>

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

class TempFolder {
  public:
    TempFolder() {
        std::string pattern =
            (std::filesystem::temp_directory_path() / "disccheck-XXXXXX").string();
        if (mkdtemp(pattern.data())) path_ = pattern;
    }
    ~TempFolder() {
        std::error_code ignored;
        if (!path_.empty()) std::filesystem::remove_all(path_, ignored);
    }
    TempFolder(const TempFolder&) = delete;
    TempFolder& operator=(const TempFolder&) = delete;
    const std::filesystem::path& Path() const { return path_; }

  private:
    std::filesystem::path path_;
};

inline void WriteFile(const std::filesystem::path& path, const std::vector<std::uint8_t>& bytes) {
    std::filesystem::create_directories(path.parent_path());
    std::ofstream(path, std::ios::binary | std::ios::trunc)
        .write(reinterpret_cast<const char*>(bytes.data()),
               static_cast<std::streamsize>(bytes.size()));
}

inline void WriteFile(const std::filesystem::path& path, const std::string& text) {
    WriteFile(path, std::vector<std::uint8_t>(text.begin(), text.end()));
}

// A bitmap file with a 40-byte (or a 12-byte core) header and zero colours and pixels.
inline std::vector<std::uint8_t> BmpFile(std::int32_t width, std::int32_t height,
                                         std::uint16_t bitCount, std::uint32_t headerSize = 40) {
    const std::uint32_t stride = ((static_cast<std::uint32_t>(width) * bitCount + 31) / 32) * 4;
    const std::uint32_t colors = bitCount <= 8 ? (1u << bitCount) : 0;
    const std::uint32_t offset = 14 + headerSize + colors * (headerSize == 12 ? 3 : 4);
    std::vector<std::uint8_t> file(offset + stride * static_cast<std::uint32_t>(std::abs(height)));
    auto put32 = [&](std::size_t at, std::uint32_t v) { std::memcpy(&file[at], &v, 4); };
    auto put16 = [&](std::size_t at, std::uint32_t v) { std::memcpy(&file[at], &v, 2); };
    file[0] = 'B';
    file[1] = 'M';
    put32(2, static_cast<std::uint32_t>(file.size()));
    put32(10, offset);
    put32(14, headerSize);
    if (headerSize == 12) {
        put16(18, static_cast<std::uint32_t>(width));
        put16(20, static_cast<std::uint32_t>(height));
        put16(22, 1);
        put16(24, bitCount);
    } else {
        put32(18, static_cast<std::uint32_t>(width));
        put32(22, static_cast<std::uint32_t>(height));
        put16(26, 1);
        put16(28, bitCount);
    }
    return file;
}

#endif
