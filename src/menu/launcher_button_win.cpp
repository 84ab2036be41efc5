#include "menu/launcher_button_win.h"

#include "graphics/masked_blend.h"
#include "graphics/painting_win.h"
#include "graphics/picture_win.h"
#include "locale/catalogue_win.h"
#include "locale/strings_win.h"
#include "platform/handles_win.h"
#include "shell/launcher_state.h"

namespace {

constexpr std::size_t kLabelCapacity = 256;
constexpr UINT kLabelFormat = DT_CENTER | DT_WORDBREAK | DT_INTERNAL;

COLORREF LabelColor(ButtonState state) {
    switch (state) {
        case kPressed:
        case kLatched:
            return PALETTERGB(0, 255, 255);
        case kFocused:
            return PALETTERGB(255, 255, 255);
        default:
            return PALETTERGB(204, 211, 216);
    }
}

// Copies the face-sized rectangle at the button's place out of the working background into the
// button's DC (rows counted from the bottom, as the block stores them).
void CopyOut(HDC dc, std::int32_t x, std::int32_t y, std::int32_t width, std::int32_t height) {
    StretchDibBlt(dc, 0, 0, width, height, launcher.workingBackground.get(), x,
                  launcher.backgroundHeight - height - y, width, height, SRCCOPY);
}

}  // namespace

LauncherButton::LauncherButton(HWND parent, std::int32_t imageIndex_, std::uint32_t id_,
                               std::uint32_t labelOffset, std::int32_t x_, std::int32_t y_,
                               std::int32_t width_, std::int32_t height_, bool initiallyVisible,
                               LanguageBase labelLanguage_)
    : visible(initiallyVisible),
      imageIndex(imageIndex_),
      id(id_),
      x(x_),
      y(y_),
      width(width_),
      height(height_),
      labelLanguage(labelLanguage_ == kActiveLanguage ? launcher.languageBase : labelLanguage_) {
    if (labelOffset != 0) {
        wchar_t text[kLabelCapacity];
        int length = LoadLocalString(labelLanguage, labelOffset, text, kLabelCapacity);
        label.assign(text, static_cast<std::size_t>(length));
    }
    DWORD style = WS_CHILD | BS_OWNERDRAW | (initiallyVisible ? WS_VISIBLE : 0);
    // The label is the window's text too, so screen readers announce the button.
    window = CreateWindowExW(
        0, L"BUTTON", label.empty() ? nullptr : label.c_str(), style, x, y, width, height, parent,
        reinterpret_cast<HMENU>(static_cast<UINT_PTR>(id)), launcher.instance, nullptr);
}

LauncherButton::~LauncherButton() {
    if (window) {
        ShowWindow(window, SW_HIDE);
        DestroyWindow(window);
    }
}

bool LauncherButton::SetWanted(bool flag) {
    if (wanted == flag) return false;
    wanted = flag;
    return true;
}

void LauncherButton::Show(bool flag) {
    if (!window || flag == visible) return;
    ShowWindow(window, flag ? SW_SHOWNORMAL : SW_HIDE);
    visible = flag;
}

void LauncherButton::DrawItem(HDC dc, std::uint32_t itemState) {
    if (!window || !dc) return;
    ButtonState state = StateForItem(itemState, latched);
    Draw(state, dc);
    lastState = state;
}

void LauncherButton::Draw(ButtonState state, HDC dc) {
    // Plates have no latched face of their own.
    const int faceState = state == kLatched ? kNormal : state;
    const DibBitmap* face = PlateFor(faceState, imageIndex);
    std::int32_t faceWidth = 0;
    std::int32_t faceHeight = 0;
    if (!DibDimensions(face, faceWidth, faceHeight)) return;
    DibBitmap* working = launcher.workingBackground.get();
    MaskedBlend(face, {0, 0}, working, {x, y}, catalogue.opaqueMask.get(), {0, 0}, working, {x, y},
                {faceWidth, faceHeight});
    CopyOut(dc, x, y, faceWidth, faceHeight);
    if (label.empty()) return;

    DcStateGuard saved(dc);
    if (HFONT font = FontFor(labelLanguage)) SelectObject(dc, font);
    PaletteGuard palette(dc, launcher.palette.Get());
    SetTextColor(dc, LabelColor(state));
    SetBkMode(dc, TRANSPARENT);
    SetMapMode(dc, MM_TEXT);
    // The label sits a little low in the plate; pressed, it moves with the plate's shadow.
    const int shift = state == kPressed ? 2 : 0;
    RECT area{-5 + shift, 10 + shift, width - 5 + shift, height + 10 + shift};
    DrawTextW(dc, label.c_str(), -1, &area, kLabelFormat);
}

bool LauncherButton::HitTest(std::int32_t, std::int32_t) const {
    return true;
}

bool LauncherButton::IsShaped() const {
    return false;
}

void VemoLauncherButton::SetCircle(std::int32_t centerX_, std::int32_t centerY_,
                                   std::int32_t radius_) {
    centerX = centerX_;
    centerY = centerY_;
    radius = radius_;
}

void VemoLauncherButton::Draw(ButtonState state, HDC dc) {
    const DibBitmap* face = IconPictureFor(state, imageIndex);
    const DibBitmap* mask = IconMaskFor(state, imageIndex);
    std::int32_t faceWidth = 0;
    std::int32_t faceHeight = 0;
    if (!mask || !DibDimensions(face, faceWidth, faceHeight)) return;
    // Wherever the previous face covered anything, the untouched background comes back first,
    // so a smaller new face leaves no rim of the old one (a hover glow included).
    const DibBitmap* previousMask =
        lastState == kNotDrawn ? nullptr : IconMaskFor(lastState, imageIndex);
    if (!previousMask) previousMask = mask;
    DibBitmap* working = launcher.workingBackground.get();
    MaskedRestore(ShownBackground(), {x, y}, previousMask, {0, 0}, working, {x, y},
                  {faceWidth, faceHeight});
    MaskedBlend(face, {0, 0}, working, {x, y}, mask, {0, 0}, working, {x, y},
                {faceWidth, faceHeight});
    CopyOut(dc, x, y, faceWidth, faceHeight);
}

bool VemoLauncherButton::HitTest(std::int32_t screenX, std::int32_t screenY) const {
    POINT point{screenX, screenY};
    MapWindowPoints(nullptr, window, &point, 1);
    return InsideHitCircle({centerX, centerY, radius}, point.x, point.y);
}

bool VemoLauncherButton::IsShaped() const {
    return true;
}
