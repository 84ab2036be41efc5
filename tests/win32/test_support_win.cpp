#include "test_support_win.h"

#include <gtest/gtest.h>

#include <cstring>
#include <filesystem>
#include <fstream>

#include "graphics/dib.h"
#include "locale/catalogue_win.h"
#include "locale/config_win.h"
#include "platform/text_win.h"
#include "shell/launcher_state.h"

void DeleteMachineKey(const wchar_t* path, REGSAM view) {
    // RegDeleteTreeW has no view of its own: it works below a key opened in one.
    HKEY key = nullptr;
    if (RegOpenKeyExW(HKEY_LOCAL_MACHINE, path, 0, KEY_ALL_ACCESS | view, &key) != ERROR_SUCCESS) {
        return;
    }
    RegDeleteTreeW(key, nullptr);
    RegCloseKey(key);
    RegDeleteKeyExW(HKEY_LOCAL_MACHINE, path, view, 0);
}

std::optional<std::wstring> MachineText(const wchar_t* path, const wchar_t* name, REGSAM view) {
    HKEY key = nullptr;
    if (RegOpenKeyExW(HKEY_LOCAL_MACHINE, path, 0, KEY_READ | view, &key) != ERROR_SUCCESS) {
        return std::nullopt;
    }
    wchar_t text[512] = {};
    DWORD bytes = sizeof(text);
    LONG result = RegGetValueW(key, nullptr, name, RRF_RT_REG_SZ, nullptr, text, &bytes);
    RegCloseKey(key);
    if (result != ERROR_SUCCESS) return std::nullopt;
    return std::wstring(text);
}

ScopedMachineKey::ScopedMachineKey(const wchar_t* path, REGSAM view) : path_(path), view_(view) {
    LONG result = RegCreateKeyExW(HKEY_LOCAL_MACHINE, path, 0, nullptr, 0, KEY_ALL_ACCESS | view,
                                  nullptr, &key_, nullptr);
    EXPECT_EQ(result, ERROR_SUCCESS);
}

ScopedMachineKey::~ScopedMachineKey() {
    if (key_) RegCloseKey(key_);
    DeleteMachineKey(path_.c_str(), view_);
}

void ScopedMachineKey::Set(const wchar_t* name, DWORD type, const void* data, DWORD size) {
    ASSERT_EQ(RegSetValueExW(key_, name, 0, type, static_cast<const BYTE*>(data), size),
              ERROR_SUCCESS);
}

TempFolder::TempFolder() {
    wchar_t base[MAX_PATH];
    GetTempPathW(MAX_PATH, base);
    static unsigned counter = 0;
    for (;;) {
        path_ = std::wstring(base) + L"autoplay-test-" + std::to_wstring(GetCurrentProcessId()) +
                L"-" + std::to_wstring(++counter) + L"\\";
        if (CreateDirectoryW(path_.c_str(), nullptr)) break;
        if (GetLastError() != ERROR_ALREADY_EXISTS) {
            ADD_FAILURE() << "cannot create a temporary folder";
            break;
        }
    }
}

TempFolder::~TempFolder() {
    for (int attempt = 0; attempt < 50; ++attempt) {
        RemoveTree(path_);
        if (GetFileAttributesW(path_.c_str()) == INVALID_FILE_ATTRIBUTES) return;
        Sleep(100);
    }
}

std::wstring TempFolder::MakeFoldersFor(const std::wstring& relativePath) const {
    std::wstring path = path_ + relativePath;
    for (std::size_t slash = path.find(L'\\', path_.size()); slash != std::wstring::npos;
         slash = path.find(L'\\', slash + 1)) {
        CreateDirectoryW(path.substr(0, slash).c_str(), nullptr);
    }
    return path;
}

std::wstring TempFolder::WriteFile(const std::wstring& relativePath,
                                   const std::string& bytes) const {
    std::wstring path = MakeFoldersFor(relativePath);
    std::ofstream file(std::filesystem::path(path), std::ios::binary);
    EXPECT_TRUE(file.write(bytes.data(), static_cast<std::streamsize>(bytes.size())).flush().good())
        << "cannot write a test file";
    return path;
}

void RemoveTree(const std::wstring& folder) {
    std::wstring root = folder;
    if (!root.empty() && root.back() != L'\\') root += L'\\';
    WIN32_FIND_DATAW entry;
    HANDLE search = FindFirstFileW((root + L"*").c_str(), &entry);
    if (search != INVALID_HANDLE_VALUE) {
        do {
            std::wstring name = entry.cFileName;
            if (name == L"." || name == L"..") continue;
            std::wstring path = root + name;
            if (entry.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) {
                RemoveTree(path);
            } else {
                SetFileAttributesW(path.c_str(), FILE_ATTRIBUTE_NORMAL);
                DeleteFileW(path.c_str());
            }
        } while (FindNextFileW(search, &entry));
        FindClose(search);
    }
    RemoveDirectoryW(root.c_str());
}

void ResetLauncherConfiguration() {
    launcher.discSku = 0;
    launcher.productSku = 0;
    launcher.languageBase = kNoLanguage;
    launcher.languageKnown = false;
    launcher.useSystemLanguage = false;
    launcher.instance = GetModuleHandleW(nullptr);
}

void ResetLauncherMenu() {
    MenuController& menu = launcher.menu;
    menu.DestroyAllButtons();
    menu.installed = false;
    menu.mainMenuBuilt = false;
    menu.panelOpen = false;
    menu.installIndex = menu.playIndex = menu.gamesIndex = menu.infoIndex = -1;
    menu.lastPanel = 0;
    launcher.appActive = true;
    launcher.buttonsRefreshed = false;
}

void DiscTest::SetUp() {
    for (const wchar_t* key : {kProductKeyPath, kUninstallKeyPath, kLocaleKeyPath}) {
        DeleteMachineKey(key);
    }
    ResetLauncherConfiguration();
    ResetLauncherMenu();
    launcher.openPanel = kNoPanel;
    wcscpy_s(launcher.rootPath, disc.Path().c_str());
}

void DiscTest::TearDown() {
    ReleaseCatalogue();
    for (const wchar_t* key : {kProductKeyPath, kUninstallKeyPath, kLocaleKeyPath}) {
        DeleteMachineKey(key);
    }
    launcher.rootPath[0] = L'\0';
}

bool RunningOnWine() {
    HMODULE ntdll = GetModuleHandleW(L"ntdll.dll");
    return ntdll && GetProcAddress(ntdll, "wine_get_version") != nullptr;
}

std::wstring TestProgramFolder() {
    std::wstring path = ModuleFileName();
    return path.substr(0, path.rfind(L'\\') + 1);
}

std::ostream& operator<<(std::ostream& out, const Rgb& color) {
    return out << "(" << int(color.r) << "," << int(color.g) << "," << int(color.b) << ")";
}

std::string BmpFile(int width, int height, int depth,
                    const std::function<Rgb(int x, int y)>& pixel) {
    const std::uint32_t bytes = static_cast<std::uint32_t>(depth) / 8;
    const std::uint32_t stride = (static_cast<std::uint32_t>(width) * bytes + 3) & ~3u;
    const std::uint32_t offset = 54 + (depth == 8 ? 1024 : 0);
    std::string file(offset + stride * static_cast<std::uint32_t>(height), '\0');
    auto put32 = [&](std::size_t at, std::uint32_t v) { std::memcpy(&file[at], &v, 4); };
    file[0] = 'B';
    file[1] = 'M';
    put32(2, static_cast<std::uint32_t>(file.size()));
    put32(10, offset);
    put32(14, 40);
    put32(18, static_cast<std::uint32_t>(width));
    put32(22, static_cast<std::uint32_t>(height));
    file[26] = 1;
    file[28] = static_cast<char>(depth);
    put32(34, stride * static_cast<std::uint32_t>(height));
    for (std::uint32_t level = 0; depth == 8 && level < 256; ++level) {
        put32(54 + level * 4, level * 0x010101u);
    }
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            const Rgb color = pixel(x, y);
            char* p = &file[offset + static_cast<std::uint32_t>(height - 1 - y) * stride +
                            static_cast<std::uint32_t>(x) * bytes];
            p[0] = static_cast<char>(color.b);
            if (depth == 24) {
                p[1] = static_cast<char>(color.g);
                p[2] = static_cast<char>(color.r);
            }
        }
    }
    return file;
}

std::string SolidBmpFile(int width, int height, Rgb color) {
    return BmpFile(width, height, 24, [color](int, int) { return color; });
}

Rgb TestColorOf(LanguageBase base) {
    return {static_cast<std::uint8_t>(40 + base / 1000 * 10), 200,
            static_cast<std::uint8_t>(base / 100)};
}

Rgb ScreenPixel(int x, int y) {
    HDC screen = GetDC(nullptr);
    COLORREF color = GetPixel(screen, x, y);
    ReleaseDC(nullptr, screen);
    return {GetRValue(color), GetGValue(color), GetBValue(color)};
}

BITMAPINFO TopDownInfo(int width, int height) {
    BITMAPINFO info{};
    info.bmiHeader.biSize = sizeof(info.bmiHeader);
    info.bmiHeader.biWidth = width;
    info.bmiHeader.biHeight = -height;
    info.bmiHeader.biPlanes = 1;
    info.bmiHeader.biBitCount = 32;
    return info;
}

Surface::Surface(int width, int height) : width_(width) {
    BITMAPINFO info = TopDownInfo(width, height);
    WindowDc screen(nullptr);
    dc_.Reset(CreateCompatibleDC(screen.Get()));
    bitmap_.Reset(CreateDIBSection(dc_.Get(), &info, DIB_RGB_COLORS, &bits_, nullptr, 0));
    selected_ = SelectObject(dc_.Get(), bitmap_.Get());
}

Rgb Surface::At(int x, int y) const {
    GdiFlush();
    const auto* pixel = static_cast<const std::uint8_t*>(bits_) + (y * width_ + x) * 4;
    return {pixel[2], pixel[1], pixel[0]};
}

Rgb PixelOf(const DibBitmap* picture, int x, int y) {
    const std::uint8_t* rows = nullptr;
    std::uint32_t stride = 0;
    std::uint16_t depth = 0;
    std::int32_t width = 0, height = 0;
    if (!DibRowInfo(picture, rows, stride, depth) || !DibDimensions(picture, width, height)) {
        return {0, 0, 0};
    }
    const std::uint8_t* p =
        rows + static_cast<std::size_t>(height - 1 - y) * stride + x * (depth / 8);
    return depth == 8 ? Rgb{0, 0, p[0]} : Rgb{p[2], p[1], p[0]};
}

testing::AssertionResult SameBlock(const DibBitmap* a, const DibBitmap* b) {
    if (!a || !b) return testing::AssertionFailure() << "a picture is missing";
    if (DibBlockSize(a) != DibBlockSize(b)) {
        return testing::AssertionFailure()
               << "blocks of " << DibBlockSize(a) << " and " << DibBlockSize(b) << " bytes";
    }
    const auto* x = reinterpret_cast<const std::uint8_t*>(a);
    const auto* y = reinterpret_cast<const std::uint8_t*>(b);
    for (std::size_t at = 0; at < DibBlockSize(a); ++at) {
        if (x[at] != y[at]) {
            return testing::AssertionFailure() << "first difference at byte " << at << ": "
                                               << int{x[at]} << " against " << int{y[at]};
        }
    }
    return testing::AssertionSuccess();
}
