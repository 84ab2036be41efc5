// The catalogue as the program loads it from its own resources: pictures, fonts and palette.
#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <set>
#include <tuple>
#include <vector>

#include "graphics/dib.h"
#include "graphics/picture_win.h"
#include "locale/catalogue_win.h"
#include "locale/picture_ids.h"
#include "locale/string_offsets.h"
#include "locale/strings_win.h"
#include "shell/launcher_state.h"
#include "test_support_win.h"

namespace {

void ExpectShape(const DibBitmap* picture, PictureShape expected) {
    ASSERT_NE(picture, nullptr);
    PictureShape shape{0, 0, 0};
    const std::uint8_t* pixels = nullptr;
    std::uint32_t stride = 0;
    DibDimensions(picture, shape.width, shape.height);
    DibRowInfo(picture, pixels, stride, shape.bitCount);
    EXPECT_EQ(shape.width, expected.width);
    EXPECT_EQ(shape.height, expected.height);
    EXPECT_EQ(shape.bitCount, expected.bitCount);
}

class Catalogue : public DiscTest {
  protected:
    void SetUp() override {
        DiscTest::SetUp();
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
        DiscTest::TearDown();
        SetCurrentDirectoryW(savedFolder);
    }
    wchar_t savedFolder[MAX_PATH] = {};
};

// Whether the program's resources have these shapes is the disc check's; here that each
// table slot holds the picture of its own resource.
TEST_F(Catalogue, EverySlotHoldsThePictureOfItsResource) {
    for (std::int32_t key = 0; key < kPlateKeys; ++key) {
        for (int state = 0; state < kPlateStates; ++state) {
            SCOPED_TRACE(testing::Message() << "plate " << key << " state " << state);
            ExpectShape(PlateFor(state, key), PlateShape(key));
        }
        // The focused plate is the normal one loaded again: equal bytes, its own block.
        EXPECT_NE(PlateFor(0, key), PlateFor(2, key));
        EXPECT_TRUE(SameBlock(PlateFor(0, key), PlateFor(2, key)));
    }
    EXPECT_EQ(PlateFor(0, kPlateKeys), nullptr);
    EXPECT_EQ(PlateFor(3, 0), nullptr) << "plates have no latched face";
    for (std::int32_t key = 0; key < kIconKeys; ++key) {
        const IconResources& icon = kIconResources[key == kListAboutIconKey ? kAboutIconKey : key];
        for (int state = 0; state < kIconStates; ++state) {
            SCOPED_TRACE(testing::Message() << "icon " << key << " state " << state);
            if (icon.picture[state] == 0) {
                EXPECT_EQ(IconPictureFor(state, key), nullptr);
                EXPECT_EQ(IconMaskFor(state, key), nullptr);
                continue;
            }
            ExpectShape(IconPictureFor(state, key), icon.shape);
            ExpectShape(IconMaskFor(state, key), {icon.shape.width, icon.shape.height, 8});
            // The list's About button draws for both About buttons, from copies of its own.
            if (key != kListAboutIconKey) continue;
            EXPECT_NE(IconPictureFor(state, key), IconPictureFor(state, kAboutIconKey));
            EXPECT_NE(IconMaskFor(state, key), IconMaskFor(state, kAboutIconKey));
            EXPECT_TRUE(
                SameBlock(IconPictureFor(state, key), IconPictureFor(state, kAboutIconKey)));
        }
    }
    for (std::size_t panel = 0; panel < kPanelResources.size(); ++panel) {
        ExpectShape(catalogue.panelPictures[panel].get(), kPanelResources[panel].shape);
    }
    ExpectShape(catalogue.opaqueMask.get(), kOpaqueMaskShape);
    ExpectShape(BackgroundFor(0), kBackgroundShape);
}

TEST_F(Catalogue, EveryLanguageHasItsFont) {
    struct Row {
        LanguageBase base;
        const wchar_t* face;
        LONG height;
        LONG weight;
        BYTE charset;
    };
    // Every other language: Comic Sans MS, 16 pixels, normal weight, Western characters.
    const Row others{kNoLanguage, L"Comic Sans MS", -16, 400, 0};
    const Row own[] = {
        {kPolish, others.face, -16, 400, 238},
        {kJapanese, L"\uFF2D\uFF33 \uFF30\u30B4\u30B7\u30C3\u30AF", -12, 700, 128},
        {kTraditionalChinese, L"\u65B0\u7D30\u660E\u9AD4", -12, 700, 136},
        {kSimplifiedChinese, L"\u5B8B\u4F53", -12, 700, 134},
        {kThai, L"Angsana New [Thai]", -16, 700, 222},
        {kKorean, L"GulimChe", -12, 700, 129},
    };
    const std::uint32_t kDrawnTexts[] = {
        kStrInstall,         kStrPlay,         kStrMoreGames,  kStrVisitWebSite,
        kStrMoreInformation, kStrExit,         kStrReadme,     kStrSupportTool,
        kStrRegistration,    kStrPlay800,      kStrPlay1024,   kStrCreator,
        kStrDemoPc,          kStrLanguageName, kStrDemoLorrel, kStrDemoDuskaro};
    MemoryDc dc(CreateCompatibleDC(nullptr));
    for (const LanguageInfo& language : Languages()) {
        Row row = others;
        for (const Row& special : own) {
            if (special.base == language.base) row = special;
        }
        SCOPED_TRACE(language.base);
        LOGFONTW font{};
        ASSERT_EQ(GetObjectW(FontFor(language.base), sizeof(font), &font),
                  static_cast<int>(sizeof(font)));
        EXPECT_STREQ(font.lfFaceName, row.face);
        // Height, weight, character set, precision, quality; nothing italic or underlined.
        EXPECT_EQ(
            std::make_tuple(font.lfHeight, font.lfWeight, font.lfCharSet, font.lfOutPrecision,
                            font.lfQuality, font.lfItalic | font.lfUnderline | font.lfStrikeOut),
            std::make_tuple(row.height, row.weight, row.charset, BYTE{OUT_TT_PRECIS},
                            BYTE{ANTIALIASED_QUALITY}, 0));
        // Selected, the face keeps its name (an unknown one falls back to another; under Wine
        // tests/wine/fonts.reg maps each to a free font) and holds every glyph of the texts
        // drawn with it.
        const int saved = SaveDC(dc.Get());
        SelectObject(dc.Get(), FontFor(language.base));
        wchar_t face[LF_FACESIZE] = {};
        GetTextFaceW(dc.Get(), LF_FACESIZE, face);
        EXPECT_STREQ(face, row.face) << "the font mapper chose another face";
        EXPECT_EQ(GetTextCharset(dc.Get()), row.charset);
        for (std::uint32_t offset : kDrawnTexts) {
            wchar_t text[kMessageCapacity] = {};
            const int length = LoadLocalString(language.base, offset, text, kMessageCapacity);
            std::vector<WORD> glyphs(static_cast<std::size_t>(length));
            GetGlyphIndicesW(dc.Get(), text, length, glyphs.data(), GGI_MARK_NONEXISTING_GLYPHS);
            EXPECT_EQ(std::count(glyphs.begin(), glyphs.end(), 0xFFFF), 0)
                << "a glyph missing from string " << language.base + offset;
        }
        RestoreDC(dc.Get(), saved);
    }
    // Languages that share a font share one handle, which release deletes once.
    EXPECT_EQ(FontFor(kUkEnglish), FontFor(kUsEnglish));
    EXPECT_EQ(FontFor(kNoLanguage), nullptr);
    EXPECT_EQ(FontFor(9000), nullptr);
    // The Cyrillic font is made and released, though no language uses it.
    LOGFONTW cyrillic{};
    ASSERT_TRUE(GetObjectW(catalogue.fontSlots[static_cast<int>(FontSlot::Cyrillic)],
                           sizeof(cyrillic), &cyrillic));
    EXPECT_EQ(std::make_tuple(cyrillic.lfHeight, cyrillic.lfWeight, cyrillic.lfCharSet),
              std::make_tuple(-12L, 700L, BYTE{RUSSIAN_CHARSET}));
}

int fontChangesSeen = 0;

LRESULT CALLBACK CountFontChanges(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_FONTCHANGE) ++fontChangesSeen;
    return DefWindowProcW(window, message, wParam, lParam);
}

TEST_F(Catalogue, ReleaseLeavesNothingBehind) {
    // Release has the private font to remove. Wine lists no font that duplicates an installed
    // one, so the removal shows only in the change it announces to this thread's windows.
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
    EXPECT_EQ(FontFor(kUsEnglish), nullptr);  // the rest of the tables: the shutdown test's
}

// The launcher's way on displays of more than 8 bits is byte for byte GDI's round trip.
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

// On displays of more than 8 bits per pixel there is no palette and no picture changes. At 8
// bits (the palette fixture's run) the palette keeps the system's colours at both ends.
TEST_F(Catalogue, OnlyAPaletteDisplayGetsTheLauncherPalette) {
    HDC screen = GetDC(nullptr);
    const int bits = GetDeviceCaps(screen, BITSPIXEL);
    PALETTEENTRY system[256] = {};
    GetSystemPaletteEntries(screen, 0, 256, system);
    ReleaseDC(nullptr, screen);
    // The 256-colour run says so, so that a display of another depth cannot pass it by.
    if (bits > 8) {
        ASSERT_EQ(GetEnvironmentVariableW(L"AUTOPLAY_EXPECT_PALETTE_DISPLAY", nullptr, 0), 0u)
            << "this run needs a display of 8 bits per pixel, got " << bits;
    }
    DibPtr grey(CreateDib(4, 4, 8));
    DibPtr colour(CreateDib(4, 4, 24));
    DibPtr greyBefore(CloneDib(grey.get()));
    DibPtr colourBefore(CloneDib(colour.get()));
    EXPECT_TRUE(ApplyLauncherPalette(grey.get()));
    EXPECT_TRUE(ApplyLauncherPalette(colour.get()));
    EXPECT_FALSE(ApplyLauncherPalette(nullptr));
    EXPECT_TRUE(SameBlock(colour.get(), colourBefore.get())) << "24 bits have no table to change";
    if (bits > 8) {
        EXPECT_EQ(launcher.palette.Get(), nullptr);
        EXPECT_EQ(launcher.paletteTable, nullptr);
        EXPECT_TRUE(SameBlock(grey.get(), greyBefore.get()));
        return;
    }
    ASSERT_NE(launcher.palette.Get(), nullptr);
    ASSERT_NE(launcher.paletteTable, nullptr);
    PALETTEENTRY entries[256] = {};
    ASSERT_EQ(GetPaletteEntries(launcher.palette.Get(), 0, 256, entries), 256u);
    auto rgb = [](const PALETTEENTRY& e) { return RGB(e.peRed, e.peGreen, e.peBlue); };
    for (int i : {0, 9, 246, 255}) EXPECT_EQ(rgb(entries[i]), rgb(system[i])) << "entry " << i;
    EXPECT_EQ(rgb(entries[11]), RGB(32, 31, 232)) << "entry 11 of the program's palette";
    // 8-bit pictures take the palette's colours.
    const void* header = nullptr;
    const void* table = nullptr;
    const std::uint8_t* pixels = nullptr;
    ASSERT_TRUE(DibParts(grey.get(), header, table, pixels));
    EXPECT_EQ(std::memcmp(table, launcher.paletteTable.get(), 1024), 0);
}

}  // namespace
