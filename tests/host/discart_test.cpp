// The disc-art generator's own building blocks: file formats, compositing, palette, lettering,
// sounds, and the promise that a language's greeting never touches the shared layout.
#include <gtest/gtest.h>

#include <cmath>
#include <set>
#include <string>
#include <vector>

#include "buttons.h"
#include "canvas.h"
#include "formats.h"
#include "geometry.h"
#include "palette.h"
#include "scene.h"
#include "sound.h"
#include "text.h"

namespace {

using namespace discart;

Picture Pattern(int width, int height, int bits) {
    Picture p(width, height, bits);
    for (size_t i = 0; i < p.bytes.size(); ++i) p.bytes[i] = static_cast<uint8_t>(i * 37 + 11);
    return p;
}

TEST(DiscartFormats, BitmapsSurviveEncodingAtEveryRowPadding) {
    for (int bits : {24, 8}) {
        for (int width : {1, 2, 3, 4, 5, 209}) {
            SCOPED_TRACE(std::to_string(bits) + " bits, width " + std::to_string(width));
            const Picture original = Pattern(width, 3, bits);
            const std::vector<uint8_t> file = EncodeBmp(original);
            const size_t stride = static_cast<size_t>(((width * bits + 31) / 32) * 4);
            EXPECT_EQ(file.size(), 54u + (bits == 8 ? 1024u : 0u) + stride * 3);
            Picture decoded;
            ASSERT_TRUE(DecodeBmp(file, decoded));
            EXPECT_EQ(decoded.width, width);
            EXPECT_EQ(decoded.height, 3);
            EXPECT_EQ(decoded.bytes, original.bytes);
        }
    }
}

TEST(DiscartFormats, BitmapRowsAreStoredBottomUpInBlueGreenRedOrder) {
    Picture p(1, 2, 24);
    p.Pixel(0, 0)[0] = 10;  // top row, red
    p.Pixel(0, 1)[2] = 20;  // bottom row, blue
    const std::vector<uint8_t> file = EncodeBmp(p);
    EXPECT_EQ(file[54 + 0], 20) << "the first stored row is the bottom one, blue first";
    EXPECT_EQ(file[54 + 4 + 2], 10) << "the second stored row is the top one, red last";
}

TEST(DiscartFormats, IconTransparencyMaskMarksClearPixels) {
    IconImage image;
    image.size = 16;
    image.rgba.assign(16 * 16 * 4, 255);
    image.rgba[3] = 0;  // top-left pixel clear
    const std::vector<uint8_t> ico = EncodeIcon({image});
    const size_t offset = 6 + 16;
    const size_t andRows = offset + 40 + 16 * 16 * 4;
    // Rows are bottom-up, 4 bytes each: the top row is the last one.
    EXPECT_EQ(ico[andRows + 15 * 4], 0x80);
    EXPECT_EQ(ico[andRows], 0x00);
    EXPECT_EQ(ico.size(), andRows + 16 * 4);
}

TEST(DiscartCompositing, MaskedBlendFollowsTheLauncherArithmetic) {
    struct Case {
        int m, a, b, expected;
    };
    const Case cases[] = {{0, 200, 100, 100},
                          {255, 200, 100, 200},
                          {128, 200, 100, 149},
                          {252, 255, 255, 254},
                          {251, 0, 255, 3}};
    for (const Case& c : cases) {
        SCOPED_TRACE("mask " + std::to_string(c.m));
        Picture a(1, 1, 24), b(1, 1, 24), mask(1, 1, 8);
        a.bytes.assign(3, static_cast<uint8_t>(c.a));
        b.bytes.assign(3, static_cast<uint8_t>(c.b));
        mask.bytes[0] = static_cast<uint8_t>(c.m);
        MaskedBlend(a, 0, 0, b, 0, 0, mask, 0, 0, b, 0, 0, 1, 1);
        EXPECT_EQ(b.bytes, std::vector<uint8_t>(3, static_cast<uint8_t>(c.expected)));
    }
}

TEST(DiscartCompositing, CutPicturesConvertBackByteForByte) {
    const Picture original = Pattern(7, 5, 24);
    EXPECT_EQ(ToPicture(ToCanvas(original)).bytes, original.bytes);
    const Picture piece = Cut(original, 2, 1, 3, 2);
    EXPECT_EQ(piece.Pixel(0, 0)[1], original.Pixel(2, 1)[1]);
    EXPECT_EQ(piece.Pixel(2, 1)[2], original.Pixel(4, 2)[2]);
}

TEST(DiscartDrawing, AntialiasedShapesCoverTheirArea) {
    Canvas canvas(64, 64);
    FillSdf(
        canvas,
        [](float x, float y) {
            return SdCircle({x, y}, {32.0f, 32.0f}, 20.0f);
        },
        Hex(0xFFFFFF), canvas.Bounds());
    float area = 0.0f;
    for (const Rgba& p : canvas.pixels) area += p.a;
    EXPECT_NEAR(area, kPi * 400.0f, 3.0f);
    Mask mask = AlphaOf(canvas);
    Blur(mask, 3.0f);
    float blurred = 0.0f;
    for (float v : mask.values) blurred += v;
    EXPECT_NEAR(blurred, area, area * 0.01f) << "blurring must not lose or gain coverage";
    const Mask grown = Dilate(AlphaOf(canvas), 2.0f);
    float grownArea = 0.0f;
    for (float v : grown.values) grownArea += v;
    EXPECT_NEAR(grownArea, kPi * 22.0f * 22.0f, 20.0f);
}

TEST(DiscartDrawing, DistanceFieldsKnowInsideFromOutside) {
    const std::vector<Vec2> square = {{0, 0}, {10, 0}, {10, 10}, {0, 10}};
    EXPECT_NEAR(SdPolygon({5, 5}, square), -5.0f, 1e-4f);
    EXPECT_NEAR(SdPolygon({13, 5}, square), 3.0f, 1e-4f);
    EXPECT_NEAR(SdRoundBox({0, 0}, {0, 0}, {10, 5}, 2), -5.0f, 1e-4f);
    EXPECT_NEAR(SdRoundBox({12, 0}, {0, 0}, {10, 5}, 2), 2.0f, 1e-4f);
    EXPECT_NEAR(SdSegment({5, 3}, {0, 0}, {10, 0}, 1), 2.0f, 1e-4f);
    EXPECT_NEAR(SdEllipse({14, 0}, {0, 0}, {10, 5}), 4.0f, 0.3f);
}

TEST(DiscartPalette, KeepsFixedEntriesAndFindsThePicturesColours) {
    Picture twoColours(64, 64, 24);
    for (int y = 0; y < 64; ++y) {
        for (int x = 0; x < 64; ++x) {
            uint8_t* p = twoColours.Pixel(x, y);
            p[0] = x < 32 ? 20 : 240;
            p[1] = x < 32 ? 90 : 200;
            p[2] = x < 32 ? 160 : 30;
        }
    }
    const std::array<Rgb8, 256> palette = BuildPalette({&twoColours});
    auto same = [](Rgb8 e, int r, int g, int b) { return e.r == r && e.g == g && e.b == b; };
    EXPECT_TRUE(same(palette[0], 177, 5, 35));
    EXPECT_TRUE(same(palette[1], 241, 98, 171));
    EXPECT_TRUE(same(palette[11], 32, 31, 232));
    EXPECT_TRUE(same(palette[255], 252, 252, 252));
    bool first = false;
    bool second = false;
    for (int i = 10; i <= 245; ++i) {
        first = first || same(palette[i], 20, 90, 160);
        second = second || same(palette[i], 240, 200, 30);
    }
    EXPECT_TRUE(first && second) << "a colour of the picture did not reach the visible entries";
}

class DiscartFonts : public ::testing::Test {
  protected:
    void SetUp() override {
        std::string error;
        ASSERT_TRUE(fonts.Load(error)) << error;
    }
    FontLibrary fonts;
};

TEST_F(DiscartFonts, ThaiToneMarkSitsLowWithoutAnUpperVowel) {
    // "to" with the second tone mark, and the same with an upper vowel between them.
    const TextMask bare = fonts.Render(Face::Thai, "\xE0\xB8\x95\xE0\xB9\x89", 40.0f);
    const TextMask stacked =
        fonts.Render(Face::Thai, "\xE0\xB8\x95\xE0\xB8\xB4\xE0\xB9\x89", 40.0f);
    const int bareTop = bare.baseline - bare.ink.y0;
    const int stackedTop = stacked.baseline - stacked.ink.y0;
    EXPECT_LT(bareTop + 4, stackedTop) << "the tone mark kept its high, stacking form";
}

TEST_F(DiscartFonts, EveryScriptOfTheGreetingsHasItsGlyphs) {
    for (const BackgroundLanguage& language : BackgroundLanguages()) {
        SCOPED_TRACE(language.fileName);
        const TextMask text = fonts.Render(language.face, language.greeting, 30.0f);
        EXPECT_GT(InkWidth(text), 40.0f);
        EXPECT_GT(text.advance, 40.0f);
    }
}

TEST_F(DiscartFonts, FittedTextStaysWithinItsWidth) {
    const std::vector<TextSpan> spans = {{Face::ComicBold, "Tervetuloa Velkommen Bienvenido"}};
    const float size = fonts.FitSize(spans, 40.0f, 180.0f);
    EXPECT_LT(size, 40.0f);
    EXPECT_LE(fonts.Measure(spans, size), 180.0f);
    EXPECT_FLOAT_EQ(fonts.FitSize({{Face::ComicBold, "Hi"}}, 30.0f, 180.0f), 30.0f);
}

TEST_F(DiscartFonts, GreetingsNeverReachIntoTheSharedLayout) {
    Canvas base(640, 480, Hex(0x808080));
    for (const BackgroundLanguage& language : BackgroundLanguages()) {
        SCOPED_TRACE(language.fileName);
        const Canvas painted = PaintLanguageBackground(base, fonts, language);
        int changed = 0;
        for (const Box& box : LanguageNeutralBoxes()) {
            for (int y = box.y0; y < box.y1; ++y) {
                for (int x = box.x0; x < box.x1; ++x) {
                    const Rgba& a = painted.At(x, y);
                    const Rgba& b = base.At(x, y);
                    if (a.r != b.r || a.g != b.g || a.b != b.b) ++changed;
                }
            }
        }
        EXPECT_EQ(changed, 0);
        EXPECT_NE(ToPicture(painted).bytes, ToPicture(base).bytes) << "no greeting drawn";
    }
}

TEST(DiscartFaces, OrbsFadeOutBeforeThePictureEdge) {
    const OrbDesign design = {54, 54, {26.0f, 25.0f}, 22.0f, Hex(0xD0405A), PowerSymbol};
    for (FaceState state :
         {FaceState::Normal, FaceState::Pressed, FaceState::Focused, FaceState::Latched}) {
        SCOPED_TRACE(static_cast<int>(state));
        const Canvas face = PaintOrb(design, state);
        for (int i = 0; i < 54; ++i) {
            EXPECT_EQ(face.At(i, 0).a, 0.0f);
            EXPECT_EQ(face.At(0, i).a, 0.0f);
            EXPECT_EQ(face.At(i, 53).a, 0.0f);
            EXPECT_EQ(face.At(53, i).a, 0.0f);
        }
        EXPECT_FLOAT_EQ(face.At(26, 25).a, 1.0f);
    }
}

TEST(DiscartSounds, AreRepeatableAndPeakBelowFullScale) {
    const std::vector<int16_t> click = SynthesiseClick();
    EXPECT_EQ(click, SynthesiseClick());
    EXPECT_LT(click.size(), static_cast<size_t>(kSampleRate * 0.15));
    const std::vector<int16_t> music = SynthesiseStartupMusic();
    int peak = 0;
    for (int16_t s : music) peak = std::max(peak, std::abs(static_cast<int>(s)));
    EXPECT_NEAR(peak, 0.7 * 32767, 2.0) << "music is normalised to -3 dB";
    EXPECT_EQ(music.front(), 0);
    EXPECT_EQ(music.back(), 0);
}

}  // namespace
