// The catalogue as the program loads it from its own resources: every table filled with
// pictures of the right size and depth, the fonts by language, and the palette on 256-colour
// displays only.
#include <gtest/gtest.h>

#include <cstring>
#include <set>
#include <vector>

#include "graphics/dib.h"
#include "graphics/picture_win.h"
#include "locale/catalogue_win.h"
#include "locale/picture_ids.h"
#include "shell/launcher_state.h"
#include "test_support_win.h"

namespace {

struct Shape {
    std::int32_t width, height;
    std::uint16_t depth;
};

Shape ShapeOf(const DibBitmap* picture) {
    Shape shape{0, 0, 0};
    const std::uint8_t* pixels = nullptr;
    std::uint32_t stride = 0;
    DibDimensions(picture, shape.width, shape.height);
    DibRowInfo(picture, pixels, stride, shape.depth);
    return shape;
}

void ExpectShape(const DibBitmap* picture, Shape expected) {
    ASSERT_NE(picture, nullptr);
    Shape shape = ShapeOf(picture);
    EXPECT_EQ(shape.width, expected.width);
    EXPECT_EQ(shape.height, expected.height);
    EXPECT_EQ(shape.depth, expected.depth);
}

class Catalogue : public testing::Test {
  protected:
    void SetUp() override {
        ResetLauncherConfiguration();
        wcscpy_s(launcher.rootPath, disc.Path().c_str());
        disc.WriteFile(FindLanguage(kUsEnglish)->backgroundFile,
                       SolidBmpFile(640, 480, TestColorOf(kUsEnglish)));
        // The private font is added by its bare name, found in the current folder as the
        // launcher finds it on its disc.
        std::wstring font = disc.MakeFoldersFor(kPrivateFontFile);
        ASSERT_TRUE(CopyFileW((TestProgramFolder() + L"..\\disc\\" + kPrivateFontFile).c_str(),
                              font.c_str(), FALSE));
        GetCurrentDirectoryW(MAX_PATH, savedFolder);
        SetCurrentDirectoryW(disc.Path().c_str());
        LoadCatalogue();
    }
    void TearDown() override {
        ReleaseCatalogue();
        SetCurrentDirectoryW(savedFolder);
        launcher.rootPath[0] = L'\0';
    }
    TempFolder disc;
    wchar_t savedFolder[MAX_PATH] = {};
};

TEST_F(Catalogue, PlatesHaveTheirSizeInEveryState) {
    for (std::int32_t key = 0; key <= 22; ++key) {
        Shape expected = key <= 10 ? Shape{209, 49, 24} : Shape{212, 50, 24};
        for (int state = 0; state < kPlateStates; ++state) {
            SCOPED_TRACE(testing::Message() << "plate " << key << " state " << state);
            ExpectShape(PlateFor(state, key), expected);
        }
        // The focused plate is the normal one loaded again: equal bytes, its own block.
        EXPECT_NE(PlateFor(0, key), PlateFor(2, key));
        ASSERT_EQ(DibBlockSize(PlateFor(0, key)), DibBlockSize(PlateFor(2, key)));
        EXPECT_EQ(std::memcmp(PlateFor(0, key), PlateFor(2, key), DibBlockSize(PlateFor(0, key))),
                  0);
    }
    EXPECT_EQ(PlateFor(0, 23), nullptr);
    EXPECT_EQ(PlateFor(3, 0), nullptr) << "plates have no latched face";
}

TEST_F(Catalogue, CircularButtonsHaveAPictureAndAMaskPerState) {
    const Shape sizes[13] = {{85, 96, 24},  {85, 96, 24}, {85, 96, 24}, {85, 96, 24},
                             {85, 96, 24},  {85, 96, 24}, {66, 67, 24}, {73, 79, 24},
                             {73, 79, 24},  {73, 87, 24}, {54, 54, 24}, {162, 117, 24},
                             {162, 117, 24}};
    const std::set<std::int32_t> latched = {1, 2, 3, 4, 5, 7, 9};
    for (std::int32_t key = 0; key <= 12; ++key) {
        for (int state = 0; state < kIconStates; ++state) {
            SCOPED_TRACE(testing::Message() << "icon " << key << " state " << state);
            if (state == 3 && !latched.count(key)) {
                EXPECT_EQ(IconPictureFor(state, key), nullptr);
                EXPECT_EQ(IconMaskFor(state, key), nullptr);
                continue;
            }
            ExpectShape(IconPictureFor(state, key), sizes[key]);
            Shape mask = sizes[key];
            mask.depth = 8;
            ExpectShape(IconMaskFor(state, key), mask);
        }
    }
}

TEST_F(Catalogue, ListAboutButtonOwnsCopiesOfTheMainAboutButtonsPictures) {
    for (int state = 0; state < kPlateStates; ++state) {
        SCOPED_TRACE(state);
        DibBitmap* main = IconPictureFor(state, 11);
        DibBitmap* copy = IconPictureFor(state, 12);
        ASSERT_TRUE(main && copy);
        EXPECT_NE(main, copy);
        ASSERT_EQ(DibBlockSize(main), DibBlockSize(copy));
        EXPECT_EQ(std::memcmp(main, copy, DibBlockSize(main)), 0);
        EXPECT_NE(IconMaskFor(state, 11), IconMaskFor(state, 12));
    }
    // Freeing one key's pictures leaves the other's intact.
    DibBitmap* copy = IconPictureFor(0, 12);
    std::vector<std::uint8_t> before(reinterpret_cast<std::uint8_t*>(copy),
                                     reinterpret_cast<std::uint8_t*>(copy) + DibBlockSize(copy));
    catalogue.iconPictures[0].erase(11);
    EXPECT_EQ(std::memcmp(copy, before.data(), before.size()), 0);
}

TEST_F(Catalogue, PanelsMaskAndLanguageListBackgroundHaveTheirShape) {
    ExpectShape(catalogue.panelPictures[0].get(), {240, 149, 24});
    ExpectShape(catalogue.panelPictures[1].get(), {237, 256, 24});
    ExpectShape(catalogue.panelPictures[2].get(), {237, 252, 24});
    ExpectShape(catalogue.opaqueMask.get(), {350, 350, 8});
    ExpectShape(BackgroundFor(0), {640, 480, 24});
}

TEST_F(Catalogue, EveryLanguageHasItsFont) {
    struct Row {
        LanguageBase base;
        const wchar_t* face;
        LONG height;
        LONG weight;
        BYTE charset;
    };
    const wchar_t* comic = L"Comic Sans MS";
    const Row rows[] = {
        {kUsEnglish, comic, -16, 400, 0},
        {kFrench, comic, -16, 400, 0},
        {kGerman, comic, -16, 400, 0},
        {kSwedish, comic, -16, 400, 0},
        {kDutch, comic, -16, 400, 0},
        {kPortuguese, comic, -16, 400, 0},
        {kSpanish, comic, -16, 400, 0},
        {kItalian, comic, -16, 400, 0},
        {kPolish, comic, -16, 400, 238},
        {kJapanese, L"\uFF2D\uFF33 \uFF30\u30B4\u30B7\u30C3\u30AF", -12, 700, 128},
        {kTraditionalChinese, L"\u65B0\u7D30\u660E\u9AD4", -12, 700, 136},
        {kSimplifiedChinese, L"\u5B8B\u4F53", -12, 700, 134},
        {kThai, L"Angsana New [Thai]", -16, 700, 222},
        {kKorean, L"GulimChe", -12, 700, 129},
        {kUkEnglish, comic, -16, 400, 0},
        {kNorwegian, comic, -16, 400, 0},
        {kFinnish, comic, -16, 400, 0},
        {kDanish, comic, -16, 400, 0},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.base);
        LOGFONTW font{};
        ASSERT_EQ(GetObjectW(FontFor(row.base), sizeof(font), &font),
                  static_cast<int>(sizeof(font)));
        EXPECT_STREQ(font.lfFaceName, row.face);
        EXPECT_EQ(font.lfHeight, row.height);
        EXPECT_EQ(font.lfWeight, row.weight);
        EXPECT_EQ(font.lfCharSet, row.charset);
        EXPECT_EQ(font.lfOutPrecision, OUT_TT_PRECIS);
        EXPECT_EQ(font.lfQuality, ANTIALIASED_QUALITY);
        EXPECT_FALSE(font.lfItalic || font.lfUnderline || font.lfStrikeOut);
    }
    // Languages that share a font share one handle, which release deletes once.
    EXPECT_EQ(FontFor(kUkEnglish), FontFor(kUsEnglish));
    EXPECT_EQ(FontFor(kNoLanguage), nullptr);
    EXPECT_EQ(FontFor(9000), nullptr);
    // The Cyrillic font is made and released, though no language uses it.
    LOGFONTW cyrillic{};
    ASSERT_TRUE(GetObjectW(catalogue.fontSlots[static_cast<int>(FontSlot::Cyrillic)],
                           sizeof(cyrillic), &cyrillic));
    EXPECT_EQ(cyrillic.lfHeight, -12);
    EXPECT_EQ(cyrillic.lfWeight, 700);
    EXPECT_EQ(cyrillic.lfCharSet, RUSSIAN_CHARSET);
}

int fontChangesSeen = 0;

LRESULT CALLBACK CountFontChanges(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_FONTCHANGE) ++fontChangesSeen;
    return DefWindowProcW(window, message, wParam, lParam);
}

TEST_F(Catalogue, ReleaseLeavesNothingBehind) {
    // The private font was found (the tests run beside a copy of it), so release has it to
    // remove. Wine keeps a font that duplicates an installed one out of its list, so the
    // removal shows only in the change it announces, which a window of this thread receives
    // before the broadcast returns.
    ASSERT_GT(catalogue.fontFileAdded, 0);
    WNDCLASSW windowClass{};
    windowClass.lpfnWndProc = CountFontChanges;
    windowClass.hInstance = GetModuleHandleW(nullptr);
    windowClass.lpszClassName = L"FontChangeCounter";
    RegisterClassW(&windowClass);
    HWND listener = CreateWindowExW(0, windowClass.lpszClassName, L"", WS_POPUP, 0, 0, 1, 1,
                                    nullptr, nullptr, windowClass.hInstance, nullptr);
    ASSERT_TRUE(listener);
    fontChangesSeen = 0;
    ReleaseCatalogue();
    DestroyWindow(listener);
    EXPECT_EQ(fontChangesSeen, 1);
    EXPECT_EQ(catalogue.fontFileAdded, 0);
    EXPECT_EQ(FontFor(kUsEnglish), nullptr);
    EXPECT_EQ(PlateFor(0, 0), nullptr);
    EXPECT_EQ(IconPictureFor(0, 0), nullptr);
    EXPECT_EQ(BackgroundFor(kUsEnglish), nullptr);
    EXPECT_EQ(launcher.workingBackground, nullptr);
}

// Every picture the catalogue loads from the program, made straight from the resource's bytes,
// is byte for byte what LoadImage and DibFromBitmap make of it. The launcher takes the short
// way only on displays of more than 8 bits, where no palette comes between.
TEST_F(Catalogue, PicturesFromResourceBytesEqualTheGdiRoundTrip) {
    std::set<WORD> ids = {kLanguageListBackgroundId, kOpaqueMaskId};
    for (const auto& plates : kPlateResources) ids.insert(std::begin(plates), std::end(plates));
    for (const IconResources& icon : kIconResources) {
        for (int state = 0; state < kIconStates; ++state) {
            if (icon.picture[state]) ids.insert(icon.picture[state]);
            if (icon.mask[state]) ids.insert(icon.mask[state]);
        }
    }
    for (const PanelResource& panel : kPanelResources) ids.insert(panel.id);
    ASSERT_GT(ids.size(), 130u);

    bool palette = launcher.palette.Get() != nullptr;
    for (WORD id : ids) {
        SCOPED_TRACE(id);
        DibPtr direct(PictureFromResourceBytes(id));
        DibPtr gdi(LoadPictureResourceThroughGdi(id, kLoadResourcePicture));
        DibPtr loaded(LoadPictureResource(id, kLoadResourcePicture));
        ASSERT_TRUE(direct && gdi && loaded);
        ASSERT_TRUE(DibIsConsistent(direct.get()));
        EXPECT_TRUE(SameBlock(loaded.get(), gdi.get()));
        if (!palette) {
            EXPECT_TRUE(SameBlock(direct.get(), gdi.get()));
        }
    }
}

// On displays of more than 8 bits per pixel there is no palette and no picture changes.
TEST_F(Catalogue, TrueColourDisplayHasNoPalette) {
    HDC screen = GetDC(nullptr);
    int bits = GetDeviceCaps(screen, BITSPIXEL);
    ReleaseDC(nullptr, screen);
    if (bits <= 8) GTEST_SKIP() << "palette display";
    EXPECT_EQ(launcher.palette.Get(), nullptr);
    EXPECT_EQ(launcher.paletteTable, nullptr);
    DibBitmap* mask = IconMaskFor(0, 0);
    std::vector<std::uint8_t> before(reinterpret_cast<std::uint8_t*>(mask),
                                     reinterpret_cast<std::uint8_t*>(mask) + DibBlockSize(mask));
    EXPECT_TRUE(ApplyLauncherPalette(mask));
    EXPECT_EQ(std::memcmp(mask, before.data(), before.size()), 0);
    EXPECT_FALSE(ApplyLauncherPalette(nullptr));
}

// Run with the display at 8 bits per pixel (the palette fixture).
TEST_F(Catalogue, PaletteDisplayGetsTheLauncherPalette) {
    HDC screen = GetDC(nullptr);
    int bits = GetDeviceCaps(screen, BITSPIXEL);
    PALETTEENTRY system[256] = {};
    GetSystemPaletteEntries(screen, 0, 256, system);
    ReleaseDC(nullptr, screen);
    if (bits > 8) {
        // The 256-colour run says so, so that a display of another depth cannot pass it by.
        ASSERT_EQ(GetEnvironmentVariableW(L"AUTOPLAY_EXPECT_PALETTE_DISPLAY", nullptr, 0), 0u)
            << "this run needs a display of 8 bits per pixel, got " << bits;
        GTEST_SKIP() << "true-colour display";
    }
    ASSERT_NE(launcher.palette.Get(), nullptr);
    ASSERT_NE(launcher.paletteTable, nullptr);
    PALETTEENTRY entries[256] = {};
    ASSERT_EQ(GetPaletteEntries(launcher.palette.Get(), 0, 256, entries), 256u);
    for (int i : {0, 9, 246, 255}) {
        SCOPED_TRACE(i);
        EXPECT_EQ(entries[i].peRed, system[i].peRed);
        EXPECT_EQ(entries[i].peGreen, system[i].peGreen);
        EXPECT_EQ(entries[i].peBlue, system[i].peBlue);
    }
    // Entry 11 comes from the program's palette resource.
    EXPECT_EQ(entries[11].peRed, 32);
    EXPECT_EQ(entries[11].peGreen, 31);
    EXPECT_EQ(entries[11].peBlue, 232);
    // 8-bit pictures take the palette's colours; 24-bit ones have no table to change.
    DibPtr grey(CreateDib(4, 4, 8));
    ASSERT_TRUE(ApplyLauncherPalette(grey.get()));
    const void* header = nullptr;
    const void* table = nullptr;
    const std::uint8_t* pixels = nullptr;
    ASSERT_TRUE(DibParts(grey.get(), header, table, pixels));
    EXPECT_EQ(std::memcmp(table, launcher.paletteTable.get(), 1024), 0);
    DibPtr colour(CreateDib(4, 4, 24));
    std::vector<std::uint8_t> before(
        reinterpret_cast<std::uint8_t*>(colour.get()),
        reinterpret_cast<std::uint8_t*>(colour.get()) + DibBlockSize(colour.get()));
    EXPECT_TRUE(ApplyLauncherPalette(colour.get()));
    EXPECT_EQ(std::memcmp(colour.get(), before.data(), before.size()), 0);
}

}  // namespace
