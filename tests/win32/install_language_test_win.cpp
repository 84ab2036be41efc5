// setup.exe's side of the language hand-over, and the launcher reading the names back.
#include <gtest/gtest.h>

#include <string>

#include "install_language.h"
#include "locale/language_table.h"
#include "setup_options.h"

namespace {

std::wstring Text(const wchar_t* text) {
    return text ? text : L"(none)";
}

TEST(InstallLanguage, EveryLanguageTheLauncherInstallsInComesBackToTheLauncher) {
    for (const LanguageInfo& language : Languages()) {
        SCOPED_TRACE(testing::Message() << "language base " << language.base);
        InstallLanguage installed = InstallLanguageFor(language.installerLangId);
        // The launcher's own reading: VEMO_OTHERLANGUAGE when written, else VEMO_LANGUAGE.
        LanguageBase readBack = installed.otherName
                                    ? LanguageBaseForOtherName(installed.otherName)
                                    : LanguageBaseForProductName(installed.productName);
        // UK English hands over the neutral English id, which is US English's too.
        EXPECT_EQ(readBack, language.base == kUkEnglish ? kUsEnglish : language.base);
        EXPECT_NE(std::wstring(installed.displayName), L"");
    }
}

TEST(InstallLanguage, RegionalIdentifiersFollowTheirLanguage) {
    struct Row {
        std::uint16_t langId;
        const wchar_t* productName;
        const wchar_t* otherName;
    };
    const Row rows[] = {{0x0C09, L"USEnglish", nullptr},
                        {0x0809, L"UKEnglish", nullptr},
                        {0x080C, L"French", nullptr},
                        {0x0816, L"Portuguese", nullptr},
                        {0x0C04, L"TraditionalChinese", nullptr},
                        {0x1004, L"SimplifiedChinese", nullptr},
                        {0x0814, L"UKEnglish", L"Norwegian"},
                        {0x0419, L"USEnglish", nullptr}};
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << "LANGID 0x" << std::hex << row.langId);
        InstallLanguage installed = InstallLanguageFor(row.langId);
        EXPECT_EQ(Text(installed.productName), Text(row.productName));
        EXPECT_EQ(Text(installed.otherName), Text(row.otherName));
    }
}

TEST(SetupOptions, ReadsTheLaunchersArgumentAndTheSwitchesInAnyOrder) {
    struct Row {
        const wchar_t* commandLine;
        bool understood;
        std::optional<std::uint16_t> langId;
        bool silent;
        bool uninstall;
    };
    const Row rows[] = {
        {L"", true, std::nullopt, false, false},
        {L"/S -L9", true, 0x0009, true, false},
        {L"  -u\t-s  ", true, std::nullopt, true, true},
        // A mistake is noticed, and the switches around it still count.
        {L"-l0407 -x", false, 0x0407, false, false},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << "command line \"" << row.commandLine << "\"");
        SetupOptions options = ParseSetupOptions(row.commandLine);
        EXPECT_EQ(options.understood, row.understood);
        EXPECT_EQ(options.langId, row.langId);
        EXPECT_EQ(options.silent, row.silent);
        EXPECT_EQ(options.uninstall, row.uninstall);
    }
    // What it cannot read it refuses rather than guess.
    for (const wchar_t* line : {L"-l", L"-l12345", L"-l0407junk", L"-s1", L"install", L"-", L"/"}) {
        SCOPED_TRACE(testing::Message() << "command line \"" << line << "\"");
        EXPECT_FALSE(ParseSetupOptions(line).understood);
    }
}

}  // namespace
