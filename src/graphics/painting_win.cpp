#include "graphics/painting_win.h"

#include "graphics/main_menu_layout.h"
#include "graphics/masked_blend.h"
#include "graphics/picture_win.h"
#include "locale/catalogue_win.h"
#include "locale/strings_win.h"
#include "shell/launcher_state.h"

namespace {

constexpr std::size_t kCaptionTextCapacity = 256;

void PrepareTextDc(HDC dc, HFONT font) {
    SetTextColor(dc, kCaptionColor);
    SetBkMode(dc, TRANSPARENT);
    SetMapMode(dc, MM_TEXT);
    if (font) SelectObject(dc, font);
}

// The background bitmap already holds the picture in the display's format: copying it out is
// cheaper than converting the working copy again. On a palette display that format has lost
// colours, which a DC of more colours (a printout, a window capture) would keep from the
// working copy.
bool CopyBackgroundBitmap(HDC dc) {
    if (!launcher.backgroundBitmap || launcher.palette) return false;
    WindowDc screen(nullptr);
    MemoryDc memory(CreateCompatibleDC(screen.Get()));
    if (!memory) return false;
    SelectionGuard bitmap(memory.Get(), launcher.backgroundBitmap.Get());
    return BitBlt(dc, 0, 0, launcher.backgroundWidth, launcher.backgroundHeight, memory.Get(), 0, 0,
                  SRCCOPY) != FALSE;
}

}  // namespace

const DibBitmap* ShownBackground() {
    std::int32_t key = launcher.languageKnown ? static_cast<std::int32_t>(launcher.languageBase) : 0;
    if (const DibBitmap* wanted = BackgroundFor(key)) return wanted;
    return BackgroundFor(catalogue.firstBackgroundKey);
}

void PaintLauncherWindow(HDC dc) {
    DcStateGuard state(dc);
    PaletteGuard palette(dc, launcher.palette.Get());
    launcher.backgroundBitmap.Reset();
    DibBitmap* working = launcher.workingBackground.get();

    CopyDibPixels(working, ShownBackground());
    if (launcher.menu.panelOpen) {
        // A panel the menu does not know shows the plain background.
        if (auto place = PanelPlacementFor(launcher.openPanel)) {
            MaskedBlend(catalogue.panelPictures[launcher.openPanel].get(), {0, 0}, working,
                        {place->x, place->y}, catalogue.opaqueMask.get(), {0, 0}, working,
                        {place->x, place->y}, {place->width, place->height});
        }
    }
    launcher.backgroundBitmap.Reset(BitmapFromDib(working, launcher.palette.Get()));
    if (!CopyBackgroundBitmap(dc)) {
        StretchDibBlt(dc, 0, 0, launcher.backgroundWidth, launcher.backgroundHeight, working, 0, 0,
                      launcher.backgroundWidth, launcher.backgroundHeight, SRCCOPY);
    }

    if (launcher.languageKnown) {
        for (const CaptionPlacement& caption :
             MainMenuCaptions(launcher.menu.installed, launcher.discSku, launcher.productSku,
                              launcher.languageBase)) {
            DrawCaption(dc, caption.stringOffset, caption.right, caption.bottom);
        }
    }
    launcher.buttonsRefreshed = false;
}

void DrawCaption(HDC dc, std::uint32_t stringOffset, int right, int bottom) {
    wchar_t text[kCaptionTextCapacity];
    int length = LoadLocalString(launcher.languageBase, stringOffset, text, kCaptionTextCapacity);
    HFONT font = FontFor(launcher.languageBase);
    // The caption is measured in the window's DC with its font; the DC gets back what it had.
    DcStateGuard state(dc);
    PrepareTextDc(dc, font);
    SIZE extent{};
    GetTextExtentPoint32W(dc, text, length, &extent);
    RECT area{right - extent.cx, bottom - extent.cy, right, bottom};
    if (!launcher.backgroundBitmap) return;

    // The text goes into the background bitmap, and only its rectangle onto the window, so
    // the window never shows text over a stale picture.
    WindowDc screen(nullptr);
    MemoryDc memory(CreateCompatibleDC(screen.Get()));
    if (!memory) return;
    SelectionGuard bitmap(memory.Get(), launcher.backgroundBitmap.Get());
    PaletteGuard palette(memory.Get(), launcher.palette.Get());
    SelectionGuard memoryFont(memory.Get(), font);
    SetTextColor(memory.Get(), kCaptionColor);
    SetBkMode(memory.Get(), TRANSPARENT);
    SetMapMode(memory.Get(), MM_TEXT);
    DrawTextW(memory.Get(), text, length, &area, DT_RIGHT);
    BitBlt(dc, area.left, area.top, area.right - area.left + 1, area.bottom - area.top + 1,
           memory.Get(), area.left, area.top, SRCCOPY);
}
