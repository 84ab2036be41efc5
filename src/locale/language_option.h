// The launcher's only command-line option: "-l" and four hexadecimal digits, the whole
// command line exactly six characters (the form setup.exe is given as well).
#ifndef AUTOPLAY_LOCALE_LANGUAGE_OPTION_H
#define AUTOPLAY_LOCALE_LANGUAGE_OPTION_H

#include <cstdint>
#include <optional>

// The LANGID named by the option, or nothing when the command line is not the option.
// The digits are read as strtoul with base 16 reads them (white space, a sign and "0x"
// accepted, parsing stops at the first other character), keeping the low 16 bits.
std::optional<std::uint16_t> ParseLanguageOption(const wchar_t* commandLine);

// strtoul(text, nullptr, 16) over at most `length` characters, as a 32-bit unsigned long.
std::uint32_t ParseHexLikeStrtoul(const wchar_t* text, std::size_t length);

#endif
