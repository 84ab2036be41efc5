// Owners for the Win32 handles the launcher holds: each closes its handle once, can be
// moved and cannot be copied.
#ifndef AUTOPLAY_PLATFORM_HANDLES_WIN_H
#define AUTOPLAY_PLATFORM_HANDLES_WIN_H

#include <windows.h>

#include <atomic>
#include <utility>

// GDI objects and device contexts that an owner below took and no owner has deleted yet,
// process-wide. Wine's GetGuiResources answers 0, so this is how a leak in the drawing paths
// shows from outside (the main window reports it).
inline std::atomic<long> gdiHandlesHeld{0};

template <typename Handle, typename Traits>
class UniqueResource {
public:
    UniqueResource() = default;
    explicit UniqueResource(Handle handle) { Reset(handle); }
    ~UniqueResource() { Reset(); }
    UniqueResource(const UniqueResource&) = delete;
    UniqueResource& operator=(const UniqueResource&) = delete;
    UniqueResource(UniqueResource&& other) noexcept
        : handle_(std::exchange(other.handle_, Traits::Empty())) {}
    UniqueResource& operator=(UniqueResource&& other) noexcept {
        if (this != &other) {
            Reset();
            handle_ = std::exchange(other.handle_, Traits::Empty());
        }
        return *this;
    }

    Handle Get() const { return handle_; }
    explicit operator bool() const { return !Traits::IsEmpty(handle_); }
    // A released GDI handle stays counted until an owner deletes it: one that nobody deletes
    // is a leak, and the count should show it.
    Handle Release() { return std::exchange(handle_, Traits::Empty()); }
    void Reset(Handle handle = Traits::Empty()) {
        Handle old = std::exchange(handle_, handle);
        if (!Traits::IsEmpty(handle)) Traits::Held(+1);
        if (!Traits::IsEmpty(old)) {
            Traits::Close(old);
            Traits::Held(-1);
        }
    }

private:
    Handle handle_ = Traits::Empty();
};

struct KernelHandleTraits {
    static HANDLE Empty() { return nullptr; }
    static bool IsEmpty(HANDLE h) { return h == nullptr || h == INVALID_HANDLE_VALUE; }
    static void Close(HANDLE h) { CloseHandle(h); }
    static void Held(int) {}
};
using UniqueHandle = UniqueResource<HANDLE, KernelHandleTraits>;

struct RegistryKeyTraits {
    static HKEY Empty() { return nullptr; }
    static bool IsEmpty(HKEY key) { return key == nullptr; }
    static void Close(HKEY key) { RegCloseKey(key); }
    static void Held(int) {}
};
using RegistryKey = UniqueResource<HKEY, RegistryKeyTraits>;

template <typename Object>
struct GdiObjectTraits {
    static Object Empty() { return nullptr; }
    static bool IsEmpty(Object object) { return object == nullptr; }
    static void Close(Object object) { DeleteObject(object); }
    static void Held(int change) { gdiHandlesHeld += change; }
};
template <typename Object>
using UniqueGdi = UniqueResource<Object, GdiObjectTraits<Object>>;
using UniqueGdiObject = UniqueGdi<HGDIOBJ>;

struct MemoryDcTraits {
    static HDC Empty() { return nullptr; }
    static bool IsEmpty(HDC dc) { return dc == nullptr; }
    static void Close(HDC dc) { DeleteDC(dc); }
    static void Held(int change) { gdiHandlesHeld += change; }
};
using MemoryDc = UniqueResource<HDC, MemoryDcTraits>;

// The device context of a window (null: the whole screen), released when it goes.
class WindowDc {
public:
    explicit WindowDc(HWND window) : window_(window), dc_(GetDC(window)) {
        if (dc_) ++gdiHandlesHeld;
    }
    ~WindowDc() {
        if (!dc_) return;
        ReleaseDC(window_, dc_);
        --gdiHandlesHeld;
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
