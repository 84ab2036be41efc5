#include "locale/language_option.h"

#include <gtest/gtest.h>

#include <cwchar>
#include <string>

namespace {

TEST(LanguageOption, SixCharactersWithLowerCaseLAreTheOptionAndAnythingElseIsIgnored) {
    EXPECT_EQ(ParseLanguageOption(L"-lFFFF"), std::optional<std::uint16_t>(0xFFFF));
    for (const wchar_t* line : {L"", L"-l407", L"-L0407", L"/l0407", L"-l04070", L"-l0407 ",
                                L" -l0407", L"-l0407 -x", L"l04070"}) {
        SCOPED_TRACE(testing::Message() << "length " << std::wcslen(line));
        EXPECT_FALSE(ParseLanguageOption(line).has_value());
    }
    EXPECT_FALSE(ParseLanguageOption(nullptr).has_value());
}

TEST(LanguageOption, DigitsAreReadAsTheCRuntimeReadsThemOnEveryFourCharacterMix) {
    // White space, signs, a "0x" prefix with or without a digit after it, digits and letters
    // in and out of the hexadecimal range: wcstoul with base 16 says what each mix means.
    const wchar_t alphabet[] = L" \t+-0xXaF9g";
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
