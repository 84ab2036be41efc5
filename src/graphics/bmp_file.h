// Checks a Windows bitmap file before the system's loader sees it: a file from the disc may be
// truncated or corrupt, and a header that promises more than the file holds must never be
// followed.
#ifndef AUTOPLAY_GRAPHICS_BMP_FILE_H
#define AUTOPLAY_GRAPHICS_BMP_FILE_H

#include <cstddef>
#include <cstdint>
#include <optional>

#include "graphics/dib.h"

// True when the bytes are a whole bitmap file: the file header, a known info header, its
// colour table and every pixel row (or the compressed image it names) lie inside the file,
// and width, height and depth are those of a real picture.
bool BmpFileIsWhole(const std::uint8_t* data, std::size_t size);
// The same judgement from the start of a file of `fileSize` bytes: `available` bytes from
// `head` on, at least the file header and the first 40 bytes of the info header (or the whole
// file, when it is shorter).
bool BmpFileIsWhole(const std::uint8_t* head, std::size_t available, std::uint64_t fileSize);

// What a checked picture holds, for the disc check to say what is wrong with a picture that
// the launcher would refuse or misdraw. The height keeps its sign (negative: top-down rows).
// The header of a file BmpFileIsWhole accepts; nothing for any other file.
std::optional<DibHeaderFields> WholeBmpFileHeader(const std::uint8_t* data, std::size_t size);
// The same check for a packed bitmap as a bitmap resource holds it: the header, its colour
// table and then the rows (or the compressed image), without the file header.
std::optional<DibHeaderFields> WholePackedDibHeader(const std::uint8_t* data, std::size_t size);

#endif
