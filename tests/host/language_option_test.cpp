#include "locale/language_option.h"

#include <gtest/gtest.h>

#include <cwchar>
#include <string>

namespace {

TEST(LanguageOption, SixCharactersWithLowerCaseLAreTheOption) {
    EXPECT_EQ(ParseLanguageOption(L"-l0407"), std::optional<std::uint16_t>(0x0407));
    EXPECT_EQ(ParseLanguageOption(L"-l0c04"), std::optional<std::uint16_t>(0x0C04));
    EXPECT_EQ(ParseLanguageOption(L"-l0C04"), std::optional<std::uint16_t>(0x0C04));
    EXPECT_EQ(ParseLanguageOption(L"-lFFFF"), std::optional<std::uint16_t>(0xFFFF));
}

TEST(LanguageOption, AnythingElseIsIgnored) {
    for (const wchar_t* line : {L"", L"-l407", L"-L0407", L"/l0407", L"-l04070", L"-l0407 ",
                                L" -l0407", L"-l0407 -x", L"l04070"}) {
        SCOPED_TRACE(testing::Message() << "length " << std::wcslen(line));
        EXPECT_FALSE(ParseLanguageOption(line).has_value());
    }
    EXPECT_FALSE(ParseLanguageOption(nullptr).has_value());
}

TEST(LanguageOption, DigitsAreReadAsStrtoulWithBaseSixteen) {
    struct Case {
        const wchar_t* line;
        std::uint16_t langId;
    };
    const Case cases[] = {
        {L"-lzzzz", 0x0000},  // nothing parsed
        {L"-l04zz", 0x0004},  // stops at the first other character
        {L"-l 407", 0x0407},  // leading white space
        {L"-l\t407", 0x0407},
        {L"-l+407", 0x0407},  // a sign
        {L"-l-001", 0xFFFF},  // minus negates as an unsigned number: low 16 bits of -1
        {L"-l0x41", 0x0041},  // "0x" prefix
        {L"-l0xzz", 0x0000},  // "0x" without a digit after it: just the zero
        {L"-l-0x1", 0xFFFF},
        {L"-l  -1", 0xFFFF},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(testing::Message() << std::hex << "expected 0x" << c.langId);
        EXPECT_EQ(ParseLanguageOption(c.line), std::optional<std::uint16_t>(c.langId));
    }
}

TEST(LanguageOption, MatchesTheCRuntimeOnEveryFourCharacterMix) {
    // Cross-check the parser against wcstoul over combinations of the characters that matter.
    const wchar_t alphabet[] = L" +-0xXaF9g";
    const std::size_t n = std::wcslen(alphabet);
    for (std::size_t i = 0; i < n; ++i)
        for (std::size_t j = 0; j < n; ++j)
            for (std::size_t k = 0; k < n; ++k)
                for (std::size_t l = 0; l < n; ++l) {
                    wchar_t digits[5] = {alphabet[i], alphabet[j], alphabet[k], alphabet[l], 0};
                    unsigned long expected = std::wcstoul(digits, nullptr, 16);
                    std::wstring line = std::wstring(L"-l") + digits;
                    SCOPED_TRACE(std::string(line.begin(), line.end()));
                    ASSERT_EQ(ParseLanguageOption(line.c_str()),
                              std::optional<std::uint16_t>(expected & 0xFFFF));
                }
}

}  // namespace
