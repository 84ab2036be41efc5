// Checks a Windows bitmap file before the system's loader sees it: a file from the disc may be
// truncated or corrupt, and a header that promises more than the file holds must never be
// followed.
#ifndef AUTOPLAY_GRAPHICS_BMP_FILE_H
#define AUTOPLAY_GRAPHICS_BMP_FILE_H

#include <cstddef>
#include <cstdint>

// True when the bytes are a whole bitmap file: the file header, a known info header, its
// colour table and every pixel row (or the compressed image it names) lie inside the file,
// and width, height and depth are those of a real picture.
bool BmpFileIsWhole(const std::uint8_t* data, std::size_t size);
// The same judgement from the start of a file of `fileSize` bytes: `available` bytes from
// `head` on, at least the file header and the first 40 bytes of the info header (or the whole
// file, when it is shorter).
bool BmpFileIsWhole(const std::uint8_t* head, std::size_t available, std::uint64_t fileSize);

#endif
