#include "actions/command_lines.h"

#include <gtest/gtest.h>

namespace {

// Which program each command starts, from which folder and with which arguments, is checked on
// the real launcher; here the limits and the quoting a test disc does not reach.
TEST(CommandPaths, NotepadGetsTheReadmeQuotedSoAFolderWithSpacesStaysOneArgument) {
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
