#include "locale/language_table.h"

#include <gtest/gtest.h>

#include <vector>

namespace {

TEST(LanguageFromLangId, EveryListedIdentifierNamesItsLanguageAndOthersAreUsEnglish) {
    const struct {
        LanguageBase base;
        std::vector<std::uint16_t> langIds;
    } rows[] = {
        {kFrench, {0x040C, 0x080C, 0x0C0C, 0x100C, 0x140C}},
        {kGerman, {0x0007, 0x0407, 0x0807, 0x0C07, 0x1007, 0x1407}},
        {kSwedish, {0x001D, 0x041D, 0x081D}},
        {kDutch, {0x0013, 0x0413, 0x0813}},
        {kPortuguese, {0x0416}},
        {kItalian, {0x0010, 0x0410, 0x0810}},
        {kPolish, {0x0015, 0x0415}},
        {kJapanese, {0x0411}},
        {kTraditionalChinese, {0x0404}},
        {kSimplifiedChinese, {0x0804, 0x0C04, 0x1004}},
        {kThai, {0x041E}},
        {kKorean, {0x0412}},
        {kUkEnglish, {0x0809}},
        {kNorwegian, {0x0014, 0x0414, 0x0814}},
        {kFinnish, {0x000B, 0x040B}},
        {kDanish, {0x0006, 0x0406}},
        // Neutral ones, Portugal, Australia, US Spanish, Russian and no language at all.
        {kUsEnglish,
         {0x0009, 0x0409, 0x000C, 0x0011, 0x0816, 0x0C09, 0x0000, 0x540A, 0xFFFF, 0x0419, 0x0004}},
    };
    for (const auto& row : rows) {
        for (std::uint16_t langId : row.langIds) {
            SCOPED_TRACE(testing::Message() << std::hex << "LANGID 0x" << langId);
            EXPECT_EQ(LanguageBaseForLangId(langId), row.base);
        }
    }
}

TEST(LanguageFromLangId, SpanishCoversTheNeutralAndTwentyRegionalIdentifiers) {
    int spanish = 0;
    for (std::uint32_t id = 0; id <= 0xFFFF; ++id) {
        if (LanguageBaseForLangId(static_cast<std::uint16_t>(id)) == kSpanish) {
            ++spanish;
            SCOPED_TRACE(testing::Message() << std::hex << "LANGID 0x" << id);
            EXPECT_TRUE(id == 0x000A || (id % 0x400 == 0x00A && id >= 0x040A && id <= 0x500A));
        }
    }
    EXPECT_EQ(spanish, 21);
}

// Every name the installer writes is read back by the Windows tests (InstallLanguage); here a
// name is matched exactly or not at all, and the Nordic ones only as the other language.
TEST(RegistryLanguageNames, AreComparedExactlyAndFallBackToTheirEnglish) {
    const struct {
        const wchar_t* name;
        LanguageBase product, other;
    } rows[] = {{L"French", kFrench, kUkEnglish},       {L"Norwegian", kUsEnglish, kNorwegian},
                {L"french", kUsEnglish, kUkEnglish},    {L"French ", kUsEnglish, kUkEnglish},
                {L"norwegian", kUsEnglish, kUkEnglish}, {L"", kUsEnglish, kUkEnglish}};
    for (const auto& row : rows) {
        SCOPED_TRACE(testing::Message() << "row " << &row - rows);
        EXPECT_EQ(LanguageBaseForProductName(row.name), row.product);
        EXPECT_EQ(LanguageBaseForOtherName(row.name), row.other);
    }
}

TEST(ProductSku, FirstByteMapsOneToNineAndTenToTwo) {
    for (int n = -128; n <= 127; ++n) {
        SCOPED_TRACE(n);
        std::uint32_t expected = (n >= 1 && n <= 9) ? static_cast<std::uint32_t>(n)
                                 : n == 10          ? 2
                                                    : 0;
        EXPECT_EQ(ProductSkuFromFirstByte(static_cast<std::int8_t>(n)), expected);
    }
}

// Each language's background, locale, readme, installer argument and site are checked where
// they take effect: the disc art, the configuration tests and the end-to-end commands.
TEST(LanguageChoices, ABaseWithoutALanguageFallsBackToUsEnglish) {
    for (LanguageBase base : {kNoLanguage, LanguageBase{9000}, kActiveLanguage}) {
        SCOPED_TRACE(base);
        EXPECT_EQ(FindLanguage(base), nullptr);
        EXPECT_STREQ(LocaleCodeFor(base), L"en_US");
        EXPECT_EQ(InstallerLangIdFor(base), 0x0409);
        EXPECT_STREQ(ReadmeFileFor(base), L"support\\readme.txt");
        EXPECT_STREQ(WebSiteFor(base), WebSiteFor(kUsEnglish));
    }
}

}  // namespace
