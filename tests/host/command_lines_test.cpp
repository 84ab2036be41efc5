#include "actions/command_lines.h"

#include <gtest/gtest.h>

namespace {

TEST(InstallerCommandLine, LanguageIdInFourLowerCaseHexDigits) {
    EXPECT_EQ(InstallerParameters(kGerman), L"-l0007");
    EXPECT_EQ(InstallerParameters(kFrench), L"-l040c");
    EXPECT_EQ(InstallerParameters(9000), L"-l0409");
}

TEST(DiscFiles, LieInTheSetupFolderOfTheRoot) {
    EXPECT_EQ(SetupFolder(L"D:\\"), L"D:\\Setup");
    EXPECT_EQ(FirstDiscFile(L"D:\\"), L"D:\\Setup\\Tolven8.iff");
    EXPECT_EQ(SecondDiscFile(L"E:\\DISC\\"), L"E:\\DISC\\Setup\\data2.cab");
}

TEST(CommandPaths, ToolsHelpPagesDemosAndTheCreatorBesideTheGame) {
    EXPECT_EQ(SupportTarget(L"D:\\", 1, kFrench).file, L"Trivex.exe");
    EXPECT_EQ(SupportTarget(L"D:\\", 3, kUsEnglish).folder, L"D:\\Support");
    EXPECT_EQ(SupportTarget(L"D:\\", 2, kFrench).folder, L"D:\\support\\ix help\\fr-fr");
    EXPECT_EQ(SupportTarget(L"D:\\", 2, kFrench).file, L"IX_Help_Fr.htm");
    EXPECT_EQ(SupportTarget(L"D:\\", 6, kGerman).file, L"IX_Help_Select.htm");
    EXPECT_EQ(RegistrationTarget(L"D:\\").folder, L"D:\\Support\\");
    EXPECT_EQ(DemoTarget(L"D:\\", 602).file, L"vemo2duskaro.mpg");
    EXPECT_EQ(DemoTarget(L"D:\\", 604).file, L"vemo2console.mpg");
    EXPECT_EQ(DemoTarget(L"D:\\", 601).folder, L"D:\\Demos");
    EXPECT_EQ(CreatorFolder(L"C:\\Games\\Vemo"), L"C:\\Games\\Vemo\\..\\The Vemo Creator");
    // Notepad gets the readme quoted, so a folder with spaces stays one argument.
    EXPECT_EQ(NotepadCommandLine(ReadmePath(L"E:\\MY DISC\\", kGerman)),
              L"notepad.exe \"E:\\MY DISC\\support\\Liesmich.txt\"");
}

TEST(CommandPaths, TheGamesProgramPathMustFitWindowsPathLimit) {
    EXPECT_EQ(GameProgramPath(L"C:\\Games"), std::optional<std::wstring>(L"C:\\Games\\Vemo.exe"));
    const std::wstring fits = L"C:\\" + std::wstring(247, L'a');  // 250 + "\Vemo.exe" = 259
    EXPECT_TRUE(GameProgramPath(fits));
    EXPECT_FALSE(GameProgramPath(fits + L"a"));
}

TEST(MessageFormat, TheOnePlaceholderTakesTheArgumentAndNothingElseIsAFormat) {
    struct Row {
        const wchar_t* format;
        const wchar_t* text;
    };
    const Row rows[] = {
        {L"Sorry.  The demo %s can't be found on this CD.",
         L"Sorry.  The demo vemo2.mpg can't be found on this CD."},
        {L"%s", L"vemo2.mpg"},
        {L"%s and %s", L"vemo2.mpg and %s"},  // one argument: only the first is filled
        {L"100%% %d %x %n", L"100% %d %x %n"},
        {L"ends in %", L"ends in %"},
        {L"", L""},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << row.format);
        EXPECT_EQ(FillPlaceholder(row.format, L"vemo2.mpg"), row.text);
    }
}

}  // namespace
