// Checks the generated pictures and palette (in DISC_ART_DIR) against what the launcher
// relies on: the ids, sizes and depths it loads, masks that fit its hit circles, plates and
// panels cut from what lies under them, backgrounds that differ only outside its layout, and
// colours its captions and labels can be read on.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <map>
#include <set>
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
    auto fail = [] { return ::testing::AssertionFailure(); };
    if (file.size() < 54 || file[0] != 'B' || file[1] != 'M') return fail() << "no BM header";
    if (U32(file, 14) != 40) return fail() << "header is not 40 bytes";
    out.width = static_cast<int32_t>(U32(file, 18));
    out.height = static_cast<int32_t>(U32(file, 22));
    out.bits = U16(file, 28);
    if (out.width <= 0 || out.height <= 0) return fail() << "not a bottom-up picture";
    if (U16(file, 26) != 1 || U32(file, 30) != 0) return fail() << "planes or compression";
    if (out.bits != 24 && out.bits != 8) return fail() << out.bits << " bits per pixel";
    const size_t stride = static_cast<size_t>(((out.width * out.bits + 31) / 32) * 4);
    const size_t offset = U32(file, 10);
    if (offset != 54 + (out.bits == 8 ? 1024u : 0u)) return fail() << "pixel offset " << offset;
    if (file.size() != offset + stride * out.height) return fail() << "size does not fit rows";
    // Masks are read by value, so their colour table must map each value to its own grey.
    for (size_t i = 0; out.bits == 8 && i < 256; ++i) {
        if (U32(file, 54 + i * 4) != i * 0x010101u) return fail() << "table entry " << i;
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

// The launcher's MaskedBlend, written out again for a mask of neither 0 nor 255 (as the opaque
// mask is): D = (A * m + B * (255 - m)) >> 8.
void Blend(const Bitmap& a, Bitmap& bd, int x, int y, const Bitmap& mask) {
    for (int r = 0; r < a.height; ++r) {
        for (int c = 0; c < a.width; ++c) {
            uint8_t* d = &bd.pixels[(static_cast<size_t>(y + r) * bd.width + x + c) * 3];
            for (int k = 0; k < 3; ++k) {
                d[k] = static_cast<uint8_t>(
                    (a.At(c, r)[k] * mask.Grey(c, r) + d[k] * (255 - mask.Grey(c, r))) >> 8);
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

// The largest channel difference between the picture's corners and the ground at (x, y).
int CornerDifference(const Bitmap& picture, const Bitmap& ground, int x, int y) {
    int worst = 0;
    for (int r : {0, 1, picture.height - 2, picture.height - 1}) {
        for (int c : {0, 1, picture.width - 2, picture.width - 1}) {
            for (int k = 0; k < 3; ++k) {
                worst = std::max(worst, std::abs(picture.At(c, r)[k] - ground.At(x + c, y + r)[k]));
            }
        }
    }
    return worst;
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

// Background file names: AutoPlayBack, this, .bmp.
const char* const kBackgrounds[] = {"",   "Fr", "De", "Sw", "Du", "Pr", "Sp", "It", "Po",
                                    "Jp", "TC", "SC", "Th", "Ko", "Uk", "NO", "FI", "DN"};

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
        ASSERT_TRUE(dir && *dir) << "DISC_ART_DIR: the output of `discart resources`";
        directory = dir;
    }

    std::string Path(const std::string& name) const { return directory + "/" + name; }
    const Bitmap& Picture(int id) { return Background("bitmap_" + std::to_string(id) + ".bmp"); }

    const Bitmap& Background(const std::string& name) {
        auto it = cache.find(name);
        if (it != cache.end()) return it->second;
        Bitmap bitmap;
        Bytes file;
        EXPECT_TRUE(ReadAll(Path(name), file)) << "cannot read " << name;
        EXPECT_TRUE(ParseBmp(file, bitmap)) << name;
        return cache.emplace(name, std::move(bitmap)).first->second;
    }

    std::string directory;
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

TEST_F(DiscArt, PaletteHasItsLayoutAndFixedEntries) {
    // The loader reads the version, the count and 256 entries from offset 24.
    Bytes pal;
    ASSERT_TRUE(ReadAll(Path("palette_247.pal"), pal));
    ASSERT_EQ(pal.size(), 1048u);
    EXPECT_EQ(U16(pal, 20), 0x0300);
    EXPECT_EQ(U16(pal, 22), 256);
    auto entry = [&](int i) { return U32(pal, 24 + static_cast<size_t>(i) * 4); };
    EXPECT_EQ(entry(0), 177u | 5u << 8 | 35u << 16);
    EXPECT_EQ(entry(1), 241u | 98u << 8 | 171u << 16);
    EXPECT_EQ(entry(11), 32u | 31u << 8 | 232u << 16);
    EXPECT_EQ(entry(255), 252u | 252u << 8 | 252u << 16);
    for (int i = 0; i < 256; ++i) EXPECT_EQ(entry(i) >> 24, 0u) << "flags of entry " << i;
}

// ---- Masks and faces ----

TEST_F(DiscArt, OpaqueMaskHoldsOnly251And252) {
    const Bitmap& mask = Picture(248);
    EXPECT_EQ(std::set<int>(mask.pixels.begin(), mask.pixels.end()), (std::set<int>{251, 252}));
}

TEST_F(DiscArt, ButtonMasksFitTheirHitCircleAndFadeBeforeTheEdge) {
    for (const ExpectedIcon& icon : kIcons) {
        for (int s = 0; s < 4; ++s) {
            if (icon.pictures[s] == 0) continue;
            SCOPED_TRACE("key " + std::to_string(icon.key) + " state " + std::to_string(s));
            const Bitmap& mask = Picture(icon.masks[s]);
            ASSERT_EQ(mask.bits, 8);
            const std::set<int> values(mask.pixels.begin(), mask.pixels.end());
            EXPECT_TRUE(values.count(255)) << "nothing opaque";
            EXPECT_GT(values.size(), 20u) << "edges are not anti-aliased";
            int holes = 0, strays = 0, cut = 0;
            for (int y = 0; y < mask.height; ++y) {
                for (int x = 0; x < mask.width; ++x) {
                    const int m = mask.Grey(x, y);
                    // A glow or shadow cut off by the border would show as a straight edge.
                    if ((x == 0 || y == 0 || x == mask.width - 1 || y == mask.height - 1) && m)
                        ++cut;
                    if (s != 0) continue;
                    const double d = std::hypot(x + 0.5 - icon.hitX, y + 0.5 - icon.hitY);
                    if (d < icon.hitRadius * 0.7 && m != 255) ++holes;
                    if (d > icon.hitRadius + icon.reach && m >= 128) ++strays;
                }
            }
            EXPECT_EQ(cut, 0) << "pixels on the border that are not clear";
            EXPECT_EQ(holes, 0) << "pixels well inside the hit circle that are not opaque";
            EXPECT_EQ(strays, 0) << "solid pixels far outside the hit circle";
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
            if (mask.Grey(x, y) == 0 || mask.Grey(x, y) == 255) continue;
            for (int k = 0; k < 3; ++k)
                difference += std::abs(normal.At(x, y)[k] - hover.At(x, y)[k]);
            count += 3;
        }
    }
    ASSERT_GT(count, 0);
    EXPECT_LT(difference / count, 10.0);
}

// ---- Plates and panels carry the picture around their place ----

TEST_F(DiscArt, PlatesAndPanelsMatchWhatLiesUnderThemAndPlatesCarryTheirLabels) {
    const Bitmap& english = Background("AutoPlayBack.bmp");
    std::map<int, Bitmap> grounds = {{0, Picture(377)}};
    for (const ExpectedPanel& panel : kPanels) {
        SCOPED_TRACE("panel " + std::to_string(panel.id));
        const Bitmap& picture = Picture(panel.id);
        ASSERT_GT(picture.width, 0);
        EXPECT_LE(CornerDifference(picture, english, panel.place.x, panel.place.y), 4);
        // The panel composited over the background, as the launcher paints it.
        grounds[panel.id] = english;
        Blend(picture, grounds[panel.id], panel.place.x, panel.place.y, Picture(248));
    }
    // The normal label colour, (204, 211, 216), as B, G, R.
    const uint8_t label[3] = {216, 211, 204};
    for (const ExpectedPlate& plate : kPlates) {
        for (int id : {plate.normal, plate.pressed}) {
            SCOPED_TRACE("plate key " + std::to_string(plate.key) + " bitmap " +
                         std::to_string(id));
            const Bitmap& picture = Picture(id);
            ASSERT_GT(picture.width, 0);
            EXPECT_LE(CornerDifference(picture, grounds[plate.panel], plate.x, plate.y), 4)
                << "corner differs from the picture under the plate";
            // Where the label's letters fall: from row 12 on, around the centre.
            double sum = 0.0;
            int count = 0;
            for (int y = 13; y < 30; ++y) {
                for (int x = 40; x < picture.width - 50; ++x, ++count) {
                    sum += Luminance(picture.At(x, y));
                }
            }
            EXPECT_GE(Contrast(Luminance(label), sum / count), 4.5);
        }
    }
}

// ---- Backgrounds ----

TEST_F(DiscArt, CaptionsReadAndBackgroundsShareEveryRectangleOfTheLayout) {
    const Bitmap& english = Background("AutoPlayBack.bmp");
    for (const std::string suffix : kBackgrounds) {
        const std::string name = "AutoPlayBack" + suffix + ".bmp";
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
        if (suffix != "" && suffix != "Uk") {
            EXPECT_NE(b.pixels, english.pixels) << "no greeting of its own";
        }
    }
    // The captions' dark blue, (0, 0, 140), as B, G, R; every background has the same pixels there.
    const uint8_t captionBlue[3] = {140, 0, 0};
    for (const auto& end : kCaptionEnds) {
        SCOPED_TRACE("caption ending at " + std::to_string(end[0]));
        double mean = 0.0, darkest = 1.0;
        for (int y = end[1] - 16; y < end[1]; ++y) {
            for (int x = end[0] - 170; x < end[0]; ++x) {
                mean += Luminance(english.At(x, y)) / (16 * 170);
                darkest = std::min(darkest, Luminance(english.At(x, y)));
            }
        }
        EXPECT_GE(Contrast(Luminance(captionBlue), mean), 7.0) << "dark blue would not read";
        EXPECT_GE(Contrast(Luminance(captionBlue), darkest), 3.0) << "a dark patch there";
    }
}

}  // namespace
