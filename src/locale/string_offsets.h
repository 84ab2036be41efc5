// The offsets of the launcher's texts: every language's string set holds the same 38
// strings at the same offsets, so string id = language base + offset.
#ifndef AUTOPLAY_LOCALE_STRING_OFFSETS_H
#define AUTOPLAY_LOCALE_STRING_OFFSETS_H

#include <array>
#include <cstdint>

// String offsets, the same in every language's set.
enum StringOffset : std::uint32_t {
    kStrInstall = 1,
    kStrPlay = 2,
    kStrMoreGames = 3,
    kStrVisitWebSite = 7,
    kStrMoreInformation = 8,
    kStrExit = 10,
    kStrReadme = 12,
    kStrSupportTool = 13,
    kStrUninstall = 14,
    kStrReinstallCaption = 15,
    kStrReplaceCdText = 17,
    kStrReplaceCdCaption = 18,
    kStrRemovableText = 19,
    kStrRemovableCaption = 20,
    kStrNoDriveText = 21,
    kStrNoDriveCaption = 22,
    kStrDemoCaption = 23,
    kStrDemoMissingFormat = 24,
    kStrDemoNoAssociationFormat = 25,
    kStrNotOnDiscText = 27,
    kStrNoBrowserCaption = 28,
    kStrNoBrowserText = 29,
    kStrBrowserFailedCaption = 30,
    kStrBrowserFailedText = 31,
    kStrRegistration = 32,
    kStrPlay800 = 69,
    kStrPlay1024 = 70,
    kStrCreator = 71,
    kStrDemoPc = 72,
    kStrLanguageName = 73,
    kStrDemoLorrel = 77,
    kStrDemoDuskaro = 78,
    kStrDemoConsole = 79,
    kStrReinstallText = 80,
    kStrInsertDiscCaption = 84,
    kStrInsertDiscText = 85,
    kStrGameMissingText = 98,
    kStrGameMissingCaption = 99,
};

// Every offset above, in rising order.
constexpr std::array<std::uint32_t, 38> kAllStringOffsets = {
    1,  2,  3,  7,  8,  10, 12, 13, 14, 15, 17, 18, 19, 20, 21, 22, 23, 24, 25,
    27, 28, 29, 30, 31, 32, 69, 70, 71, 72, 73, 77, 78, 79, 80, 84, 85, 98, 99,
};

#endif
