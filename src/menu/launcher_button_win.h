// The launcher's picture buttons: owner-drawn "BUTTON" children that composite their face into
// the working background at their place and copy that rectangle into their window, so their
// edges blend with whatever lies behind them. Plates carry a text label; circular buttons show
// only their picture and answer hit tests on their circle.
#ifndef AUTOPLAY_MENU_LAUNCHER_BUTTON_WIN_H
#define AUTOPLAY_MENU_LAUNCHER_BUTTON_WIN_H

#include <windows.h>

#include <cstdint>
#include <string>

#include "locale/language_table.h"
#include "menu/button_rules.h"

class LauncherButton {
  public:
    // `labelLanguage` kActiveLanguage stands for the active language at this moment, so a later
    // change of language leaves the button as it is. Label offset 0: no label.
    LauncherButton(HWND parent, std::int32_t imageIndex, std::uint32_t id,
                   std::uint32_t labelOffset, std::int32_t x, std::int32_t y, std::int32_t width,
                   std::int32_t height, bool initiallyVisible, LanguageBase labelLanguage);
    LauncherButton(const LauncherButton&) = delete;
    LauncherButton& operator=(const LauncherButton&) = delete;

    // Draws the face of `state` into the button's DC.
    virtual void Draw(ButtonState state, HDC dc);
    // Whether a point on the screen lies on the button's shape.
    virtual bool HitTest(std::int32_t screenX, std::int32_t screenY) const;
    // Circular buttons are shaped; plates fill their window.
    virtual bool IsShaped() const;
    // Hides and destroys the window.
    virtual ~LauncherButton();

    // True when the flag changed; changes nothing on the screen.
    bool SetWanted(bool flag);
    void Show(bool flag);
    // Draws the state an owner-draw request asks for and remembers it.
    void DrawItem(HDC dc, std::uint32_t itemState);

    HWND window = nullptr;
    bool visible = false;
    std::int32_t imageIndex = 0;
    std::uint32_t id = 0;
    std::wstring label;  // empty: no label
    std::int32_t x = 0;
    std::int32_t y = 0;
    std::int32_t width = 0;
    std::int32_t height = 0;
    LanguageBase labelLanguage = kNoLanguage;
    bool wanted = true;
    ButtonState lastState = kNotDrawn;
    bool latched = false;
};

class VemoLauncherButton : public LauncherButton {
  public:
    using LauncherButton::LauncherButton;

    // Centre and radius in the button's client coordinates.
    void SetCircle(std::int32_t centerX, std::int32_t centerY, std::int32_t radius);

    void Draw(ButtonState state, HDC dc) override;
    bool HitTest(std::int32_t screenX, std::int32_t screenY) const override;
    bool IsShaped() const override;

    // Until SetCircle, no point of the screen is on the button.
    std::int32_t centerX = -1000;
    std::int32_t centerY = -1000;
    std::int32_t radius = 1;
};

#endif
