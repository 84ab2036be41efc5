// The generated pictures (in DISC_ART_DIR) against what the launcher's own tables rely on.
// Sizes, depths and the palette are the disc check's, on the built disc.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <iterator>
#include <map>
#include <set>
#include <string>
#include <vector>

#include "graphics/bmp_file.h"
#include "graphics/dib.h"
#include "graphics/main_menu_layout.h"
#include "graphics/masked_blend.h"
#include "locale/picture_ids.h"
#include "menu/screen_layout.h"

namespace {

// A picture read as the launcher reads its resources, addressed from the top.
struct Bitmap {
    explicit Bitmap(DibBitmap* block = nullptr) : dib(block) {
        DibDimensions(dib.get(), width, height);
        DibRowInfo(dib.get(), rows, stride, bits);
    }
    const uint8_t* At(int x, int y) const {
        return rows + static_cast<size_t>(height - 1 - y) * stride + x * (bits / 8);
    }
    uint8_t Grey(int x, int y) const { return *At(x, y); }
    std::set<int> GreyLevels() const {
        std::set<int> levels;
        for (int y = 0; y < height; ++y) levels.insert(At(0, y), At(0, y) + width);
        return levels;
    }

    DibPtr dib;
    int32_t width = 0, height = 0;
    uint16_t bits = 0;
    uint8_t* rows = nullptr;
    uint32_t stride = 0;
};

::testing::AssertionResult ReadBmp(const std::string& path, Bitmap& out) {
    std::ifstream in(path, std::ios::binary);
    const std::vector<uint8_t> file{std::istreambuf_iterator<char>(in), {}};
    if (!BmpFileIsWhole(file.data(), file.size())) {
        return ::testing::AssertionFailure() << "not a whole bitmap file";
    }
    uint32_t offset = 0;
    std::memcpy(&offset, &file[10], 4);
    out = Bitmap(DibFromStoredPicture(file.data() + 14, file.size() - 14, offset - 14));
    if (!out.dib) return ::testing::AssertionFailure() << "not read straight from its bytes";
    // Masks are read by value, so their colour table must map each value to its own grey.
    const void* header = nullptr;
    const void* table = nullptr;
    const uint8_t* pixels = nullptr;
    DibParts(out.dib.get(), header, table, pixels);
    for (uint32_t i = 0; out.bits == 8 && i < 256; ++i) {
        const uint32_t grey = i * 0x010101u;
        if (std::memcmp(static_cast<const uint8_t*>(table) + i * 4, &grey, 4) != 0) {
            return ::testing::AssertionFailure() << "table entry " << i;
        }
    }
    return ::testing::AssertionSuccess();
}

struct Rect {
    int x, y, w, h;
};

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

// The generator keeps a copy of the layout; these rectangles come from the launcher's.
std::vector<Rect> LayoutRects() {
    std::vector<Rect> rects;
    for (const MainButtonLayout& item : MainPageButtons(1, 1, kUsEnglish)) {
        const ButtonPlace& p = item.button.place;
        rects.push_back({p.x, p.y, p.width, p.height});
    }
    for (std::int32_t page : {InfoPanel, GamesPanel, PlayPanel}) {
        for (std::int32_t slot = 0; auto plate = PanelSlotFor(page, slot); ++slot) {
            rects.push_back({plate->x, plate->y, kPanelPlateWidth, kPanelPlateHeight});
        }
    }
    for (std::uint32_t panel = 0; auto place = PanelPlacementFor(panel); ++panel) {
        rects.push_back({place->x, place->y, place->width, place->height});
    }
    for (const CaptionPlacement& caption : MainMenuCaptions(false, 1, 1, kUsEnglish)) {
        rects.push_back({caption.right - 172, caption.bottom - 20, 172, 20});
    }
    return rects;
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
        EXPECT_TRUE(ReadBmp(Path(name), bitmap)) << name;
        return cache.emplace(name, std::move(bitmap)).first->second;
    }

    std::string directory;
    std::map<std::string, Bitmap> cache;
};

TEST_F(DiscArt, MasksFitTheirHitCircleAndFadeBeforeTheEdgeAndTheOpaqueMaskIsNearlyOpaque) {
    std::map<int, HitCircle> circles;  // by picture; every language's Play picture
    for (const LanguageInfo& language : Languages()) {
        for (const MainButtonLayout& item : MainPageButtons(1, 1, language.base)) {
            circles[item.button.imageIndex] = item.button.circle;
        }
    }
    ASSERT_EQ(circles.size(), 11u);
    EXPECT_EQ(Picture(kOpaqueMaskId).GreyLevels(), (std::set<int>{251, 252})) << "opaque mask";
    for (int key = 0; key < kLoadedIconKeys; ++key) {
        const auto circle = circles.find(key);
        // The About emblem's banner runs out past its medallion on both sides.
        const int reach = key == kAboutIconKey ? 30 : 8;
        for (int s = 0; s < kIconStates; ++s) {
            if (kIconResources[key].picture[s] == 0) continue;
            SCOPED_TRACE("key " + std::to_string(key) + " state " + std::to_string(s));
            const Bitmap& mask = Picture(kIconResources[key].mask[s]);
            ASSERT_EQ(mask.bits, 8);
            const std::set<int> values = mask.GreyLevels();
            EXPECT_TRUE(values.count(255)) << "nothing opaque";
            EXPECT_GT(values.size(), 20u) << "edges are not anti-aliased";
            int holes = 0, strays = 0, cut = 0;
            for (int y = 0; y < mask.height; ++y) {
                for (int x = 0; x < mask.width; ++x) {
                    const int m = mask.Grey(x, y);
                    // A glow or shadow cut off by the border would show as a straight edge.
                    if ((x == 0 || y == 0 || x == mask.width - 1 || y == mask.height - 1) && m)
                        ++cut;
                    if (s != 0 || circle == circles.end()) continue;
                    const HitCircle& c = circle->second;
                    const double d = std::hypot(x + 0.5 - c.centerX, y + 0.5 - c.centerY);
                    if (d < c.radius * 0.7 && m != 255) ++holes;
                    if (d > c.radius + reach && m >= 128) ++strays;
                }
            }
            EXPECT_EQ(cut, 0) << "pixels on the border that are not clear";
            EXPECT_EQ(holes, 0) << "pixels well inside the hit circle that are not opaque";
            EXPECT_EQ(strays, 0) << "solid pixels far outside the hit circle";
        }
    }
}

TEST_F(DiscArt, AboutHoverFaceFitsTheSharedMask) {
    // Normal and hover faces of the About button go through one mask: their outlines, where
    // the mask is partly transparent, must agree.
    const IconResources& about = kIconResources[kAboutIconKey];
    ASSERT_EQ(about.mask[0], about.mask[2]);
    const Bitmap& mask = Picture(about.mask[0]);
    const Bitmap& normal = Picture(about.picture[0]);
    const Bitmap& hover = Picture(about.picture[2]);
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

TEST_F(DiscArt, PlatesAndPanelsMatchWhatLiesUnderThemAndPlatesCarryTheirLabels) {
    const Bitmap& english = Background("AutoPlayBack.bmp");
    struct Plate {
        int key, x, y;
        const Bitmap* ground;
    };
    std::vector<Plate> plates;
    std::map<std::int32_t, Bitmap> panelGrounds;  // by page: the background with its panel open
    for (std::int32_t page : {PlayPanel, InfoPanel, GamesPanel}) {
        const std::uint32_t panel = OpenPanelValueFor(page);
        const PanelPlacement place = *PanelPlacementFor(panel);
        SCOPED_TRACE("panel " + std::to_string(kPanelResources[panel].id));
        const Bitmap& picture = Picture(kPanelResources[panel].id);
        ASSERT_GT(picture.width, 0);
        EXPECT_LE(CornerDifference(picture, english, place.x, place.y), 4);
        // The panel composited over the background, as the launcher paints it.
        Bitmap& ground = panelGrounds[page] = Bitmap(CloneDib(english.dib.get()));
        MaskedBlend(picture.dib.get(), {0, 0}, ground.dib.get(), {place.x, place.y},
                    Picture(kOpaqueMaskId).dib.get(), {0, 0}, ground.dib.get(), {place.x, place.y},
                    {place.width, place.height});
        for (std::int32_t slot = 0; auto item = PanelSlotFor(page, slot); ++slot) {
            plates.push_back({item->imageIndex, item->x, item->y, &ground});
        }
    }
    // The longest language list places every list plate.
    const Bitmap& list = Picture(kLanguageListBackgroundId);
    const std::vector<LanguageButtonLayout> buttons = LanguageListFor(2).buttons;
    for (std::size_t i = 0; i < buttons.size(); ++i) {
        plates.push_back(
            {kFirstListPlate + static_cast<int>(i), buttons[i].x, buttons[i].y, &list});
    }
    ASSERT_EQ(plates.size(), static_cast<std::size_t>(kPlateKeys));
    const uint8_t label[3] = {216, 211, 204};  // the normal label colour, as B, G, R
    for (const Plate& plate : plates) {
        for (int state : {0, 1}) {
            const int id = kPlateResources[plate.key][state];
            SCOPED_TRACE("plate key " + std::to_string(plate.key) + " bitmap " +
                         std::to_string(id));
            const Bitmap& picture = Picture(id);
            ASSERT_GT(picture.width, 0);
            EXPECT_LE(CornerDifference(picture, *plate.ground, plate.x, plate.y), 4)
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

TEST_F(DiscArt, CaptionsReadAndBackgroundsShareEveryRectangleOfTheLayout) {
    const Bitmap& english = Background("AutoPlayBack.bmp");
    for (const LanguageInfo& language : Languages()) {
        const std::wstring file = language.backgroundFile;
        const std::string name(file.begin() + static_cast<long>(file.rfind(L'\\') + 1), file.end());
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
        if (language.base != kUsEnglish && language.base != kUkEnglish) {
            EXPECT_NE(std::memcmp(b.rows, english.rows, english.stride * 480u), 0)
                << "no greeting of its own";
        }
    }
    // The captions' dark blue, (0, 0, 140), as B, G, R; every background has the same pixels there.
    const uint8_t captionBlue[3] = {140, 0, 0};
    for (const CaptionPlacement& caption : MainMenuCaptions(false, 1, 1, kUsEnglish)) {
        SCOPED_TRACE("caption ending at " + std::to_string(caption.right));
        double mean = 0.0, darkest = 1.0;
        for (int y = caption.bottom - 16; y < caption.bottom; ++y) {
            for (int x = caption.right - 170; x < caption.right; ++x) {
                mean += Luminance(english.At(x, y)) / (16 * 170);
                darkest = std::min(darkest, Luminance(english.At(x, y)));
            }
        }
        EXPECT_GE(Contrast(Luminance(captionBlue), mean), 7.0) << "dark blue would not read";
        EXPECT_GE(Contrast(Luminance(captionBlue), darkest), 3.0) << "a dark patch there";
    }
}

}  // namespace
