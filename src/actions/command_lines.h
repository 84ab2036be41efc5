// Paths and parameters of the programs the launcher starts, built in one place.
#ifndef AUTOPLAY_ACTIONS_COMMAND_LINES_H
#define AUTOPLAY_ACTIONS_COMMAND_LINES_H

#include <string>
#include <string_view>

#include "locale/language_table.h"

// "-l" and the installer's language id in four lower-case hexadecimal digits.
std::wstring InstallerParameters(LanguageBase base);

// The installer's folder on the disc.
std::wstring SetupFolder(std::wstring_view rootPath);

// The two files that prove Disc 1 is in the drive.
std::wstring FirstDiscFile(std::wstring_view rootPath);
std::wstring SecondDiscFile(std::wstring_view rootPath);

#endif
