// Pictures between their packed-DIB blocks and GDI: conversion both ways, drawing, loading
// from the program's resources and from bitmap files, and the launcher's 256-colour palette.
#ifndef AUTOPLAY_GRAPHICS_PICTURE_WIN_H
#define AUTOPLAY_GRAPHICS_PICTURE_WIN_H

#include <windows.h>

#include <cstdint>

#include "graphics/dib.h"

// Flags the launcher loads pictures with: DIB sections keep the depth they were stored with.
constexpr UINT kLoadResourcePicture = LR_CREATEDIBSECTION;
constexpr UINT kLoadFilePicture = LR_CREATEDIBSECTION | LR_LOADFROMFILE;
constexpr WORD kPaletteResource = 247;

// A new block for the bitmap's pixels at `bitCount` bits (0: the bitmap's own depth),
// through `palette` (null: the default palette); null on failure.
DibBitmap* DibFromBitmap(HBITMAP bitmap, std::uint32_t compression, std::uint16_t bitCount,
                         HPALETTE palette);
// A device bitmap of the picture; shows the wait cursor while it converts. Null for null.
HBITMAP BitmapFromDib(const DibBitmap* picture, HPALETTE palette);
// Draws a rectangle of the picture (source y counted from the bottom, as StretchDIBits does);
// without a picture the destination is filled with PatBlt and `rop`.
int StretchDibBlt(HDC dc, int x, int y, int width, int height, const DibBitmap* picture,
                  int sourceX, int sourceY, int sourceWidth, int sourceHeight, DWORD rop);

// A picture of the program's resources or of a bitmap file on the disc, as LoadImage with
// `flags` and DibFromBitmap through the launcher's palette make it. On displays of more than
// 8 bits per pixel that round trip gives back the picture's stored bytes, so a DIB-section
// load of a picture DibFromStoredPicture can read is made straight from those bytes instead.
DibBitmap* LoadPictureResource(WORD id, UINT flags);
// Null for a missing, unreadable or corrupt file.
DibBitmap* LoadPictureFile(const wchar_t* path, UINT flags);
// The part of LoadPictureFile that needs no GDI, so any thread may run it: the picture made
// straight from a whole file's stored bytes. Null for a missing or corrupt file, and also, with
// `gdiNeeded` set, for a whole file that only the system's loader can read.
DibBitmap* ReadStoredPictureFile(const wchar_t* path, bool& gdiNeeded);
// Whether LoadPictureFile and LoadPictureResource take pictures loaded with these flags as
// their stored bytes (displays of more than 8 bits per pixel).
bool PicturesKeepTheirStoredBytes(UINT flags);

// The two ways those loads take, for the tests that hold them to the same bytes: always
// through LoadImage and DibFromBitmap, and straight from the resource's bytes (null when
// DibFromStoredPicture cannot read them).
DibBitmap* LoadPictureResourceThroughGdi(WORD id, UINT flags);
DibBitmap* LoadPictureFileThroughGdi(const wchar_t* path, UINT flags);
DibBitmap* PictureFromResourceBytes(WORD id);

// The palette for displays of 8 bits per pixel or fewer (also making the palette table);
// null on deeper displays.
HPALETTE CreateLauncherPalette();
// Fills a LOGPALETTE with room for 257 entries from the palette resource; false when missing.
bool LoadPaletteResource(WORD id, LOGPALETTE* palette);
// Gives an 8-bit picture the palette's colours; false for null, true otherwise.
bool ApplyLauncherPalette(DibBitmap* picture);

#endif
