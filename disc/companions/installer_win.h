// Installing and removing The Vemo Vodizuri Virezazida: the game and its creator tool in
// Program Files, the product's registry values that the launcher reads, and the uninstall
// entry. Like the product's own 32-bit installer, it writes the 32-bit registry view, also
// when built for x86_64.
#ifndef AUTOPLAY_DISC_INSTALLER_WIN_H
#define AUTOPLAY_DISC_INSTALLER_WIN_H

#include <windows.h>

#include <cstdint>
#include <optional>
#include <string>

#include "install_language.h"

inline constexpr wchar_t kProductTitle[] = L"The Vemo Vodizuri Virezazida";

struct InstallPlan {
    std::wstring setupProgram;   // this setup.exe; the uninstall entry starts it with "-u"
    std::wstring sourceFolder;   // the disc's Setup\Program\, where the programs wait
    std::wstring gameFolder;     // %ProgramFiles%\Orvak\The Vemo, no trailing backslash
    std::wstring creatorFolder;  // its sibling "The Vemo Creator"
    InstallLanguage language;
    DWORD discSku;  // [SKU] SKU= of the disc's ORVAK.INI, 0 when absent
};

// What this setup.exe would install from its disc; nothing when Program Files is unknown.
std::optional<InstallPlan> PlanInstallation(std::uint16_t langId);

// Copies the programs and writes the registry. On failure `error` says what went wrong and
// whatever was made is taken away again.
bool Install(const InstallPlan& plan, std::wstring& error);

// Whether the product key or the uninstall entry is there.
bool IsInstalled();

// Removes the programs, their folders and both registry keys; parts already gone are fine.
// False, with `error` set, when something could not be removed (a program still running).
bool Uninstall(std::wstring& error);

#endif
