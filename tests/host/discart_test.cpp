// What the disc-art generator's finished pictures cannot show: byte order, and every script.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "formats.h"
#include "scene.h"
#include "text.h"

namespace {

using namespace discart;

TEST(DiscartFormats, BitmapRowsAreStoredBottomUpInBlueGreenRedOrder) {
    Picture p(1, 2, 24);
    p.Pixel(0, 0)[0] = 10;  // top row, red
    p.Pixel(0, 1)[2] = 20;  // bottom row, blue
    const std::vector<uint8_t> file = EncodeBmp(p);
    EXPECT_EQ(file[54 + 0], 20) << "the first stored row is the bottom one, blue first";
    EXPECT_EQ(file[54 + 4 + 2], 10) << "the second stored row is the top one, red last";
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

}  // namespace
