// Checks the generated pictures, palette, sounds and icon against what the launcher relies on.
// The generated directory comes from DISC_ART_DIR; the language backgrounds are looked for in
// DISC_ART_BACKGROUNDS_DIR when it is set, else in the same directory.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <map>
#include <set>
#include <sstream>
#include <string>
#include <vector>

namespace {

using Bytes = std::vector<uint8_t>;

uint32_t U32(const Bytes& b, size_t at) {
    return static_cast<uint32_t>(b[at]) | static_cast<uint32_t>(b[at + 1]) << 8 |
           static_cast<uint32_t>(b[at + 2]) << 16 | static_cast<uint32_t>(b[at + 3]) << 24;
}
uint16_t U16(const Bytes& b, size_t at) {
    return static_cast<uint16_t>(b[at] | b[at + 1] << 8);
}
int32_t I32(const Bytes& b, size_t at) {
    return static_cast<int32_t>(U32(b, at));
}

bool ReadAll(const std::string& path, Bytes& bytes) {
    std::ifstream in(path, std::ios::binary);
    if (!in) return false;
    bytes.assign(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
    return true;
}

// A picture as the launcher sees it after loading: top-down, three bytes (B, G, R) or one.
struct Bitmap {
    int width = 0;
    int height = 0;
    int bits = 0;
    Bytes pixels;

    const uint8_t* At(int x, int y) const {
        return &pixels[(static_cast<size_t>(y) * width + x) * (bits / 8)];
    }
    uint8_t Grey(int x, int y) const { return *At(x, y); }
};

// Parses a Windows bitmap file, checking the header fields the launcher's loader depends on.
::testing::AssertionResult ParseBmp(const Bytes& file, Bitmap& out) {
    if (file.size() < 54 || file[0] != 'B' || file[1] != 'M') {
        return ::testing::AssertionFailure() << "no BM file header";
    }
    if (U32(file, 2) != file.size()) return ::testing::AssertionFailure() << "bfSize is wrong";
    if (U32(file, 14) != 40) return ::testing::AssertionFailure() << "header is not 40 bytes";
    out.width = I32(file, 18);
    out.height = I32(file, 22);
    out.bits = U16(file, 28);
    if (out.width <= 0 || out.height <= 0) {
        return ::testing::AssertionFailure() << "not a bottom-up picture";
    }
    if (U16(file, 26) != 1) return ::testing::AssertionFailure() << "planes is not 1";
    if (U32(file, 30) != 0) return ::testing::AssertionFailure() << "compressed";
    if (out.bits != 24 && out.bits != 8) {
        return ::testing::AssertionFailure() << out.bits << " bits per pixel";
    }
    const size_t stride = static_cast<size_t>(((out.width * out.bits + 31) / 32) * 4);
    const size_t table = out.bits == 8 ? 1024 : 0;
    const size_t offset = U32(file, 10);
    if (offset != 54 + table) return ::testing::AssertionFailure() << "pixel offset " << offset;
    if (U32(file, 34) != stride * out.height) {
        return ::testing::AssertionFailure() << "biSizeImage " << U32(file, 34);
    }
    if (file.size() != offset + stride * out.height) {
        return ::testing::AssertionFailure() << "file size does not match the rows";
    }
    if (out.bits == 8) {
        if (U32(file, 46) != 0 && U32(file, 46) != 256) {
            return ::testing::AssertionFailure() << "colour count " << U32(file, 46);
        }
        for (size_t i = 0; i < 256; ++i) {
            const size_t at = 54 + i * 4;
            if (file[at] != i || file[at + 1] != i || file[at + 2] != i || file[at + 3] != 0) {
                return ::testing::AssertionFailure() << "grey table entry " << i << " is not grey";
            }
        }
    }
    const size_t rowBytes = static_cast<size_t>(out.width) * (out.bits / 8);
    out.pixels.resize(rowBytes * out.height);
    for (int y = 0; y < out.height; ++y) {
        const uint8_t* row = &file[offset + stride * (out.height - 1 - y)];
        std::copy(row, row + rowBytes, out.pixels.begin() + static_cast<long>(rowBytes * y));
    }
    return ::testing::AssertionSuccess();
}

struct Rect {
    int x, y, w, h;
};

// The launcher's MaskedBlend, written out again: D = (A * m + B * (255 - m)) >> 8.
void Blend(const Bitmap& a, Bitmap& bd, int x, int y, const Bitmap& mask) {
    for (int r = 0; r < a.height; ++r) {
        for (int c = 0; c < a.width; ++c) {
            const int m = mask.Grey(c, r);
            uint8_t* d = &bd.pixels[(static_cast<size_t>(y + r) * bd.width + x + c) * 3];
            const uint8_t* s = a.At(c, r);
            for (int k = 0; k < 3; ++k) {
                d[k] = m == 0     ? d[k]
                       : m == 255 ? s[k]
                                  : static_cast<uint8_t>((s[k] * m + d[k] * (255 - m)) >> 8);
            }
        }
    }
}

double Channel(uint8_t v) {
    const double c = v / 255.0;
    return c <= 0.04045 ? c / 12.92 : std::pow((c + 0.055) / 1.055, 2.4);
}

// Relative luminance of a B, G, R pixel.
double Luminance(const uint8_t* bgr) {
    return 0.2126 * Channel(bgr[2]) + 0.7152 * Channel(bgr[1]) + 0.0722 * Channel(bgr[0]);
}

double Contrast(double a, double b) {
    return (std::max(a, b) + 0.05) / (std::min(a, b) + 0.05);
}

// ---- What the launcher expects of its resources ----

struct ExpectedBitmap {
    int id, width, height, bits;
};

struct ExpectedIcon {
    int key, width, height;
    int pictures[4];  // normal, pressed, focused, latched; 0 = none
    int masks[4];
    int hitX, hitY, hitRadius;  // button client coordinates
    int reach = 8;              // how far solid parts may lie outside the hit circle
};

const ExpectedIcon kIcons[] = {
    {0, 85, 96, {223, 246, 245, 0}, {269, 265, 266, 0}, 40, 50, 35},
    {1, 85, 96, {237, 238, 239, 362}, {273, 274, 270, 372}, 40, 50, 35},
    {2, 85, 96, {327, 324, 397, 368}, {319, 325, 396, 369}, 40, 50, 35},
    {3, 85, 96, {395, 240, 236, 367}, {272, 275, 271, 375}, 40, 50, 35},
    {4, 85, 96, {320, 326, 390, 370}, {321, 318, 389, 371}, 40, 50, 35},
    {5, 85, 96, {322, 391, 393, 374}, {323, 392, 394, 373}, 40, 50, 35},
    {6, 66, 67, {333, 330, 332, 0}, {329, 331, 328, 0}, 29, 31, 31},
    {7, 73, 79, {218, 219, 220, 366}, {255, 256, 257, 363}, 33, 42, 29},
    {8, 73, 79, {384, 385, 387, 0}, {388, 386, 383, 0}, 33, 42, 29},
    {9, 73, 87, {224, 225, 226, 364}, {261, 262, 259, 365}, 37, 48, 26},
    {10, 54, 54, {221, 217, 228, 0}, {254, 263, 260, 0}, 26, 25, 23},
    // The About emblem's banner runs out past its medallion on both sides.
    {11, 162, 117, {380, 379, 378, 0}, {267, 268, 267, 0}, 74, 54, 60, 30},
};

// Plate key, normal (= focused) and pressed ids, and the place whose picture it carries.
struct ExpectedPlate {
    int key, normal, pressed, x, y;
    int panel;  // 376, 227 or 222; 0 for the language list on 377
};

const ExpectedPlate kPlates[] = {
    {0, 408, 409, 416, 29, 222},  {1, 350, 352, 416, 81, 222},   {2, 340, 338, 416, 133, 222},
    {3, 336, 353, 416, 185, 222}, {4, 358, 361, 416, 28, 227},   {5, 348, 346, 416, 81, 227},
    {6, 354, 357, 416, 133, 227}, {7, 344, 355, 416, 185, 227},  {8, 316, 314, 295, 71, 376},
    {9, 406, 404, 295, 19, 376},  {10, 312, 317, 295, 123, 376}, {11, 286, 287, 84, 151, 0},
    {12, 290, 291, 84, 202, 0},   {13, 294, 295, 84, 253, 0},    {14, 298, 299, 84, 304, 0},
    {15, 302, 303, 300, 151, 0},  {16, 306, 307, 300, 202, 0},   {17, 502, 503, 300, 253, 0},
    {18, 506, 507, 300, 304, 0},  {19, 510, 511, 300, 355, 0},   {20, 512, 513, 84, 355, 0},
    {21, 514, 515, 84, 100, 0},   {22, 516, 517, 300, 100, 0},
};

struct ExpectedPanel {
    int id;
    Rect place;
};

const ExpectedPanel kPanels[] = {
    {376, {271, 55, 240, 149}},
    {227, {403, 67, 237, 256}},
    {222, {403, 54, 237, 252}},
};

const char* const kBackgrounds[] = {
    "AutoPlayBack.bmp",   "AutoPlayBackFr.bmp", "AutoPlayBackDe.bmp", "AutoPlayBackSw.bmp",
    "AutoPlayBackDu.bmp", "AutoPlayBackPr.bmp", "AutoPlayBackSp.bmp", "AutoPlayBackIt.bmp",
    "AutoPlayBackPo.bmp", "AutoPlayBackJp.bmp", "AutoPlayBackTC.bmp", "AutoPlayBackSC.bmp",
    "AutoPlayBackTh.bmp", "AutoPlayBackKo.bmp", "AutoPlayBackUk.bmp", "AutoPlayBackNO.bmp",
    "AutoPlayBackFI.bmp", "AutoPlayBackDN.bmp",
};

// Caption end points: captions are right-aligned on them and reach some 170 pixels left.
const int kCaptionEnds[][2] = {{187, 237}, {262, 278}, {329, 332}, {370, 391}, {398, 443}};

std::vector<Rect> LayoutRects() {
    std::vector<Rect> rects = {
        {9, 346, 162, 117},  {186, 162, 85, 96}, {330, 268, 73, 79}, {272, 225, 66, 67},
        {372, 323, 73, 87},  {405, 411, 54, 54}, {295, 19, 209, 49}, {295, 71, 209, 49},
        {295, 123, 209, 49}, {416, 28, 209, 49}, {416, 81, 209, 49}, {416, 133, 209, 49},
        {416, 185, 209, 49}, {416, 29, 209, 49},
    };
    for (const ExpectedPanel& panel : kPanels) rects.push_back(panel.place);
    for (const auto& end : kCaptionEnds) rects.push_back({end[0] - 172, end[1] - 20, 172, 20});
    return rects;
}

std::vector<ExpectedBitmap> AllBitmaps() {
    std::vector<ExpectedBitmap> all = {
        {377, 640, 480, 24}, {248, 350, 350, 8},  {376, 240, 149, 24}, {227, 237, 256, 24},
        {222, 237, 252, 24}, {241, 400, 488, 24}, {264, 162, 117, 8},
    };
    for (const ExpectedPlate& plate : kPlates) {
        const int w = plate.key <= 10 ? 209 : 212;
        const int h = plate.key <= 10 ? 49 : 50;
        all.push_back({plate.normal, w, h, 24});
        all.push_back({plate.pressed, w, h, 24});
    }
    std::set<int> masks;
    for (const ExpectedIcon& icon : kIcons) {
        for (int s = 0; s < 4; ++s) {
            if (icon.pictures[s] == 0) continue;
            all.push_back({icon.pictures[s], icon.width, icon.height, 24});
            if (masks.insert(icon.masks[s]).second) {
                all.push_back({icon.masks[s], icon.width, icon.height, 8});
            }
        }
    }
    return all;
}

class DiscArt : public ::testing::Test {
  protected:
    void SetUp() override {
        const char* dir = std::getenv("DISC_ART_DIR");
        if (!dir || !*dir) {
            FAIL() << "DISC_ART_DIR is not set: point it at the output of `discart resources`";
        }
        directory = dir;
        const char* backgrounds = std::getenv("DISC_ART_BACKGROUNDS_DIR");
        backgroundDirectory = backgrounds && *backgrounds ? backgrounds : directory;
    }

    std::string Path(const std::string& name) const { return directory + "/" + name; }

    const Bitmap& Picture(int id) { return Load(Path("bitmap_" + std::to_string(id) + ".bmp")); }
    const Bitmap& Background(const std::string& name) {
        return Load(backgroundDirectory + "/" + name);
    }

    const Bitmap& Load(const std::string& path) {
        auto it = cache.find(path);
        if (it != cache.end()) return it->second;
        Bitmap bitmap;
        Bytes file;
        if (!ReadAll(path, file)) {
            ADD_FAILURE() << "cannot read " << path;
        } else {
            EXPECT_TRUE(ParseBmp(file, bitmap)) << path;
        }
        return cache.emplace(path, std::move(bitmap)).first->second;
    }

    // The English background with a panel composited over it, as the launcher paints it.
    Bitmap WithPanel(int panelId) {
        Bitmap screen = Background("AutoPlayBack.bmp");
        for (const ExpectedPanel& panel : kPanels) {
            if (panel.id == panelId) {
                Blend(Picture(panel.id), screen, panel.place.x, panel.place.y, Picture(248));
            }
        }
        return screen;
    }

    std::string directory;
    std::string backgroundDirectory;
    std::map<std::string, Bitmap> cache;
};

// ---- Files and formats ----

TEST_F(DiscArt, EveryBitmapHasItsSizeAndDepth) {
    for (const ExpectedBitmap& want : AllBitmaps()) {
        SCOPED_TRACE("bitmap " + std::to_string(want.id));
        const Bitmap& b = Picture(want.id);
        EXPECT_EQ(b.width, want.width);
        EXPECT_EQ(b.height, want.height);
        EXPECT_EQ(b.bits, want.bits);
    }
}

TEST_F(DiscArt, ResourceScriptListsEveryResourceOnceWithoutLanguage) {
    Bytes bytes;
    ASSERT_TRUE(ReadAll(Path("pictures.rc"), bytes));
    std::istringstream script(std::string(bytes.begin(), bytes.end()));
    std::map<std::string, std::string> entries;  // "id TYPE" -> file
    std::string line;
    while (std::getline(script, line)) {
        if (line.empty() || line.rfind("//", 0) == 0) continue;
        EXPECT_EQ(line.find("LANGUAGE"), std::string::npos) << line;
        std::istringstream fields(line);
        std::string id, type, file;
        fields >> id >> type >> file;
        ASSERT_GE(file.size(), 2u) << line;
        file = file.substr(1, file.size() - 2);
        EXPECT_TRUE(entries.emplace(id + " " + type, file).second) << "listed twice: " << line;
        Bytes listed;
        EXPECT_TRUE(ReadAll(Path(file), listed)) << "listed file is missing: " << file;
    }
    std::set<std::string> expected = {"247 IDR_PALETTE", "113 WAVE", "308 WAVE", "101 ICON"};
    for (const ExpectedBitmap& want : AllBitmaps())
        expected.insert(std::to_string(want.id) + " BITMAP");
    for (const std::string& key : expected) EXPECT_EQ(entries.count(key), 1u) << key;
    EXPECT_EQ(entries.size(), expected.size());
}

TEST_F(DiscArt, PaletteHasTheRiffLayoutAndFixedEntries) {
    Bytes pal;
    ASSERT_TRUE(ReadAll(Path("palette_247.pal"), pal));
    ASSERT_EQ(pal.size(), 1048u);
    EXPECT_EQ(std::string(pal.begin(), pal.begin() + 4), "RIFF");
    EXPECT_EQ(U32(pal, 4), 1040u);
    EXPECT_EQ(std::string(pal.begin() + 8, pal.begin() + 16), "PAL data");
    EXPECT_EQ(U32(pal, 16), 1028u);
    EXPECT_EQ(U16(pal, 20), 0x0300);
    EXPECT_EQ(U16(pal, 22), 256);
    auto entry = [&](int i) {
        const size_t at = 24 + static_cast<size_t>(i) * 4;
        return std::vector<int>{pal[at], pal[at + 1], pal[at + 2], pal[at + 3]};
    };
    EXPECT_EQ(entry(0), (std::vector<int>{177, 5, 35, 0}));
    EXPECT_EQ(entry(1), (std::vector<int>{241, 98, 171, 0}));
    EXPECT_EQ(entry(11), (std::vector<int>{32, 31, 232, 0}));
    EXPECT_EQ(entry(255), (std::vector<int>{252, 252, 252, 0}));
    for (int i = 0; i < 256; ++i) EXPECT_EQ(entry(i)[3], 0) << "flags of entry " << i;

    // Only entries 10 to 245 reach a 256-colour screen; they must carry the pictures' colours.
    std::set<std::vector<int>> distinct;
    for (int i = 10; i <= 245; ++i) distinct.insert(entry(i));
    EXPECT_GE(distinct.size(), 200u);
    const Bitmap& english = Background("AutoPlayBack.bmp");
    double totalError = 0.0;
    int samples = 0;
    for (int y = 0; y < english.height; y += 7) {
        for (int x = 0; x < english.width; x += 7) {
            const uint8_t* p = english.At(x, y);
            int best = 1 << 30;
            for (int i = 10; i <= 245; ++i) {
                const std::vector<int> e = entry(i);
                const int dr = e[0] - p[2], dg = e[1] - p[1], db = e[2] - p[0];
                best = std::min(best, dr * dr + dg * dg + db * db);
            }
            totalError += std::sqrt(static_cast<double>(best));
            ++samples;
        }
    }
    EXPECT_LT(totalError / samples, 12.0) << "mean distance to the nearest palette colour";
}

TEST_F(DiscArt, SoundsAreShortCleanMonoPcm) {
    struct ExpectedWave {
        const char* file;
        double minSeconds, maxSeconds;
    };
    for (const ExpectedWave& want :
         {ExpectedWave{"wave_113.wav", 0.02, 0.15}, ExpectedWave{"wave_308.wav", 4.0, 7.0}}) {
        SCOPED_TRACE(want.file);
        Bytes wav;
        ASSERT_TRUE(ReadAll(Path(want.file), wav));
        ASSERT_GE(wav.size(), 44u);
        EXPECT_EQ(std::string(wav.begin(), wav.begin() + 4), "RIFF");
        EXPECT_EQ(U32(wav, 4), wav.size() - 8);
        EXPECT_EQ(std::string(wav.begin() + 8, wav.begin() + 16), "WAVEfmt ");
        EXPECT_EQ(U32(wav, 16), 16u);
        EXPECT_EQ(U16(wav, 20), 1) << "PCM";
        EXPECT_EQ(U16(wav, 22), 1) << "mono";
        EXPECT_EQ(U32(wav, 24), 22050u);
        EXPECT_EQ(U32(wav, 28), 44100u);
        EXPECT_EQ(U16(wav, 32), 2);
        EXPECT_EQ(U16(wav, 34), 16);
        EXPECT_EQ(std::string(wav.begin() + 36, wav.begin() + 40), "data");
        const uint32_t dataSize = U32(wav, 40);
        ASSERT_EQ(44 + dataSize, wav.size());
        const size_t count = dataSize / 2;
        const double seconds = static_cast<double>(count) / 22050.0;
        EXPECT_GE(seconds, want.minSeconds);
        EXPECT_LE(seconds, want.maxSeconds);
        int peak = 0;
        for (size_t i = 0; i < count; ++i) {
            const int s = static_cast<int16_t>(U16(wav, 44 + i * 2));
            peak = std::max(peak, std::abs(s));
        }
        EXPECT_LT(peak, 32767) << "clipped";
        EXPECT_GT(peak, 8000) << "too quiet to hear";
        // Faded in and out, so neither end clicks.
        const int first = static_cast<int16_t>(U16(wav, 44));
        const int last = static_cast<int16_t>(U16(wav, 44 + (count - 1) * 2));
        EXPECT_LT(std::abs(first), 200);
        EXPECT_LT(std::abs(last), 200);
    }
}

TEST_F(DiscArt, IconHoldsThreeSizesWithRealAlpha) {
    Bytes ico;
    ASSERT_TRUE(ReadAll(Path("icon_101.ico"), ico));
    ASSERT_GE(ico.size(), 6u + 3 * 16);
    EXPECT_EQ(U16(ico, 0), 0);
    EXPECT_EQ(U16(ico, 2), 1) << "not an icon";
    ASSERT_EQ(U16(ico, 4), 3);
    std::set<int> sizes;
    for (size_t i = 0; i < 3; ++i) {
        const size_t entry = 6 + i * 16;
        const int size = ico[entry];
        SCOPED_TRACE("icon image of " + std::to_string(size));
        sizes.insert(size);
        EXPECT_EQ(ico[entry + 1], size);
        EXPECT_EQ(U16(ico, entry + 6), 32) << "bits per pixel";
        const uint32_t bytes = U32(ico, entry + 8);
        const uint32_t offset = U32(ico, entry + 12);
        ASSERT_LE(static_cast<size_t>(offset) + bytes, ico.size());
        EXPECT_EQ(U32(ico, offset), 40u);
        EXPECT_EQ(I32(ico, offset + 4), size);
        EXPECT_EQ(I32(ico, offset + 8), size * 2) << "colour and mask rows";
        EXPECT_EQ(U16(ico, offset + 14), 32);
        const size_t maskStride = static_cast<size_t>(((size + 31) / 32) * 4);
        EXPECT_EQ(bytes, 40 + static_cast<uint32_t>(size * size * 4 + maskStride * size));
        std::set<int> alphas;
        for (int p = 0; p < size * size; ++p) alphas.insert(ico[offset + 40 + p * 4 + 3]);
        EXPECT_TRUE(alphas.count(0)) << "no transparent corner";
        EXPECT_TRUE(alphas.count(255)) << "no opaque middle";
        EXPECT_GT(alphas.size(), 4u) << "edges are not anti-aliased";
    }
    EXPECT_EQ(sizes, (std::set<int>{16, 32, 48}));
}

// ---- Masks and faces ----

TEST_F(DiscArt, OpaqueMaskHoldsOnly251And252) {
    const Bitmap& mask = Picture(248);
    std::set<int> values(mask.pixels.begin(), mask.pixels.end());
    EXPECT_EQ(values, (std::set<int>{251, 252}));
}

TEST_F(DiscArt, CircularMasksAreOpaqueInsideAndClearAtTheEdges) {
    for (const ExpectedIcon& icon : kIcons) {
        for (int s = 0; s < 4; ++s) {
            if (icon.pictures[s] == 0) continue;
            SCOPED_TRACE("key " + std::to_string(icon.key) + " state " + std::to_string(s));
            const Bitmap& mask = Picture(icon.masks[s]);
            ASSERT_EQ(mask.bits, 8);
            std::set<int> values(mask.pixels.begin(), mask.pixels.end());
            EXPECT_TRUE(values.count(0));
            EXPECT_TRUE(values.count(255));
            EXPECT_GT(values.size(), 20u) << "edges are not anti-aliased";
            // A glow or shadow cut off by the picture's border would show as a straight edge.
            for (int x = 0; x < mask.width; ++x) {
                EXPECT_EQ(mask.Grey(x, 0), 0) << "top edge at " << x;
                EXPECT_EQ(mask.Grey(x, mask.height - 1), 0) << "bottom edge at " << x;
            }
            for (int y = 0; y < mask.height; ++y) {
                EXPECT_EQ(mask.Grey(0, y), 0) << "left edge at " << y;
                EXPECT_EQ(mask.Grey(mask.width - 1, y), 0) << "right edge at " << y;
            }
        }
    }
}

TEST_F(DiscArt, VisibleButtonMatchesItsHitCircle) {
    for (const ExpectedIcon& icon : kIcons) {
        SCOPED_TRACE("key " + std::to_string(icon.key));
        const Bitmap& mask = Picture(icon.masks[0]);
        int holes = 0;
        int strays = 0;
        for (int y = 0; y < mask.height; ++y) {
            for (int x = 0; x < mask.width; ++x) {
                const double d = std::hypot(x + 0.5 - icon.hitX, y + 0.5 - icon.hitY);
                if (d < icon.hitRadius * 0.7 && mask.Grey(x, y) != 255) ++holes;
                if (d > icon.hitRadius + icon.reach && mask.Grey(x, y) >= 128) ++strays;
            }
        }
        EXPECT_EQ(holes, 0) << "pixels well inside the hit circle that are not opaque";
        EXPECT_EQ(strays, 0) << "solid pixels far outside the hit circle";
    }
}

double MeanLuminance(const Bitmap& picture, const Bitmap& mask) {
    double sum = 0.0;
    int count = 0;
    for (int y = 0; y < picture.height; ++y) {
        for (int x = 0; x < picture.width; ++x) {
            if (mask.Grey(x, y) != 255) continue;
            sum += Luminance(picture.At(x, y));
            ++count;
        }
    }
    return count ? sum / count : 0.0;
}

long Coverage(const Bitmap& mask) {
    long sum = 0;
    for (uint8_t v : mask.pixels) sum += v;
    return sum;
}

TEST_F(DiscArt, ButtonStatesLookDifferent) {
    for (const ExpectedIcon& icon : kIcons) {
        SCOPED_TRACE("key " + std::to_string(icon.key));
        const Bitmap& normal = Picture(icon.pictures[0]);
        const Bitmap& normalMask = Picture(icon.masks[0]);
        const double normalLight = MeanLuminance(normal, normalMask);
        EXPECT_LT(MeanLuminance(Picture(icon.pictures[1]), Picture(icon.masks[1])),
                  normalLight * 0.85)
            << "pressed is not darker";
        EXPECT_NE(normalMask.pixels, Picture(icon.masks[1]).pixels) << "pressed does not move";
        EXPECT_GT(MeanLuminance(Picture(icon.pictures[2]), Picture(icon.masks[2])), normalLight)
            << "hover is not brighter";
        if (icon.masks[2] != icon.masks[0]) {
            EXPECT_GT(Coverage(Picture(icon.masks[2])), Coverage(normalMask))
                << "hover has no glow around it";
        }
        if (icon.pictures[3] != 0) {
            EXPECT_GT(Coverage(Picture(icon.masks[3])), Coverage(normalMask))
                << "latched has no ring around it";
            EXPECT_NE(Picture(icon.pictures[3]).pixels, normal.pixels);
        }
    }
}

TEST_F(DiscArt, AboutHoverFaceFitsTheSharedMask) {
    // Normal and hover faces of the About button go through the one mask 267: their outlines,
    // where the mask is partly transparent, must agree.
    const Bitmap& mask = Picture(267);
    const Bitmap& normal = Picture(380);
    const Bitmap& hover = Picture(378);
    double difference = 0.0;
    int count = 0;
    for (int y = 0; y < mask.height; ++y) {
        for (int x = 0; x < mask.width; ++x) {
            const int m = mask.Grey(x, y);
            if (m == 0 || m == 255) continue;
            for (int k = 0; k < 3; ++k)
                difference += std::abs(normal.At(x, y)[k] - hover.At(x, y)[k]);
            count += 3;
        }
    }
    ASSERT_GT(count, 0);
    EXPECT_LT(difference / count, 10.0);
}

TEST_F(DiscArt, AboutGreyPictureIsTheEmblemOutline) {
    const Bitmap& grey = Picture(264);
    const Bitmap& mask = Picture(267);
    int outside = 0;
    for (int y = 0; y < grey.height; ++y) {
        for (int x = 0; x < grey.width; ++x) {
            if (grey.Grey(x, y) > 0 && mask.Grey(x, y) == 0) ++outside;
        }
    }
    EXPECT_EQ(outside, 0);
    EXPECT_GT(Coverage(grey), Coverage(mask) / 2);
}

// ---- Plates and panels carry the picture around their place ----

TEST_F(DiscArt, PlatesMatchWhatLiesUnderTheirPlace) {
    std::map<int, Bitmap> grounds;
    grounds[0] = Picture(377);
    for (const ExpectedPanel& panel : kPanels) grounds[panel.id] = WithPanel(panel.id);
    for (const ExpectedPlate& plate : kPlates) {
        for (int id : {plate.normal, plate.pressed}) {
            SCOPED_TRACE("plate key " + std::to_string(plate.key) + " bitmap " +
                         std::to_string(id));
            const Bitmap& picture = Picture(id);
            const Bitmap& ground = grounds[plate.panel];
            ASSERT_GT(picture.width, 0);
            int worst = 0;
            for (int y : {0, 1, picture.height - 2, picture.height - 1}) {
                for (int x : {0, 1, picture.width - 2, picture.width - 1}) {
                    for (int k = 0; k < 3; ++k) {
                        worst = std::max(worst, std::abs(picture.At(x, y)[k] -
                                                         ground.At(plate.x + x, plate.y + y)[k]));
                    }
                }
            }
            EXPECT_LE(worst, 4) << "corner differs from the picture under the plate";
        }
    }
}

TEST_F(DiscArt, PlatesAreDarkEnoughForTheirLabels) {
    const double labelNormal = Luminance(std::vector<uint8_t>{216, 211, 204}.data());
    for (const ExpectedPlate& plate : kPlates) {
        for (int id : {plate.normal, plate.pressed}) {
            SCOPED_TRACE("bitmap " + std::to_string(id));
            const Bitmap& picture = Picture(id);
            // Where the label's letters fall: from row 12 on, around the centre.
            double sum = 0.0;
            int count = 0;
            for (int y = 13; y < 30; ++y) {
                for (int x = 40; x < picture.width - 50; ++x) {
                    sum += Luminance(picture.At(x, y));
                    ++count;
                }
            }
            EXPECT_GE(Contrast(labelNormal, sum / count), 4.5);
        }
    }
}

TEST_F(DiscArt, PanelEdgesBlendIntoTheBackground) {
    const Bitmap& english = Background("AutoPlayBack.bmp");
    for (const ExpectedPanel& panel : kPanels) {
        SCOPED_TRACE("panel " + std::to_string(panel.id));
        const Bitmap& picture = Picture(panel.id);
        int worst = 0;
        for (int y : {0, picture.height - 1}) {
            for (int x : {0, 1, picture.width - 2, picture.width - 1}) {
                for (int k = 0; k < 3; ++k) {
                    worst = std::max(worst,
                                     std::abs(picture.At(x, y)[k] -
                                              english.At(panel.place.x + x, panel.place.y + y)[k]));
                }
            }
        }
        EXPECT_LE(worst, 4);
    }
}

// ---- Backgrounds ----

TEST_F(DiscArt, BackgroundsShareEveryRectangleOfTheLayout) {
    const Bitmap& english = Background("AutoPlayBack.bmp");
    ASSERT_EQ(english.width, 640);
    ASSERT_EQ(english.height, 480);
    ASSERT_EQ(english.bits, 24);
    for (const char* name : kBackgrounds) {
        SCOPED_TRACE(name);
        const Bitmap& b = Background(name);
        ASSERT_EQ(b.width, 640);
        ASSERT_EQ(b.height, 480);
        ASSERT_EQ(b.bits, 24);
        for (const Rect& r : LayoutRects()) {
            int differing = 0;
            for (int y = r.y; y < r.y + r.h; ++y) {
                for (int x = r.x; x < r.x + r.w; ++x) {
                    if (!std::equal(b.At(x, y), b.At(x, y) + 3, english.At(x, y))) ++differing;
                }
            }
            EXPECT_EQ(differing, 0) << "rectangle at " << r.x << "," << r.y;
        }
        const bool isEnglish =
            std::string(name) == "AutoPlayBack.bmp" || std::string(name) == "AutoPlayBackUk.bmp";
        if (!isEnglish) {
            EXPECT_NE(b.pixels, english.pixels) << "no greeting of its own";
        }
    }
}

TEST_F(DiscArt, CaptionAreasAreLightAndCalm) {
    const uint8_t captionBlue[3] = {140, 0, 0};
    const double blue = Luminance(captionBlue);
    for (const char* name : kBackgrounds) {
        const Bitmap& b = Background(name);
        for (const auto& end : kCaptionEnds) {
            SCOPED_TRACE(std::string(name) + " caption ending at " + std::to_string(end[0]));
            std::vector<double> values;
            for (int y = end[1] - 16; y < end[1]; ++y) {
                for (int x = end[0] - 170; x < end[0]; ++x) values.push_back(Luminance(b.At(x, y)));
            }
            double mean = 0.0;
            for (double v : values) mean += v;
            mean /= static_cast<double>(values.size());
            double spread = 0.0;
            for (double v : values) spread += (v - mean) * (v - mean);
            spread = std::sqrt(spread / static_cast<double>(values.size()));
            EXPECT_GE(Contrast(blue, mean), 7.0) << "dark blue text would not read";
            const double darkest = *std::min_element(values.begin(), values.end());
            EXPECT_GE(Contrast(blue, darkest), 3.0) << "a dark patch under the caption";
            EXPECT_LT(spread, 0.12) << "too busy behind the caption";
        }
    }
}

TEST_F(DiscArt, LanguageListLeavesItsPlatePlacesCalm) {
    const Bitmap& list = Picture(377);
    for (const ExpectedPlate& plate : kPlates) {
        if (plate.panel != 0) continue;
        SCOPED_TRACE("place " + std::to_string(plate.x) + "," + std::to_string(plate.y));
        double minimum = 1.0;
        double maximum = 0.0;
        for (int y = plate.y; y < plate.y + 50; ++y) {
            for (int x = plate.x; x < plate.x + 212; ++x) {
                const double v = Luminance(list.At(x, y));
                minimum = std::min(minimum, v);
                maximum = std::max(maximum, v);
            }
        }
        EXPECT_LT(maximum - minimum, 0.45) << "something busy lies where a plate goes";
    }
}

}  // namespace
