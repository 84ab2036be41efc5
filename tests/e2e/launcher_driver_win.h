// Using the launcher's window as a user does: its buttons as child windows, the real mouse
// moved and clicked over them, the keyboard focus they take, and the client area read back as
// pixels. Every wait is bounded.
#ifndef AUTOPLAY_TESTS_LAUNCHER_DRIVER_WIN_H
#define AUTOPLAY_TESTS_LAUNCHER_DRIVER_WIN_H

#include <windows.h>

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "test_support_win.h"

// The client area of a window as it is on the screen (or the pixels of a picture), read as
// top-down 32-bit pixels.
class Screenshot {
public:
    explicit Screenshot(HWND window);
    explicit Screenshot(HBITMAP picture);

    int Width() const { return width_; }
    int Height() const { return height_; }
    Rgb At(int x, int y) const;
    // Pixels that differ between two shots of the same size, inside a rectangle.
    int DifferingPixels(const Screenshot& other, const RECT& area) const;
    void SaveAs(const std::wstring& path) const;
    // Saves the shot as NAME.bmp in AUTOPLAY_SCREENSHOT_DIR when that is set (the README's
    // pictures are made this way); nothing otherwise.
    void SaveForReadme(const std::wstring& name) const;

private:
    int width_ = 0;
    int height_ = 0;
    std::vector<std::uint32_t> pixels_;
};

int ColorDistance(Rgb a, Rgb b);

// A child window of the launcher as a user and a screen reader see it.
struct ButtonSeen {
    HWND window = nullptr;
    std::wstring className;
    std::wstring text;
    int id = 0;
    RECT place{};  // in the launcher's client area
    bool visible = false;
};
std::vector<ButtonSeen> ChildButtons(HWND launcher);
std::vector<ButtonSeen> VisibleButtons(HWND launcher);
// The visible child with this control id, or null.
HWND VisibleButton(HWND launcher, int id);

// The real mouse, moved or clicked at a point of a window's client area.
void MoveMouse(HWND window, POINT client);
void Click(HWND window, POINT client);
// Real key presses, as the keyboard sends them.
void PressKey(WORD virtualKey, bool shift = false);

// The window that has the keyboard focus in the thread that owns `window`.
HWND FocusInThreadOf(HWND window);

// Polls `done` until it holds or `timeoutMs` passes; the last answer.
bool WaitUntil(const std::function<bool()>& done, DWORD timeoutMs = 10000);

// Waits until two shots of the window in a row are equal (its painting has settled); the last.
Screenshot SettledShot(HWND window, DWORD timeoutMs = 5000);

#endif
