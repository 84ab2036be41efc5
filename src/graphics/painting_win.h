// The window's picture: the active language's background (or the language-selection one),
// the open panel composited into it, and the main menu's captions.
#ifndef AUTOPLAY_GRAPHICS_PAINTING_WIN_H
#define AUTOPLAY_GRAPHICS_PAINTING_WIN_H

#include <windows.h>

#include <cstdint>

#include "graphics/dib.h"

// Draws the whole client area into `dc` (a paint DC, or any DC a test reads back).
void PaintLauncherWindow(HDC dc);
// The pristine background the window shows: the active language's (the language list's until a
// language is settled), or the one the working copy was made from when that one is missing.
const DibBitmap* ShownBackground();
// Writes a caption of the active language right-aligned to (right, bottom).
void DrawCaption(HDC dc, std::uint32_t stringOffset, int right, int bottom);

// Captions are drawn in this palette-relative dark blue.
constexpr COLORREF kCaptionColor = PALETTERGB(0, 0, 140);

#endif
