// Localised texts: string id = language base + offset, one string table per language.
#ifndef AUTOPLAY_LOCALE_STRINGS_WIN_H
#define AUTOPLAY_LOCALE_STRINGS_WIN_H

#include <cstddef>
#include <cstdint>

#include "locale/language_table.h"

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

// Loads string `base` + `offset` into `buffer`; an id without a string gives an empty text.
// Returns the length loaded. The text is cut to fit and always terminated.
int LoadLocalString(LanguageBase base, std::uint32_t offset, wchar_t* buffer, std::size_t capacity);

// Loads a caption and a text of the active language into the launcher's message buffers and
// shows them in a task-modal box with no owner; returns the button pressed.
int ShowLauncherMessage(std::uint32_t captionOffset, std::uint32_t textOffset, unsigned flags);

#endif
