#include "locale/language_table.h"

#include <gtest/gtest.h>

#include <set>
#include <string>

namespace {

struct LangIdCase {
    std::uint16_t langId;
    LanguageBase base;
};

TEST(LanguageFromLangId, EveryListedIdentifierNamesItsLanguage) {
    const LangIdCase cases[] = {
        {0x040C, kFrench}, {0x080C, kFrench}, {0x0C0C, kFrench}, {0x100C, kFrench},
        {0x140C, kFrench}, {0x0007, kGerman}, {0x0407, kGerman}, {0x0807, kGerman},
        {0x0C07, kGerman}, {0x1007, kGerman}, {0x1407, kGerman}, {0x001D, kSwedish},
        {0x041D, kSwedish}, {0x081D, kSwedish}, {0x0013, kDutch}, {0x0413, kDutch},
        {0x0813, kDutch}, {0x0416, kPortuguese}, {0x0010, kItalian}, {0x0410, kItalian},
        {0x0810, kItalian}, {0x0015, kPolish}, {0x0415, kPolish}, {0x0411, kJapanese},
        {0x0404, kTraditionalChinese}, {0x0804, kSimplifiedChinese},
        {0x0C04, kSimplifiedChinese}, {0x1004, kSimplifiedChinese}, {0x041E, kThai},
        {0x0412, kKorean}, {0x0809, kUkEnglish}, {0x0014, kNorwegian}, {0x0414, kNorwegian},
        {0x0814, kNorwegian}, {0x000B, kFinnish}, {0x040B, kFinnish}, {0x0006, kDanish},
        {0x0406, kDanish},
    };
    for (const LangIdCase& c : cases) {
        SCOPED_TRACE(testing::Message() << std::hex << "LANGID 0x" << c.langId);
        EXPECT_EQ(LanguageBaseForLangId(c.langId), c.base);
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

TEST(LanguageFromLangId, UnlistedIdentifiersAreUsEnglish) {
    for (std::uint16_t id : {0x0009, 0x0409, 0x000C, 0x0011, 0x0816, 0x0C09, 0x0000, 0x540A, 0xFFFF,
                             0x0419, 0x0004}) {
        SCOPED_TRACE(testing::Message() << std::hex << "LANGID 0x" << id);
        EXPECT_EQ(LanguageBaseForLangId(id), kUsEnglish);
    }
}

TEST(ProductLanguageNames, AreComparedExactly) {
    EXPECT_EQ(LanguageBaseForProductName(L"USEnglish"), kUsEnglish);
    EXPECT_EQ(LanguageBaseForProductName(L"UKEnglish"), kUkEnglish);
    EXPECT_EQ(LanguageBaseForProductName(L"French"), kFrench);
    EXPECT_EQ(LanguageBaseForProductName(L"Portuguese"), kPortuguese);
    EXPECT_EQ(LanguageBaseForProductName(L"TraditionalChinese"), kTraditionalChinese);
    EXPECT_EQ(LanguageBaseForProductName(L"SimplifiedChinese"), kSimplifiedChinese);
    EXPECT_EQ(LanguageBaseForProductName(L"Korean"), kKorean);
    // Case, surrounding text and the Nordic names (which only the other-language value
    // carries) fall back to US English.
    for (const wchar_t* name : {L"french", L"French ", L"", L"Norwegian", L"Danish", L"Finnish"}) {
        SCOPED_TRACE(testing::Message() << "name length " << std::wstring(name).size());
        EXPECT_EQ(LanguageBaseForProductName(name), kUsEnglish);
    }
}

TEST(OtherLanguageNames, FallBackToUkEnglish) {
    EXPECT_EQ(LanguageBaseForOtherName(L"UKEnglish"), kUkEnglish);
    EXPECT_EQ(LanguageBaseForOtherName(L"Norwegian"), kNorwegian);
    EXPECT_EQ(LanguageBaseForOtherName(L"Danish"), kDanish);
    EXPECT_EQ(LanguageBaseForOtherName(L"Finnish"), kFinnish);
    EXPECT_EQ(LanguageBaseForOtherName(L"Swedish"), kUkEnglish);
    EXPECT_EQ(LanguageBaseForOtherName(L"USEnglish"), kUkEnglish);
    EXPECT_EQ(LanguageBaseForOtherName(L"norwegian"), kUkEnglish);
}

TEST(ProductSku, FirstByteMapsOneToNineAndTenToTwo) {
    for (int n = -128; n <= 127; ++n) {
        SCOPED_TRACE(n);
        std::uint32_t expected = (n >= 1 && n <= 9) ? static_cast<std::uint32_t>(n) : n == 10 ? 2 : 0;
        EXPECT_EQ(ProductSkuFromFirstByte(static_cast<std::int8_t>(n)), expected);
    }
}

TEST(LanguageChoices, LocaleCodesInstallerIdsAndReadmes) {
    struct Row {
        LanguageBase base;
        const wchar_t* locale;
        std::uint16_t installer;
        const wchar_t* readme;
    };
    const Row rows[] = {
        {kUsEnglish, L"en_US", 0x0009, L"support\\readme.txt"},
        {kFrench, L"fr_FR", 0x040c, L"support\\Lisezmoi.txt"},
        {kGerman, L"de", 0x0007, L"support\\Liesmich.txt"},
        {kSwedish, L"sv", 0x001d, L"support\\Lasmig.TXT"},
        {kDutch, L"nl", 0x0013, L"support\\Leesmij.txt"},
        {kPortuguese, L"pt_BR", 0x0416, L"support\\Leia-me.txt"},
        {kSpanish, L"es", 0x000a, L"support\\Leeme.txt"},
        {kItalian, L"it", 0x0010, L"support\\Leggimi.txt"},
        {kPolish, L"pl", 0x0015, L"support\\ReadmeP.txt"},
        {kJapanese, L"ja", 0x0011, L"support\\readmeJ.txt"},
        {kTraditionalChinese, L"zh_TW", 0x0404, L"support\\readmeTC.txt"},
        {kSimplifiedChinese, L"zh_CN", 0x0804, L"support\\readmeSC.txt"},
        {kThai, L"th", 0x001e, L"support\\readmeTh.txt"},
        {kKorean, L"ko", 0x0012, L"support\\readmeKo.txt"},
        {kUkEnglish, L"en_UK", 0x0009, L"support\\readmeUK.txt"},
        {kNorwegian, L"no", 0x0014, L"support\\readmeNO.txt"},
        {kFinnish, L"fi", 0x000b, L"support\\readmeFI.txt"},
        {kDanish, L"da", 0x0006, L"support\\readmeDN.txt"},
        // No language, or one the launcher does not carry.
        {kNoLanguage, L"en_US", 0x0409, L"support\\readme.txt"},
        {9000, L"en_US", 0x0409, L"support\\readme.txt"},
        {kActiveLanguage, L"en_US", 0x0409, L"support\\readme.txt"},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.base);
        EXPECT_STREQ(LocaleCodeFor(row.base), row.locale);
        EXPECT_EQ(InstallerLangIdFor(row.base), row.installer);
        EXPECT_STREQ(ReadmeFileFor(row.base), row.readme);
    }
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

TEST(LanguageTable, EighteenDistinctLanguagesInRisingOrder) {
    LanguageBase previous = 0;
    std::set<std::wstring> backgrounds;
    for (const LanguageInfo& language : Languages()) {
        SCOPED_TRACE(language.base);
        EXPECT_GT(language.base, previous);
        EXPECT_EQ(language.base % 1000, 0u);
        EXPECT_NE(language.base, 9000u);
        EXPECT_EQ(FindLanguage(language.base), &language);
        backgrounds.insert(language.backgroundFile);
        previous = language.base;
    }
    EXPECT_EQ(backgrounds.size(), kLanguageCount);
    EXPECT_EQ(FindLanguage(9000), nullptr);
    EXPECT_EQ(FindLanguage(kNoLanguage), nullptr);
    EXPECT_EQ(FindLanguage(kPolish)->font, FontSlot::CentralEuropean);
    EXPECT_EQ(FindLanguage(kUkEnglish)->font, FontSlot::Western);
}

}  // namespace
