#include "actions/command_lines.h"

#include <gtest/gtest.h>

namespace {

TEST(InstallerCommandLine, LanguageIdInFourLowerCaseHexDigits) {
    EXPECT_EQ(InstallerParameters(kUsEnglish), L"-l0009");
    EXPECT_EQ(InstallerParameters(kGerman), L"-l0007");
    EXPECT_EQ(InstallerParameters(kFrench), L"-l040c");
    EXPECT_EQ(InstallerParameters(kSimplifiedChinese), L"-l0804");
    EXPECT_EQ(InstallerParameters(kUkEnglish), L"-l0009");
    EXPECT_EQ(InstallerParameters(kNoLanguage), L"-l0409");
    EXPECT_EQ(InstallerParameters(9000), L"-l0409");
}

TEST(DiscFiles, LieInTheSetupFolderOfTheRoot) {
    EXPECT_EQ(SetupFolder(L"D:\\"), L"D:\\Setup");
    EXPECT_EQ(FirstDiscFile(L"D:\\"), L"D:\\Setup\\Tolven8.iff");
    EXPECT_EQ(SecondDiscFile(L"E:\\DISC\\"), L"E:\\DISC\\Setup\\data2.cab");
}

}  // namespace
