#include "locale/language_table.h"

#include <gtest/gtest.h>

#include <set>
#include <string>
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
        // Neutral English, French, Japanese and Chinese, Portugal, Australia, US Spanish,
        // Russian, and identifiers of no language.
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

TEST(RegistryLanguageNames, AreComparedExactlyAndFallBackToTheirEnglish) {
    // The product's language value never names the Nordic languages; only the other one does.
    const struct {
        const wchar_t* name;
        LanguageBase product, other;
    } rows[] = {{L"USEnglish", kUsEnglish, kUkEnglish},
                {L"UKEnglish", kUkEnglish, kUkEnglish},
                {L"French", kFrench, kUkEnglish},
                {L"Portuguese", kPortuguese, kUkEnglish},
                {L"TraditionalChinese", kTraditionalChinese, kUkEnglish},
                {L"SimplifiedChinese", kSimplifiedChinese, kUkEnglish},
                {L"Korean", kKorean, kUkEnglish},
                {L"Norwegian", kUsEnglish, kNorwegian},
                {L"Danish", kUsEnglish, kDanish},
                {L"Finnish", kUsEnglish, kFinnish},
                {L"french", kUsEnglish, kUkEnglish},
                {L"French ", kUsEnglish, kUkEnglish},
                {L"norwegian", kUsEnglish, kUkEnglish},
                {L"", kUsEnglish, kUkEnglish}};
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

TEST(LanguageChoices, BackgroundsLocaleCodesInstallerIdsAndReadmes) {
    struct Row {
        LanguageBase base;
        const wchar_t* background;  // in Launcher\; null: none
        const wchar_t* locale;
        std::uint16_t installer;
        const wchar_t* readme;
    };
    const Row rows[] = {
        {kUsEnglish, L"AutoPlayBack.bmp", L"en_US", 0x0009, L"support\\readme.txt"},
        {kFrench, L"AutoPlayBackFr.bmp", L"fr_FR", 0x040c, L"support\\Lisezmoi.txt"},
        {kGerman, L"AutoPlayBackDe.bmp", L"de", 0x0007, L"support\\Liesmich.txt"},
        {kSwedish, L"AutoPlayBackSw.bmp", L"sv", 0x001d, L"support\\Lasmig.TXT"},
        {kDutch, L"AutoPlayBackDu.bmp", L"nl", 0x0013, L"support\\Leesmij.txt"},
        {kPortuguese, L"AutoPlayBackPr.bmp", L"pt_BR", 0x0416, L"support\\Leia-me.txt"},
        {kSpanish, L"AutoPlayBackSp.bmp", L"es", 0x000a, L"support\\Leeme.txt"},
        {kItalian, L"AutoPlayBackIt.bmp", L"it", 0x0010, L"support\\Leggimi.txt"},
        {kPolish, L"AutoPlayBackPo.bmp", L"pl", 0x0015, L"support\\ReadmeP.txt"},
        {kJapanese, L"AutoPlayBackJp.bmp", L"ja", 0x0011, L"support\\readmeJ.txt"},
        {kTraditionalChinese, L"AutoPlayBackTC.bmp", L"zh_TW", 0x0404, L"support\\readmeTC.txt"},
        {kSimplifiedChinese, L"AutoPlayBackSC.bmp", L"zh_CN", 0x0804, L"support\\readmeSC.txt"},
        {kThai, L"AutoPlayBackTh.bmp", L"th", 0x001e, L"support\\readmeTh.txt"},
        {kKorean, L"AutoPlayBackKo.bmp", L"ko", 0x0012, L"support\\readmeKo.txt"},
        {kUkEnglish, L"AutoPlayBackUk.bmp", L"en_UK", 0x0009, L"support\\readmeUK.txt"},
        {kNorwegian, L"AutoPlayBackNO.bmp", L"no", 0x0014, L"support\\readmeNO.txt"},
        {kFinnish, L"AutoPlayBackFI.bmp", L"fi", 0x000b, L"support\\readmeFI.txt"},
        {kDanish, L"AutoPlayBackDN.bmp", L"da", 0x0006, L"support\\readmeDN.txt"},
        // No language, or one the launcher does not carry.
        {kNoLanguage, nullptr, L"en_US", 0x0409, L"support\\readme.txt"},
        {9000, nullptr, L"en_US", 0x0409, L"support\\readme.txt"},
        {kActiveLanguage, nullptr, L"en_US", 0x0409, L"support\\readme.txt"},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.base);
        const LanguageInfo* language = FindLanguage(row.base);
        ASSERT_EQ(language != nullptr, row.background != nullptr);
        if (language) {
            EXPECT_EQ(language->backgroundFile, L"Launcher\\" + std::wstring(row.background));
        }
        EXPECT_STREQ(LocaleCodeFor(row.base), row.locale);
        EXPECT_EQ(InstallerLangIdFor(row.base), row.installer);
        EXPECT_STREQ(ReadmeFileFor(row.base), row.readme);
    }
    // Polish needs the Central European character set; UK English does not.
    EXPECT_EQ(FindLanguage(kPolish)->font, FontSlot::CentralEuropean);
    EXPECT_EQ(FindLanguage(kUkEnglish)->font, FontSlot::Western);
}

TEST(LanguageChoices, FourteenRegionalSitesAllUnderTheExampleDomain) {
    std::set<std::wstring> sites;
    for (const LanguageInfo& language : Languages()) sites.insert(WebSiteFor(language.base));
    EXPECT_EQ(sites.size(), 14u);
    for (const std::wstring& site : sites) {
        SCOPED_TRACE(std::string(site.begin(), site.end()));
        EXPECT_NE(site.find(L".example"), std::wstring::npos);
    }
    // The languages without a market of their own share the international site.
    for (LanguageBase base : {kUsEnglish, kPolish, kSimplifiedChinese, kThai, kFinnish, 9000u}) {
        SCOPED_TRACE(base);
        EXPECT_STREQ(WebSiteFor(base), WebSiteFor(kUsEnglish));
    }
    EXPECT_STRNE(WebSiteFor(kUkEnglish), WebSiteFor(kUsEnglish));
    EXPECT_EQ(std::wstring(WebSiteFor(kKorean)).rfind(L"http://", 0), 0u);
}

}  // namespace
