// What setup.exe is asked to do, read from its command line. Platform-neutral.
#ifndef AUTOPLAY_DISC_SETUP_OPTIONS_H
#define AUTOPLAY_DISC_SETUP_OPTIONS_H

#include <cstdint>
#include <optional>
#include <string_view>

struct SetupOptions {
    std::optional<std::uint16_t> langId;  // "-l" and one to four hexadecimal digits
    bool silent = false;                  // "-s": no questions, no result box
    bool uninstall = false;               // "-u": remove the installation
    bool understood = true;               // false when any word was not one of the above
};

// Switches are separated by blanks, start with '-' or '/' and ignore case, so "-l0407 /S"
// works as well as the launcher's "-l0407". A switch setup does not know, or an "-l"
// without its digits, leaves `understood` false: a mistyped command line must not install
// in a guessed language. The other words are still read, so "-s" keeps even the complaint
// about the mistake silent.
SetupOptions ParseSetupOptions(std::wstring_view commandLine);

#endif
