// Localised texts: string id = language base + offset, one string table per language.
#ifndef AUTOPLAY_LOCALE_STRINGS_WIN_H
#define AUTOPLAY_LOCALE_STRINGS_WIN_H

#include <cstddef>
#include <cstdint>

#include <windows.h>

#include "locale/language_table.h"
#include "locale/string_offsets.h"

// Loads string `base` + `offset` into `buffer`; an id without a string gives an empty text.
// Returns the length loaded. The text is cut to fit and always terminated.
int LoadLocalString(LanguageBase base, std::uint32_t offset, wchar_t* buffer, std::size_t capacity);

// Loads a caption and a text of the active language into the launcher's message buffers and
// shows them in a box (task-modal with no owner unless the flags and owner say otherwise);
// returns the button pressed.
int ShowLauncherMessage(std::uint32_t captionOffset, std::uint32_t textOffset, unsigned flags,
                        HWND owner = nullptr);
// Shows the launcher's message buffers as they are.
int ShowMessageBuffers(unsigned flags, HWND owner = nullptr);

#endif
