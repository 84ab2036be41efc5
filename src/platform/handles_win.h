// Owners for the Win32 handles the launcher holds: each closes its handle once, can be
// moved and cannot be copied.
#ifndef AUTOPLAY_PLATFORM_HANDLES_WIN_H
#define AUTOPLAY_PLATFORM_HANDLES_WIN_H

#include <windows.h>

#include <utility>

template <typename Handle, typename Traits>
class UniqueResource {
public:
    UniqueResource() = default;
    explicit UniqueResource(Handle handle) : handle_(handle) {}
    ~UniqueResource() { Reset(); }
    UniqueResource(const UniqueResource&) = delete;
    UniqueResource& operator=(const UniqueResource&) = delete;
    UniqueResource(UniqueResource&& other) noexcept : handle_(other.Release()) {}
    UniqueResource& operator=(UniqueResource&& other) noexcept {
        if (this != &other) Reset(other.Release());
        return *this;
    }

    Handle Get() const { return handle_; }
    explicit operator bool() const { return !Traits::IsEmpty(handle_); }
    Handle Release() { return std::exchange(handle_, Traits::Empty()); }
    void Reset(Handle handle = Traits::Empty()) {
        Handle old = std::exchange(handle_, handle);
        if (!Traits::IsEmpty(old)) Traits::Close(old);
    }

private:
    Handle handle_ = Traits::Empty();
};

struct KernelHandleTraits {
    static HANDLE Empty() { return nullptr; }
    static bool IsEmpty(HANDLE h) { return h == nullptr || h == INVALID_HANDLE_VALUE; }
    static void Close(HANDLE h) { CloseHandle(h); }
};
using UniqueHandle = UniqueResource<HANDLE, KernelHandleTraits>;

struct RegistryKeyTraits {
    static HKEY Empty() { return nullptr; }
    static bool IsEmpty(HKEY key) { return key == nullptr; }
    static void Close(HKEY key) { RegCloseKey(key); }
};
using RegistryKey = UniqueResource<HKEY, RegistryKeyTraits>;

template <typename Object>
struct GdiObjectTraits {
    static Object Empty() { return nullptr; }
    static bool IsEmpty(Object object) { return object == nullptr; }
    static void Close(Object object) { DeleteObject(object); }
};
template <typename Object>
using UniqueGdi = UniqueResource<Object, GdiObjectTraits<Object>>;
using UniqueGdiObject = UniqueGdi<HGDIOBJ>;

struct MemoryDcTraits {
    static HDC Empty() { return nullptr; }
    static bool IsEmpty(HDC dc) { return dc == nullptr; }
    static void Close(HDC dc) { DeleteDC(dc); }
};
using MemoryDc = UniqueResource<HDC, MemoryDcTraits>;

// The device context of a window (null: the whole screen), released when it goes.
class WindowDc {
public:
    explicit WindowDc(HWND window) : window_(window), dc_(GetDC(window)) {}
    ~WindowDc() {
        if (dc_) ReleaseDC(window_, dc_);
    }
    WindowDc(const WindowDc&) = delete;
    WindowDc& operator=(const WindowDc&) = delete;
    HDC Get() const { return dc_; }

private:
    HWND window_;
    HDC dc_;
};

// Selects an object into a device context and puts the previous one back when it goes.
class SelectionGuard {
public:
    SelectionGuard(HDC dc, HGDIOBJ object) : dc_(dc), previous_(dc && object ? SelectObject(dc, object) : nullptr) {}
    ~SelectionGuard() {
        if (previous_) SelectObject(dc_, previous_);
    }
    SelectionGuard(const SelectionGuard&) = delete;
    SelectionGuard& operator=(const SelectionGuard&) = delete;

private:
    HDC dc_;
    HGDIOBJ previous_;
};

// Selects a palette (as foreground palette) and realises it; the previous palette goes back
// when the guard goes. Nothing happens for a null palette, as on true-colour displays.
class PaletteGuard {
public:
    PaletteGuard(HDC dc, HPALETTE palette) : dc_(dc) {
        if (dc && palette) {
            previous_ = SelectPalette(dc, palette, FALSE);
            RealizePalette(dc);
        }
    }
    ~PaletteGuard() {
        if (previous_) SelectPalette(dc_, previous_, FALSE);
    }
    PaletteGuard(const PaletteGuard&) = delete;
    PaletteGuard& operator=(const PaletteGuard&) = delete;

private:
    HDC dc_;
    HPALETTE previous_ = nullptr;
};

// Saves a device context's state (selected objects, colours, modes) and restores it when it
// goes: a class DC (CS_OWNDC) keeps whatever a paint leaves in it, so nothing stays behind.
class DcStateGuard {
  public:
    explicit DcStateGuard(HDC dc) : dc_(dc), saved_(dc ? SaveDC(dc) : 0) {}
    ~DcStateGuard() {
        if (saved_ != 0) RestoreDC(dc_, saved_);
    }
    DcStateGuard(const DcStateGuard&) = delete;
    DcStateGuard& operator=(const DcStateGuard&) = delete;

  private:
    HDC dc_;
    int saved_;
};

#endif
