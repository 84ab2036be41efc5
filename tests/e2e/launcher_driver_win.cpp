#include "launcher_driver_win.h"

#include <algorithm>
#include <cstdlib>

Screenshot::Screenshot(HWND window) {
    RECT client{};
    GetClientRect(window, &client);
    width_ = client.right;
    height_ = client.bottom;
    POINT origin{0, 0};
    ClientToScreen(window, &origin);
    BITMAPINFO info = TopDownInfo(width_, height_);
    HDC screen = GetDC(nullptr);
    HDC memory = CreateCompatibleDC(screen);
    void* bits = nullptr;
    HBITMAP bitmap = CreateDIBSection(memory, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
    HGDIOBJ previous = SelectObject(memory, bitmap);
    BitBlt(memory, 0, 0, width_, height_, screen, origin.x, origin.y, SRCCOPY);
    GdiFlush();
    if (bits) {
        pixels_.assign(static_cast<const std::uint32_t*>(bits),
                       static_cast<const std::uint32_t*>(bits) + width_ * height_);
    }
    SelectObject(memory, previous);
    DeleteObject(bitmap);
    DeleteDC(memory);
    ReleaseDC(nullptr, screen);
}

Screenshot::Screenshot(HBITMAP picture) {
    BITMAP info{};
    GetObjectW(picture, sizeof(info), &info);
    width_ = info.bmWidth;
    height_ = info.bmHeight;
    BITMAPINFO layout = TopDownInfo(width_, height_);
    pixels_.resize(static_cast<std::size_t>(width_ * height_));
    HDC screen = GetDC(nullptr);
    GetDIBits(screen, picture, 0, static_cast<UINT>(height_), pixels_.data(), &layout,
              DIB_RGB_COLORS);
    ReleaseDC(nullptr, screen);
}

Rgb Screenshot::At(int x, int y) const {
    if (x < 0 || y < 0 || x >= width_ || y >= height_ || pixels_.empty()) return {0, 0, 0};
    std::uint32_t p = pixels_[static_cast<std::size_t>(y * width_ + x)];
    return {static_cast<std::uint8_t>(p >> 16), static_cast<std::uint8_t>(p >> 8),
            static_cast<std::uint8_t>(p)};
}

int Screenshot::DifferingPixels(const Screenshot& other, const RECT& area) const {
    int count = 0;
    for (int y = area.top; y < area.bottom; ++y) {
        for (int x = area.left; x < area.right; ++x) {
            if (At(x, y) != other.At(x, y)) ++count;
        }
    }
    return count;
}

void Screenshot::SaveAs(const std::wstring& path) const {
    BITMAPINFO info = TopDownInfo(width_, height_);
    BITMAPFILEHEADER file{};
    file.bfType = 0x4D42;
    file.bfOffBits = sizeof(file) + sizeof(info.bmiHeader);
    file.bfSize = file.bfOffBits + static_cast<DWORD>(pixels_.size() * 4);
    HANDLE out = CreateFileW(path.c_str(), GENERIC_WRITE, 0, nullptr, CREATE_ALWAYS,
                             FILE_ATTRIBUTE_NORMAL, nullptr);
    if (out == INVALID_HANDLE_VALUE) return;
    DWORD written = 0;
    WriteFile(out, &file, sizeof(file), &written, nullptr);
    WriteFile(out, &info.bmiHeader, sizeof(info.bmiHeader), &written, nullptr);
    WriteFile(out, pixels_.data(), static_cast<DWORD>(pixels_.size() * 4), &written, nullptr);
    CloseHandle(out);
}

void Screenshot::SaveForReadme(const std::wstring& name) const {
    wchar_t folder[MAX_PATH];
    DWORD length = GetEnvironmentVariableW(L"AUTOPLAY_SCREENSHOT_DIR", folder, MAX_PATH);
    if (length == 0 || length >= MAX_PATH) return;
    SaveAs(std::wstring(folder) + L"\\" + name + L".bmp");
}

int ColorDistance(Rgb a, Rgb b) {
    return std::abs(a.r - b.r) + std::abs(a.g - b.g) + std::abs(a.b - b.b);
}

namespace {

std::wstring TextOfWindow(HWND window) {
    int length = GetWindowTextLengthW(window);
    std::wstring text(static_cast<std::size_t>(length) + 1, L'\0');
    GetWindowTextW(window, text.data(), length + 1);
    text.resize(static_cast<std::size_t>(length));
    return text;
}

struct ChildSearch {
    HWND parent;
    std::vector<ButtonSeen> found;
};

BOOL CALLBACK CollectChild(HWND child, LPARAM context) {
    auto* search = reinterpret_cast<ChildSearch*>(context);
    if (GetParent(child) != search->parent) return TRUE;
    ButtonSeen seen;
    seen.window = child;
    wchar_t name[64] = {};
    GetClassNameW(child, name, 64);
    seen.className = name;
    seen.text = TextOfWindow(child);
    seen.id = GetDlgCtrlID(child);
    GetWindowRect(child, &seen.place);
    MapWindowPoints(nullptr, search->parent, reinterpret_cast<POINT*>(&seen.place), 2);
    seen.visible = IsWindowVisible(child) != FALSE;
    search->found.push_back(seen);
    return TRUE;
}

void SendMouse(DWORD flags, POINT screen) {
    INPUT input{};
    input.type = INPUT_MOUSE;
    // Absolute coordinates run from 0 to 65535 over the primary screen.
    const int width = GetSystemMetrics(SM_CXSCREEN);
    const int height = GetSystemMetrics(SM_CYSCREEN);
    input.mi.dx = static_cast<LONG>((screen.x * 65536 + width / 2) / width);
    input.mi.dy = static_cast<LONG>((screen.y * 65536 + height / 2) / height);
    input.mi.dwFlags = flags | MOUSEEVENTF_ABSOLUTE;
    SendInput(1, &input, sizeof(input));
}

}  // namespace

std::vector<ButtonSeen> ChildButtons(HWND launcher) {
    ChildSearch search{launcher, {}};
    EnumChildWindows(launcher, CollectChild, reinterpret_cast<LPARAM>(&search));
    return search.found;
}

std::vector<ButtonSeen> VisibleButtons(HWND launcher) {
    std::vector<ButtonSeen> visible;
    for (const ButtonSeen& button : ChildButtons(launcher)) {
        if (button.visible) visible.push_back(button);
    }
    return visible;
}

HWND VisibleButton(HWND launcher, int id) {
    for (const ButtonSeen& button : VisibleButtons(launcher)) {
        if (button.id == id) return button.window;
    }
    return nullptr;
}

void MoveMouse(HWND window, POINT client) {
    POINT screen = client;
    ClientToScreen(window, &screen);
    SendMouse(MOUSEEVENTF_MOVE, screen);
    Sleep(100);
}

void Click(HWND window, POINT client) {
    MoveMouse(window, client);
    POINT screen = client;
    ClientToScreen(window, &screen);
    SendMouse(MOUSEEVENTF_LEFTDOWN, screen);
    Sleep(50);
    SendMouse(MOUSEEVENTF_LEFTUP, screen);
    Sleep(100);
}

void PressKey(WORD virtualKey, bool shift) {
    std::vector<INPUT> inputs;
    auto key = [&inputs](WORD code, bool up) {
        INPUT input{};
        input.type = INPUT_KEYBOARD;
        input.ki.wVk = code;
        input.ki.wScan = static_cast<WORD>(MapVirtualKeyW(code, MAPVK_VK_TO_VSC));
        input.ki.dwFlags = up ? KEYEVENTF_KEYUP : 0;
        inputs.push_back(input);
    };
    if (shift) key(VK_SHIFT, false);
    key(virtualKey, false);
    key(virtualKey, true);
    if (shift) key(VK_SHIFT, true);
    SendInput(static_cast<UINT>(inputs.size()), inputs.data(), sizeof(INPUT));
    Sleep(100);
}

HWND FocusInThreadOf(HWND window) {
    GUITHREADINFO info{};
    info.cbSize = sizeof(info);
    if (!GetGUIThreadInfo(GetWindowThreadProcessId(window, nullptr), &info)) return nullptr;
    return info.hwndFocus;
}

bool WaitUntil(const std::function<bool()>& done, DWORD timeoutMs) {
    DWORD start = GetTickCount();
    for (;;) {
        if (done()) return true;
        if (GetTickCount() - start > timeoutMs) return false;
        Sleep(50);
    }
}

Screenshot SettledShot(HWND window, DWORD timeoutMs) {
    DWORD start = GetTickCount();
    Screenshot last(window);
    for (;;) {
        Sleep(250);
        Screenshot now(window);
        RECT whole{0, 0, now.Width(), now.Height()};
        bool settled = now.Width() == last.Width() && now.DifferingPixels(last, whole) == 0;
        last = now;
        if (settled || GetTickCount() - start > timeoutMs) return last;
    }
}
