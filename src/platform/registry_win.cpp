#include "platform/registry_win.h"

#include <vector>

RegistryKey OpenKeyForReading(HKEY root, const wchar_t* path) {
    HKEY key = nullptr;
    if (RegOpenKeyExW(root, path, 0, KEY_READ | kProductRegistryView, &key) != ERROR_SUCCESS) {
        return RegistryKey();
    }
    return RegistryKey(key);
}

RegistryKey CreateKeyForWriting(HKEY root, const wchar_t* path) {
    HKEY key = nullptr;
    if (RegCreateKeyExW(root, path, 0, nullptr, REG_OPTION_NON_VOLATILE,
                        KEY_ALL_ACCESS | kProductRegistryView, nullptr, &key,
                        nullptr) != ERROR_SUCCESS) {
        return RegistryKey();
    }
    return RegistryKey(key);
}

bool DeleteKeyTree(HKEY root, const wchar_t* path) {
    // RegDeleteTreeW takes no view, so the key is opened in the view first and emptied through
    // that handle; RegDeleteKeyExW then removes the key itself from the same view.
    HKEY opened = nullptr;
    LONG result = RegOpenKeyExW(
        root, path, 0,
        DELETE | KEY_ENUMERATE_SUB_KEYS | KEY_QUERY_VALUE | KEY_SET_VALUE | kProductRegistryView,
        &opened);
    if (result == ERROR_FILE_NOT_FOUND) return true;
    if (result != ERROR_SUCCESS) return false;
    RegistryKey key(opened);
    if (RegDeleteTreeW(key.Get(), nullptr) != ERROR_SUCCESS) return false;
    key.Reset();
    result = RegDeleteKeyExW(root, path, kProductRegistryView, 0);
    return result == ERROR_SUCCESS || result == ERROR_FILE_NOT_FOUND;
}

bool QueryData(HKEY key, const wchar_t* name, BYTE* buffer, DWORD& size, DWORD* type) {
    DWORD valueType = REG_NONE;
    // ERROR_MORE_DATA (the value does not fit) counts as a failed read, like any other error.
    LONG result = RegQueryValueExW(key, name, nullptr, &valueType, buffer, &size);
    if (result != ERROR_SUCCESS) return false;
    if (type) *type = valueType;
    return true;
}

bool QueryText(HKEY key, const wchar_t* name, wchar_t* buffer, std::size_t capacity) {
    if (capacity == 0) return false;
    // Read into scratch space one character larger, so a value that fills the buffer
    // without its own terminator still gets one.
    std::vector<wchar_t> scratch(capacity + 1, L'\0');
    DWORD size = static_cast<DWORD>(capacity * sizeof(wchar_t));
    DWORD type = REG_NONE;
    if (!QueryData(key, name, reinterpret_cast<BYTE*>(scratch.data()), size, &type)) return false;
    if (type != REG_SZ) return false;
    std::size_t chars = size / sizeof(wchar_t);
    if (chars < capacity) scratch[chars] = L'\0';
    // A value of exactly `capacity` characters without a terminator does not fit.
    std::size_t length = 0;
    while (length < capacity && scratch[length] != L'\0') ++length;
    if (length == capacity) return false;
    for (std::size_t i = 0; i <= length; ++i) buffer[i] = scratch[i];
    return true;
}
