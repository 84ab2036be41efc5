// The eighteen string sets as compiled into the program's resources.
#include <gtest/gtest.h>

#include <algorithm>
#include <string>

#include "locale/language_table.h"
#include "locale/strings_win.h"
#include "shell/launcher_state.h"
#include "test_support_win.h"

namespace {

constexpr std::uint32_t kCaptionOffsets[] = {15, 18, 20, 22, 23, 28, 30, 84, 99};
constexpr std::uint32_t kTwoSentenceOffsets[] = {21, 24, 25, 27, 98};

std::wstring Load(LanguageBase base, std::uint32_t offset, std::size_t capacity = 1024) {
    std::wstring text(capacity, L'\0');
    int length = LoadLocalString(base, offset, text.data(), capacity);
    text.resize(static_cast<std::size_t>(length));
    return text;
}

using StringSets = DiscTest;

// A full-width stop carries its own space: ASCII spaces after it show as a gap.
bool UsesFullWidthStops(LanguageBase base) {
    return base == kJapanese || base == kTraditionalChinese || base == kSimplifiedChinese;
}

TEST_F(StringSets, EveryLanguageHasEveryOffsetFitsItsBufferAndKeepsItsPlaceholder) {
    for (const LanguageInfo& language : Languages()) {
        for (std::uint32_t offset : kAllStringOffsets) {
            SCOPED_TRACE(testing::Message() << "string " << language.base + offset);
            std::wstring text = Load(language.base, offset);
            EXPECT_FALSE(text.empty());
            EXPECT_LT(text.size(), kMessageCapacity);
            const bool twoSentences =
                std::find(std::begin(kTwoSentenceOffsets), std::end(kTwoSentenceOffsets), offset) !=
                std::end(kTwoSentenceOffsets);
            const bool fullWidth = UsesFullWidthStops(language.base);
            EXPECT_EQ(text.find(L"  ") != std::wstring::npos, twoSentences && !fullWidth);
            if (fullWidth) {
                EXPECT_EQ(text.find(L"\u3002 "), std::wstring::npos);
            }
            // The two formats take the demo's file name; a stray % would be read as another.
            const bool isFormat = offset == 24 || offset == 25;
            EXPECT_EQ(std::count(text.begin(), text.end(), L'%'), isFormat ? 1 : 0);
            EXPECT_EQ(text.find(L"%s") != std::wstring::npos, isFormat);
        }
        for (std::uint32_t offset : kCaptionOffsets) {
            SCOPED_TRACE(testing::Message() << "caption " << language.base + offset);
            EXPECT_LT(Load(language.base, offset).size(), kCaptionCapacity);
        }
    }
}

TEST_F(StringSets, UkEnglishDiffersFromUsEnglishOnlyInTheHelpLabelAndSite) {
    for (std::uint32_t offset : kAllStringOffsets) {
        SCOPED_TRACE(offset);
        if (offset == kStrSupportTool || offset == kStrVisitWebSite) continue;
        EXPECT_EQ(Load(kUkEnglish, offset), Load(kUsEnglish, offset));
    }
    EXPECT_EQ(Load(kUkEnglish, kStrSupportTool), L"Ix Help");
}

TEST_F(StringSets, WebSiteLabelNamesTheLanguagesOwnSite) {
    for (const LanguageInfo& language : Languages()) {
        SCOPED_TRACE(language.base);
        std::wstring site = WebSiteFor(language.base);
        // Korea's site is a full address; its label names the host.
        std::size_t hostStart = site.find(L"//");
        hostStart = hostStart == std::wstring::npos ? 0 : hostStart + 2;
        std::wstring host = site.substr(hostStart, site.find(L'/', hostStart) - hostStart);
        EXPECT_NE(Load(language.base, kStrVisitWebSite).find(host), std::wstring::npos);
    }
}

TEST_F(StringSets, TextsAreCutToTheirBufferAndTerminatedAndNoneForAnUnknownLanguage) {
    wchar_t caption[8];
    std::fill(std::begin(caption), std::end(caption), L'#');
    EXPECT_EQ(LoadLocalString(kUsEnglish, kStrInsertDiscText, caption, 8), 7);
    EXPECT_EQ(std::wstring(caption), L"To cont");
    for (LanguageBase base : {kNoLanguage, LanguageBase{9000}, LanguageBase{20000}}) {
        SCOPED_TRACE(base);
        EXPECT_EQ(Load(base, kStrInstall), L"");
        EXPECT_EQ(Load(base, kStrNotOnDiscText), L"");
    }
}

}  // namespace
