// Loading the backgrounds from the disc and painting the window, read back as pixels.
#include <gtest/gtest.h>

#include <cstring>
#include <fstream>
#include <iterator>
#include <string>
#include <tuple>

#include "graphics/dib.h"
#include "graphics/main_menu_layout.h"
#include "graphics/masked_blend.h"
#include "graphics/painting_win.h"
#include "graphics/picture_win.h"
#include "locale/catalogue_win.h"
#include "locale/strings_win.h"
#include "shell/launcher_state.h"
#include "test_support_win.h"

namespace {

// A picture block with every byte `value`.
DibPtr Filled(int width, int height, std::uint16_t bits, std::uint8_t value) {
    DibPtr picture(CreateDib(width, height, bits));
    std::uint8_t* rows = nullptr;
    std::uint32_t stride = 0;
    if (DibRowInfo(picture.get(), rows, stride, bits)) std::memset(rows, value, stride * height);
    return picture;
}

// An 8-bit grey .bmp file, every pixel black.
std::string GreyBmpFile(int width, int height) {
    return BmpFile(width, height, 8, [](int, int) { return Rgb{0, 0, 0}; });
}

class Painting : public DiscTest {
  protected:
    void WriteBackground(LanguageBase base) {
        disc.WriteFile(FindLanguage(base)->backgroundFile,
                       SolidBmpFile(640, 480, TestColorOf(base)));
    }
    void WriteAllBackgrounds() {
        for (const LanguageInfo& language : Languages()) WriteBackground(language.base);
    }
};

// A damaged background counts as missing. The window's size and every background's shape come
// from the program's own 640 × 480 24-bit picture, never from whichever file loads first.
TEST_F(Painting, DamagedBackgroundsCountAsMissingWhicheverLoadsFirst) {
    // Which files are whole is the host tests'; here that each file is asked.
    std::string truncated = SolidBmpFile(640, 480, TestColorOf(kGerman));
    truncated.resize(1000);
    const struct {
        const char* name;
        LanguageBase base;
        std::string file;
    } rows[] = {
        {"first one at 320 x 240", kUsEnglish, SolidBmpFile(320, 240, TestColorOf(kUsEnglish))},
        {"first one 8-bit", kUsEnglish, GreyBmpFile(640, 480)},
        {"320 x 240", kFrench, SolidBmpFile(320, 240, TestColorOf(kFrench))},
        {"truncated", kGerman, truncated},
    };
    WriteAllBackgrounds();
    for (const auto& row : rows) {
        SCOPED_TRACE(row.name);
        disc.WriteFile(FindLanguage(row.base)->backgroundFile, row.file);
        LoadBackgrounds();
        EXPECT_EQ(launcher.backgroundWidth, 640);
        EXPECT_EQ(launcher.backgroundHeight, 480);
        EXPECT_NE(BackgroundFor(0), nullptr) << "the language-selection picture was dropped";
        for (const LanguageInfo& language : Languages()) {
            EXPECT_EQ(BackgroundFor(language.base) == nullptr, language.base == row.base)
                << "language " << language.base;
        }
        // Compositing into the working copy needs its 24 bits.
        MaskedBlend(Filled(10, 10, 24, 255).get(), {0, 0}, launcher.workingBackground.get(), {0, 0},
                    Filled(10, 10, 8, 255).get(), {0, 0}, launcher.workingBackground.get(), {0, 0},
                    {10, 10});
        EXPECT_EQ(PixelOf(launcher.workingBackground.get(), 0, 0), (Rgb{255, 255, 255}))
            << "the blend left the working copy alone";
        ReleaseCatalogue();
        WriteBackground(row.base);
    }
}

TEST_F(Painting, ShowsTheLanguagesBackgroundElseTheFirstLoadedOrTheLanguageList) {
    WriteBackground(kFrench);
    WriteBackground(kGerman);
    LoadCatalogue();
    Surface surface(640, 480);
    launcher.languageKnown = true;
    launcher.buttonsRefreshed = true;
    launcher.languageBase = kGerman;
    PaintLauncherWindow(surface.Dc());
    EXPECT_EQ(surface.At(639, 479), TestColorOf(kGerman));
    EXPECT_FALSE(launcher.buttonsRefreshed) << "the buttons are not asked to draw again";
    launcher.languageBase = kKorean;  // not on this disc
    PaintLauncherWindow(surface.Dc());
    EXPECT_EQ(surface.At(10, 10), TestColorOf(kFrench));
    // No language yet: the program's own language-selection picture, pixel for pixel.
    launcher.languageBase = kNoLanguage;
    launcher.languageKnown = false;
    PaintLauncherWindow(surface.Dc());
    ASSERT_NE(BackgroundFor(0), nullptr);
    for (POINT at : {POINT{5, 5}, POINT{320, 240}, POINT{639, 479}}) {
        SCOPED_TRACE(testing::Message() << at.x << "," << at.y);
        EXPECT_EQ(surface.At(at.x, at.y), PixelOf(BackgroundFor(0), at.x, at.y));
    }
}

TEST_F(Painting, OpenPanelIsCompositedAtItsPlaceThroughTheOpaqueMask) {
    WriteAllBackgrounds();
    LoadCatalogue();
    // Stand-ins with known colours, whatever the program's own pictures look like.
    catalogue.opaqueMask = Filled(350, 350, 8, 252);
    catalogue.panelPictures[1] = Filled(237, 256, 24, 255);  // white

    launcher.languageBase = kUsEnglish;
    launcher.languageKnown = true;
    launcher.menu.panelOpen = true;
    launcher.openPanel = 1;
    Surface surface(640, 480);
    PaintLauncherWindow(surface.Dc());
    Rgb under = TestColorOf(kUsEnglish);
    auto blend = [](int a, int b) { return static_cast<std::uint8_t>((a * 252 + b * 3) >> 8); };
    Rgb expected{blend(255, under.r), blend(255, under.g), blend(255, under.b)};
    EXPECT_EQ(surface.At(403, 67), expected);
    EXPECT_EQ(surface.At(639, 322), expected);
    EXPECT_EQ(surface.At(402, 67), under);
    EXPECT_EQ(surface.At(403, 66), under);
    EXPECT_EQ(surface.At(500, 323), under);

    // Closing the panel paints the pristine background again.
    launcher.menu.panelOpen = false;
    launcher.openPanel = kNoPanel;
    PaintLauncherWindow(surface.Dc());
    EXPECT_EQ(surface.At(500, 100), under);
}

// The caption colour as this display shows it: exact on true colour, else the palette's nearest.
Rgb CaptionColorShown() {
    if (!launcher.palette) return {0, 0, 140};
    PALETTEENTRY entry{};
    GetPaletteEntries(launcher.palette.Get(),
                      GetNearestPaletteIndex(launcher.palette.Get(), RGB(0, 0, 140)), 1, &entry);
    return {entry.peRed, entry.peGreen, entry.peBlue};
}

// Caption pixels in a band of rows; the core ones, covered fully, show the caption colour.
struct Ink {
    int right = -1, count = 0, core = 0;
};
Ink FindInk(const Surface& surface, int top, int bottom, Rgb background) {
    const Rgb caption = CaptionColorShown();
    Ink ink;
    for (int y = top; y <= bottom; ++y) {
        for (int x = 0; x < 640; ++x) {
            Rgb c = surface.At(x, y);
            if (c == background) continue;
            // Anti-aliased text lies between the background and the caption colour: its
            // green falls well below the background's.
            if (c.g + 60 < background.g) {
                ink.right = std::max(ink.right, x);
                ++ink.count;
            }
            if (c == caption) ++ink.core;
        }
    }
    return ink;
}

TEST_F(Painting, CaptionsAreRightAlignedAtTheirPointsInTheCaptionColour) {
    WriteAllBackgrounds();
    LoadCatalogue();
    launcher.languageBase = kUsEnglish;
    launcher.languageKnown = true;
    Surface surface(640, 480);
    PaintLauncherWindow(surface.Dc());
    Rgb background = TestColorOf(kUsEnglish);
    for (const CaptionPlacement& row : MainMenuCaptions(false, 1, 1, kUsEnglish)) {
        SCOPED_TRACE(row.right);
        Ink ink = FindInk(surface, row.bottom - 14, row.bottom - 2, background);
        ASSERT_GT(ink.count, 20) << "no caption text there";
        EXPECT_GE(ink.core, 5) << "the text is not drawn in the caption colour";
        EXPECT_LE(ink.right, row.right);
        // Side bearings of the last glyph leave a few pixels free; a left-aligned or misplaced
        // caption would end far from the point.
        EXPECT_GE(ink.right, row.right - 12) << "caption does not end at its point";
    }
    // Without a settled language there are no captions.
    launcher.languageKnown = false;
    launcher.languageBase = kNoLanguage;
    catalogue.languageBackgrounds[0].reset(CloneDib(BackgroundFor(kUsEnglish)));
    PaintLauncherWindow(surface.Dc());
    EXPECT_EQ(FindInk(surface, 223, 235, background).count, 0);
}

// The window's DC is a class DC that keeps its state between paints, and the catalogue
// deletes its fonts at shutdown: a paint must hand the DC back as it found it.
TEST_F(Painting, PaintingLeavesTheDcAsItFoundIt) {
    WriteAllBackgrounds();
    LoadCatalogue();
    launcher.languageBase = kUsEnglish;
    launcher.languageKnown = true;
    Surface surface(640, 480);
    HDC dc = surface.Dc();
    UniqueGdi<HFONT> ownFont(CreateFontW(-20, 0, 0, 0, FW_NORMAL, FALSE, FALSE, FALSE,
                                         DEFAULT_CHARSET, 0, 0, 0, 0, L"Arial"));
    HGDIOBJ originalFont = SelectObject(dc, ownFont.Get());
    SetTextColor(dc, RGB(1, 2, 3));
    SetBkMode(dc, OPAQUE);
    // Isotropic at one to one draws as MM_TEXT does, so only the mode itself can differ.
    SetMapMode(dc, MM_ISOTROPIC);
    // Font, palette, text colour, background mode and map mode.
    auto stateOf = [dc] {
        return std::make_tuple(GetCurrentObject(dc, OBJ_FONT), GetCurrentObject(dc, OBJ_PAL),
                               GetTextColor(dc), GetBkMode(dc), GetMapMode(dc));
    };
    const auto before = stateOf();
    PaintLauncherWindow(dc);
    EXPECT_EQ(stateOf(), before) << "after the window's paint";
    DrawCaption(dc, 10, 398, 443);
    EXPECT_EQ(stateOf(), before) << "after one caption";
    SelectObject(dc, originalFont);
}

// Every background of the sample disc read straight from its bytes is what GDI makes of it.
TEST_F(Painting, DiscBackgroundsFromFileBytesEqualTheGdiRoundTrip) {
    const std::wstring built = TestProgramFolder() + L"..\\disc\\";
    bool palette = launcher.palette.Get() != nullptr;
    for (const LanguageInfo& language : Languages()) {
        SCOPED_TRACE(language.base);
        std::wstring path = built + language.backgroundFile;
        DibPtr loaded(LoadPictureFile(path.c_str(), kLoadFilePicture));
        DibPtr gdi(LoadPictureFileThroughGdi(path.c_str(), kLoadFilePicture));
        ASSERT_TRUE(loaded && gdi) << "the sample disc has not been built";
        EXPECT_TRUE(SameBlock(loaded.get(), gdi.get()));
        if (palette) continue;
        // On this display the launcher reads the file's bytes once and never asks GDI.
        std::ifstream in(path.c_str(), std::ios::binary);
        std::string file((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
        ASSERT_GT(file.size(), 54u);
        std::uint32_t pixelOffset = 0;
        std::memcpy(&pixelOffset, &file[10], 4);
        DibPtr direct(DibFromStoredPicture(reinterpret_cast<const std::uint8_t*>(file.data()) + 14,
                                           file.size() - 14, pixelOffset - 14));
        EXPECT_TRUE(SameBlock(direct.get(), gdi.get()));
    }
}

// What the direct read refuses (each kind: the host tests) still loads, through GDI.
TEST_F(Painting, FilesTheDirectReadCannotMakeGoThroughGdi) {
    // Rows of their own colours, stored top-down.
    std::string topDown = BmpFile(8, 4, 24, [](int, int y) {
        return Rgb{0, 0, std::uint8_t(60 * y)};
    });
    const std::int32_t negativeHeight = -4;
    std::memcpy(&topDown[22], &negativeHeight, 4);
    std::string shortTable = GreyBmpFile(8, 4);
    const std::uint32_t sixteenColours = 16;
    std::memcpy(&shortTable[46], &sixteenColours, 4);
    for (const std::string& file : {topDown, shortTable}) {
        SCOPED_TRACE(file.size());
        std::wstring path = disc.WriteFile(L"picture.bmp", file);
        DibPtr loaded(LoadPictureFile(path.c_str(), kLoadFilePicture));
        DibPtr gdi(LoadPictureFileThroughGdi(path.c_str(), kLoadFilePicture));
        ASSERT_TRUE(loaded && gdi);
        EXPECT_TRUE(SameBlock(loaded.get(), gdi.get()));
    }
}

TEST_F(Painting, NullPictureDrawsThroughPatBlt) {
    Surface surface(20, 20);  // black
    SelectObject(surface.Dc(), GetStockObject(WHITE_BRUSH));
    EXPECT_TRUE(StretchDibBlt(surface.Dc(), 0, 0, 20, 20, nullptr, 0, 0, 20, 20, PATCOPY));
    EXPECT_EQ(surface.At(10, 10), (Rgb{255, 255, 255}));
}

}  // namespace
