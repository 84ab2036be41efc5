// Helpers shared by the Windows tests: self-cleaning keys and folders, fresh launcher state.
#ifndef AUTOPLAY_TESTS_TEST_SUPPORT_WIN_H
#define AUTOPLAY_TESTS_TEST_SUPPORT_WIN_H

#include <gtest/gtest.h>
#include <windows.h>

#include <cstdint>
#include <functional>
#include <optional>
#include <ostream>
#include <string>

#include "locale/language_table.h"
#include "platform/handles_win.h"
#include "platform/registry_win.h"

// Deletes an HKLM key and all below it, if there, in the product's (32-bit) view unless told.
void DeleteMachineKey(const wchar_t* path, REGSAM view = kProductRegistryView);

// A REG_SZ value of an HKLM key, terminated or not; nothing when the key or value is missing.
std::optional<std::wstring> MachineText(const wchar_t* path, const wchar_t* name,
                                        REGSAM view = kProductRegistryView);

// An HKEY_LOCAL_MACHINE key deleted with everything below it when the test ends.
class ScopedMachineKey {
  public:
    explicit ScopedMachineKey(const wchar_t* path, REGSAM view = kProductRegistryView);
    ~ScopedMachineKey();
    ScopedMachineKey(const ScopedMachineKey&) = delete;
    ScopedMachineKey& operator=(const ScopedMachineKey&) = delete;

    void Set(const wchar_t* name, DWORD type, const void* data, DWORD size);
    void SetText(const wchar_t* name, const std::wstring& text) {
        Set(name, REG_SZ, text.c_str(), static_cast<DWORD>((text.size() + 1) * sizeof(wchar_t)));
    }
    void SetDword(const wchar_t* name, DWORD value) { Set(name, REG_DWORD, &value, sizeof value); }
    HKEY Get() const { return key_; }

  private:
    std::wstring path_;
    REGSAM view_;
    HKEY key_ = nullptr;
};

// A new folder under %TEMP%, removed when the test ends (once programs in it have closed).
class TempFolder {
  public:
    TempFolder();
    ~TempFolder();
    TempFolder(const TempFolder&) = delete;
    TempFolder& operator=(const TempFolder&) = delete;

    // With a trailing backslash.
    const std::wstring& Path() const { return path_; }
    // Writes a file below the folder (making sub-folders as needed) and returns its path.
    std::wstring WriteFile(const std::wstring& relativePath, const std::string& bytes) const;
    // Makes the sub-folders a file below the folder needs and returns the file's path.
    std::wstring MakeFoldersFor(const std::wstring& relativePath) const;

  private:
    std::wstring path_;
};

void RemoveTree(const std::wstring& folder);

// Puts the launcher's configuration fields back to their start values.
void ResetLauncherConfiguration();
// Destroys the menu's buttons and puts its fields back to their start values.
void ResetLauncherMenu();

// From the launcher's start values, without its keys, on a disc of its own; released after.
class DiscTest : public testing::Test {
  protected:
    void SetUp() override;
    void TearDown() override;
    TempFolder disc;
};

struct Rgb {
    std::uint8_t r, g, b;
    bool operator==(const Rgb& o) const { return r == o.r && g == o.g && b == o.b; }
    bool operator!=(const Rgb& o) const { return !(*this == o); }
};
std::ostream& operator<<(std::ostream& out, const Rgb& color);

// A 24-bit .bmp file, or 8-bit with a grey table (the level in b); y counted from the top.
std::string BmpFile(int width, int height, int depth,
                    const std::function<Rgb(int x, int y)>& pixel);
std::string SolidBmpFile(int width, int height, Rgb color);
// A colour of its own for each language, so a test can tell which background shows.
Rgb TestColorOf(LanguageBase base);
// The pixel at a point of the screen, as the user sees it.
Rgb ScreenPixel(int x, int y);
// The header of a 32-bit top-down picture, the layout tests read pixels in.
BITMAPINFO TopDownInfo(int width, int height);

// A 32-bit top-down memory surface to paint into and read back as pixels.
class Surface {
  public:
    Surface(int width, int height);
    ~Surface() { SelectObject(dc_.Get(), selected_); }
    Surface(const Surface&) = delete;
    Surface& operator=(const Surface&) = delete;
    HDC Dc() const { return dc_.Get(); }
    Rgb At(int x, int y) const;

  private:
    int width_;
    MemoryDc dc_;
    UniqueGdi<HBITMAP> bitmap_;
    HGDIOBJ selected_ = nullptr;
    void* bits_ = nullptr;
};

struct DibBitmap;
// A pixel of a picture block, counted from the top (24-bit: its colour; 8-bit: its value in b).
Rgb PixelOf(const DibBitmap* picture, int x, int y);
// Success when both blocks have the same length and bytes; otherwise says where they part.
testing::AssertionResult SameBlock(const DibBitmap* a, const DibBitmap* b);

// Wine behaves differently from Windows in a few documented details.
bool RunningOnWine();

// The folder of the running test program, with a trailing backslash.
std::wstring TestProgramFolder();

#endif
