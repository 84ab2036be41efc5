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

struct GdiObjectTraits {
    static HGDIOBJ Empty() { return nullptr; }
    static bool IsEmpty(HGDIOBJ object) { return object == nullptr; }
    static void Close(HGDIOBJ object) { DeleteObject(object); }
};
using UniqueGdiObject = UniqueResource<HGDIOBJ, GdiObjectTraits>;

#endif
