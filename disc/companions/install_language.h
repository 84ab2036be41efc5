// The language setup.exe installs in, chosen by the Windows language identifier the
// launcher passes as "-l%04x", and the registry names the launcher reads back.
// Platform-neutral: no windows.h.
#ifndef AUTOPLAY_DISC_INSTALL_LANGUAGE_H
#define AUTOPLAY_DISC_INSTALL_LANGUAGE_H

#include <cstdint>

struct InstallLanguage {
    const wchar_t* productName;  // VEMO_LANGUAGE
    const wchar_t* otherName;    // VEMO_OTHERLANGUAGE, null when the value is not written
    const wchar_t* displayName;  // what the user reads in setup's questions
};

// Chosen by the primary language, so that neutral identifiers (0x0007) and regional ones
// (0x0407, 0x0807) agree. The Nordic languages install the UK English product with their
// own name beside it; identifiers of languages the product lacks install US English.
InstallLanguage InstallLanguageFor(std::uint16_t langId);

#endif
