// Loading the backgrounds from the disc and painting the window, read back as pixels.
#include <gtest/gtest.h>

#include <cstring>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "graphics/dib.h"
#include "graphics/masked_blend.h"
#include "graphics/painting_win.h"
#include "graphics/picture_win.h"
#include "locale/catalogue_win.h"
#include "locale/strings_win.h"
#include "shell/launcher_state.h"
#include "test_support_win.h"

namespace {

// An 8-bit grey .bmp file, every pixel black.
std::string GreyBmpFile(int width, int height) {
    const std::uint32_t stride = (static_cast<std::uint32_t>(width) + 3) & ~3u;
    const std::uint32_t offset = 14 + 40 + 1024;
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
    file[28] = 8;
    for (std::size_t level = 0; level < 256; ++level) {
        for (std::size_t channel = 0; channel < 3; ++channel) {
            file[54 + level * 4 + channel] = static_cast<char>(level);
        }
    }
    return file;
}

class Painting : public testing::Test {
  protected:
    void SetUp() override {
        ResetLauncherConfiguration();
        wcscpy_s(launcher.rootPath, disc.Path().c_str());
        launcher.menu.panelOpen = false;
        launcher.menu.installed = false;
        launcher.openPanel = kNoPanel;
    }
    void TearDown() override {
        ReleaseCatalogue();
        launcher.rootPath[0] = L'\0';
        launcher.menu.panelOpen = false;
        launcher.openPanel = kNoPanel;
    }

    void WriteBackground(LanguageBase base, int width = 640, int height = 480) {
        disc.WriteFile(FindLanguage(base)->backgroundFile,
                       SolidBmpFile(width, height, TestColorOf(base)));
    }
    void WriteAllBackgrounds() {
        for (const LanguageInfo& language : Languages()) WriteBackground(language.base);
    }

    TempFolder disc;
};

TEST_F(Painting, CorruptOrMismatchedBackgroundsCountAsMissing) {
    WriteBackground(kUsEnglish);
    WriteBackground(kFrench, 320, 240);  // not the window's size
    std::string truncated = SolidBmpFile(640, 480, TestColorOf(kGerman));
    truncated.resize(1000);
    disc.WriteFile(FindLanguage(kGerman)->backgroundFile, truncated);
    disc.WriteFile(FindLanguage(kSpanish)->backgroundFile, "BM not a picture at all");
    std::string lying = SolidBmpFile(64, 48, TestColorOf(kItalian));
    std::uint32_t hugeWidth = 100000;
    std::memcpy(&lying[18], &hugeWidth, 4);  // header claims far more pixels than the file has
    disc.WriteFile(FindLanguage(kItalian)->backgroundFile, lying);
    LoadBackgrounds();
    EXPECT_EQ(launcher.backgroundWidth, 640);
    EXPECT_NE(BackgroundFor(kUsEnglish), nullptr);
    for (LanguageBase base : {kFrench, kGerman, kSpanish, kItalian}) {
        SCOPED_TRACE(base);
        EXPECT_EQ(BackgroundFor(base), nullptr);
    }
}

// The window's size and every background's shape come from the program's own 640 × 480 24-bit
// picture, never from whichever disc file happens to load first.
TEST_F(Painting, OffShapeFirstBackgroundIsTheOneThatCountsAsMissing) {
    struct Row {
        const char* name;
        std::string file;
    };
    const Row rows[] = {
        {"320 x 240", SolidBmpFile(320, 240, TestColorOf(kUsEnglish))},
        {"8-bit", GreyBmpFile(640, 480)},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        WriteAllBackgrounds();
        disc.WriteFile(FindLanguage(kUsEnglish)->backgroundFile, row.file);
        LoadBackgrounds();
        EXPECT_EQ(launcher.backgroundWidth, 640);
        EXPECT_EQ(launcher.backgroundHeight, 480);
        EXPECT_EQ(BackgroundFor(kUsEnglish), nullptr);
        EXPECT_NE(BackgroundFor(0), nullptr) << "the language-selection picture was dropped";
        for (LanguageBase base : {kFrench, kJapanese, kDanish}) {
            SCOPED_TRACE(base);
            EXPECT_NE(BackgroundFor(base), nullptr);
        }
        // Compositing into the working copy needs its 24 bits.
        DibPtr white(CreateDib(10, 10, 24));
        DibPtr opaque(CreateDib(10, 10, 8));
        std::uint8_t* rows8 = nullptr;
        std::uint32_t stride = 0;
        std::uint16_t depth = 0;
        ASSERT_TRUE(DibRowInfo(white.get(), rows8, stride, depth));
        std::memset(rows8, 255, stride * 10);
        ASSERT_TRUE(DibRowInfo(opaque.get(), rows8, stride, depth));
        std::memset(rows8, 255, stride * 10);
        MaskedBlend(white.get(), {0, 0}, launcher.workingBackground.get(), {0, 0}, opaque.get(),
                    {0, 0}, launcher.workingBackground.get(), {0, 0}, {10, 10});
        ASSERT_TRUE(DibRowInfo(launcher.workingBackground.get(), rows8, stride, depth));
        EXPECT_EQ(rows8[stride * 479], 255) << "the blend left the working copy alone";
        ReleaseCatalogue();
    }
}

TEST_F(Painting, ShowsTheActiveLanguagesBackgroundOrTheLanguageList) {
    WriteAllBackgrounds();
    LoadCatalogue();
    Surface surface(640, 480);
    for (LanguageBase base : {kUsEnglish, kThai, kDanish}) {
        SCOPED_TRACE(base);
        launcher.languageBase = base;
        launcher.languageKnown = true;
        launcher.buttonsRefreshed = true;
        PaintLauncherWindow(surface.Dc());
        EXPECT_EQ(surface.At(5, 5), TestColorOf(base));
        EXPECT_EQ(surface.At(639, 479), TestColorOf(base));
        EXPECT_FALSE(launcher.buttonsRefreshed) << "the buttons are not asked to draw again";
    }
    launcher.languageBase = kNoLanguage;
    launcher.languageKnown = false;
    PaintLauncherWindow(surface.Dc());
    // The program's own language-selection picture, pixel for pixel.
    ASSERT_NE(BackgroundFor(0), nullptr);
    for (POINT at : {POINT{5, 5}, POINT{320, 240}, POINT{639, 479}}) {
        SCOPED_TRACE(testing::Message() << at.x << "," << at.y);
        EXPECT_EQ(surface.At(at.x, at.y), PixelOf(BackgroundFor(0), at.x, at.y));
    }
}

TEST_F(Painting, MissingLanguageBackgroundShowsTheFirstOneLoaded) {
    WriteBackground(kFrench);
    WriteBackground(kGerman);
    LoadCatalogue();
    Surface surface(640, 480);
    launcher.languageBase = kGerman;
    launcher.languageKnown = true;
    PaintLauncherWindow(surface.Dc());
    ASSERT_EQ(surface.At(10, 10), TestColorOf(kGerman));
    launcher.languageBase = kKorean;  // not on this disc
    PaintLauncherWindow(surface.Dc());
    EXPECT_EQ(surface.At(10, 10), TestColorOf(kFrench));
}

TEST_F(Painting, OpenPanelIsCompositedAtItsPlaceThroughTheOpaqueMask) {
    WriteAllBackgrounds();
    LoadCatalogue();
    // Stand-ins with known colours, whatever the program's own pictures look like.
    catalogue.opaqueMask.reset(CreateDib(350, 350, 8));
    std::uint8_t* rows = nullptr;
    std::uint32_t stride = 0;
    std::uint16_t depth = 0;
    ASSERT_TRUE(DibRowInfo(catalogue.opaqueMask.get(), rows, stride, depth));
    std::memset(rows, 252, stride * 350);
    catalogue.panelPictures[1].reset(CreateDib(237, 256, 24));
    ASSERT_TRUE(DibRowInfo(catalogue.panelPictures[1].get(), rows, stride, depth));
    std::memset(rows, 255, stride * 256);  // white

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

// The caption pixels (dark blue text on the green test background) in a band of rows; the
// core is the pixels the glyphs cover fully, which show the caption colour itself.
struct Ink {
    int left = 10000, right = -1, count = 0, core = 0;
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
                ink.left = std::min(ink.left, x);
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
    struct Row {
        int right, bottom;
    };
    for (Row row : {Row{187, 237}, Row{262, 278}, Row{329, 332}, Row{370, 391}, Row{398, 443}}) {
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
    struct DcState {
        HGDIOBJ font, palette;
        COLORREF textColor;
        int backgroundMode, mapMode;
    };
    auto stateOf = [dc] {
        return DcState{GetCurrentObject(dc, OBJ_FONT), GetCurrentObject(dc, OBJ_PAL),
                       GetTextColor(dc), GetBkMode(dc), GetMapMode(dc)};
    };
    const DcState before = stateOf();
    struct Row {
        const char* name;
        void (*paint)(HDC);
    };
    const Row rows[] = {
        {"window paint", [](HDC target) { PaintLauncherWindow(target); }},
        {"one caption", [](HDC target) { DrawCaption(target, 10, 398, 443); }},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        row.paint(dc);
        DcState after = stateOf();
        EXPECT_EQ(after.font, before.font);
        EXPECT_EQ(after.palette, before.palette);
        EXPECT_EQ(after.textColor, before.textColor);
        EXPECT_EQ(after.backgroundMode, before.backgroundMode);
        EXPECT_EQ(after.mapMode, before.mapMode);
    }
    SelectObject(dc, originalFont);
}

// Every background of the sample disc, made straight from the file's checked bytes, is byte
// for byte what LoadImage and DibFromBitmap make of the file.
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

// What the direct read cannot make exactly still loads, through LoadImage and DibFromBitmap.
TEST_F(Painting, FilesTheDirectReadCannotMakeGoThroughGdi) {
    struct Row {
        const char* name;
        std::string file;
    };
    // Rows stored top-down, the first one red and the others blue.
    std::string topDown = SolidBmpFile(8, 4, Rgb{0, 0, 255});
    std::int32_t negativeHeight = -4;
    std::memcpy(&topDown[22], &negativeHeight, 4);
    for (std::size_t x = 0; x < 8; ++x) {
        topDown[54 + x * 3] = 0;
        topDown[54 + x * 3 + 2] = static_cast<char>(255);
    }
    std::string shortTable = GreyBmpFile(8, 4);
    std::uint32_t sixteenColours = 16;
    std::memcpy(&shortTable[46], &sixteenColours, 4);
    std::string v5Header = SolidBmpFile(8, 4, Rgb{10, 20, 30});
    v5Header.insert(54, 84, '\0');
    std::uint32_t v5 = 124, offset = 14 + 124, size = static_cast<std::uint32_t>(v5Header.size());
    std::memcpy(&v5Header[14], &v5, 4);
    std::memcpy(&v5Header[10], &offset, 4);
    std::memcpy(&v5Header[2], &size, 4);
    const Row rows[] = {{"top-down rows", topDown},
                        {"16-entry colour table", shortTable},
                        {"version 5 header", v5Header}};
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        std::wstring path = disc.WriteFile(L"picture.bmp", row.file);
        DibPtr loaded(LoadPictureFile(path.c_str(), kLoadFilePicture));
        DibPtr gdi(LoadPictureFileThroughGdi(path.c_str(), kLoadFilePicture));
        ASSERT_TRUE(loaded && gdi);
        EXPECT_TRUE(SameBlock(loaded.get(), gdi.get()));
    }
}

TEST_F(Painting, NullPictureDrawsThroughPatBlt) {
    Surface surface(20, 20);
    SelectObject(surface.Dc(), GetStockObject(BLACK_BRUSH));
    EXPECT_TRUE(StretchDibBlt(surface.Dc(), 0, 0, 20, 20, nullptr, 0, 0, 20, 20, PATCOPY));
    EXPECT_EQ(surface.At(10, 10), (Rgb{0, 0, 0}));
    SelectObject(surface.Dc(), GetStockObject(WHITE_BRUSH));
    StretchDibBlt(surface.Dc(), 0, 0, 20, 20, nullptr, 0, 0, 20, 20, PATCOPY);
    EXPECT_EQ(surface.At(10, 10), (Rgb{255, 255, 255}));
}

}  // namespace
