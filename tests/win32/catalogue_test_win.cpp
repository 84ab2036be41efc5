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
        LoadCatalogue();
    }
    void TearDown() override {
        ReleaseCatalogue();
        launcher.rootPath[0] = L'\0';
    }
    TempFolder disc;
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
        EXPECT_EQ(std::memcmp(PlateFor(0, key), PlateFor(2, key), DibBlockSize(PlateFor(0, key))), 0);
    }
    EXPECT_EQ(PlateFor(0, 23), nullptr);
    EXPECT_EQ(PlateFor(3, 0), nullptr) << "plates have no latched face";
}

TEST_F(Catalogue, CircularButtonsHaveAPictureAndAMaskPerState) {
    const Shape sizes[13] = {{85, 96, 24}, {85, 96, 24}, {85, 96, 24}, {85, 96, 24}, {85, 96, 24},
                             {85, 96, 24}, {66, 67, 24}, {73, 79, 24}, {73, 79, 24}, {73, 87, 24},
                             {54, 54, 24}, {162, 117, 24}, {162, 117, 24}};
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

TEST_F(Catalogue, PanelsMaskAndLanguageListBackground) {
    ExpectShape(catalogue.panelPictures[0].get(), {240, 149, 24});
    ExpectShape(catalogue.panelPictures[1].get(), {237, 256, 24});
    ExpectShape(catalogue.panelPictures[2].get(), {237, 252, 24});
    ExpectShape(catalogue.opaqueMask.get(), {350, 350, 8});
    ExpectShape(BackgroundFor(0), {640, 480, 24});
    // Every value of the opaque mask is nearly opaque.
    const std::uint8_t* rows = nullptr;
    std::uint32_t stride = 0;
    std::uint16_t depth = 0;
    ASSERT_TRUE(DibRowInfo(catalogue.opaqueMask.get(), rows, stride, depth));
    for (int y = 0; y < 350; ++y) {
        for (int x = 0; x < 350; ++x) {
            std::uint8_t value = rows[y * stride + x];
            ASSERT_TRUE(value == 251 || value == 252) << "at " << x << "," << y;
        }
    }
}

TEST_F(Catalogue, FontsByLanguage) {
    for (const LanguageInfo& language : Languages()) {
        SCOPED_TRACE(language.base);
        EXPECT_EQ(FontFor(language.base), catalogue.fontSlots[static_cast<int>(language.font)]);
        EXPECT_NE(FontFor(language.base), nullptr);
    }
    EXPECT_EQ(FontFor(kNoLanguage), nullptr);
    EXPECT_EQ(FontFor(9000), nullptr);
    EXPECT_NE(FontFor(kPolish), FontFor(kUsEnglish));
    EXPECT_EQ(FontFor(kUkEnglish), FontFor(kUsEnglish));
    LOGFONTW polish{};
    ASSERT_TRUE(GetObjectW(FontFor(kPolish), sizeof(polish), &polish));
    EXPECT_EQ(polish.lfCharSet, EASTEUROPE_CHARSET);
    EXPECT_EQ(polish.lfHeight, -16);
    LOGFONTW japanese{};
    ASSERT_TRUE(GetObjectW(FontFor(kJapanese), sizeof(japanese), &japanese));
    EXPECT_EQ(japanese.lfCharSet, SHIFTJIS_CHARSET);
    EXPECT_EQ(japanese.lfWeight, FW_BOLD);
    EXPECT_STREQ(japanese.lfFaceName, L"\uFF2D\uFF33 \uFF30\u30B4\u30B7\u30C3\u30AF");
    EXPECT_NE(catalogue.fontSlots[static_cast<int>(FontSlot::Cyrillic)], nullptr);
}

TEST_F(Catalogue, ReleaseLeavesNothingBehind) {
    ReleaseCatalogue();
    EXPECT_EQ(FontFor(kUsEnglish), nullptr);
    EXPECT_EQ(PlateFor(0, 0), nullptr);
    EXPECT_EQ(IconPictureFor(0, 0), nullptr);
    EXPECT_EQ(BackgroundFor(kUsEnglish), nullptr);
    EXPECT_EQ(launcher.workingBackground, nullptr);
    EXPECT_EQ(catalogue.fontFileAdded, 0);
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
    std::vector<std::uint8_t> before(reinterpret_cast<std::uint8_t*>(colour.get()),
                                     reinterpret_cast<std::uint8_t*>(colour.get()) + DibBlockSize(colour.get()));
    EXPECT_TRUE(ApplyLauncherPalette(colour.get()));
    EXPECT_EQ(std::memcmp(colour.get(), before.data(), before.size()), 0);
}

}  // namespace
