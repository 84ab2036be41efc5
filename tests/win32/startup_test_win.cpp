// How the launcher finds its disc root and current drive.
#include <gtest/gtest.h>

#include <string>

#include "platform/text_win.h"
#include "shell/launcher_state.h"
#include "shell/startup_win.h"
#include "test_support_win.h"

namespace {

// Where the folder is cut is tested on the host; here the upper-casing and the fallback to the
// program's own folder, which need Windows.
TEST(DiscRoot, FolderOfTheProgramAsInvokedUpperCasedOrItsOwnFolder) {
    const std::wstring own = UpperCased(TestProgramFolder());
    const std::wstring tooLong = L"C:\\" + std::wstring(300, L'a') + L"\\autoplay.exe";
    struct Row {
        const char* what;
        const wchar_t* invokedAs;
        std::wstring root;
    };
    const Row rows[] = {
        {"a path", L"e:\\Games\\Disc One\\AutoPlay.exe", L"E:\\GAMES\\DISC ONE\\"},
        {"a bare name", L"autoplay.exe", own},
        {"no argument 0", nullptr, own},
        {"a folder too long", tooLong.c_str(), own},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.what);
        launcher.rootPath[0] = L'\0';
        FindDiscRoot(row.invokedAs);
        EXPECT_EQ(std::wstring(launcher.rootPath), row.root);
    }
}

TEST(CurrentDrive, IsTheLetterOfTheCurrentDirectory) {
    wchar_t saved[MAX_PATH];
    GetCurrentDirectoryW(MAX_PATH, saved);
    ASSERT_TRUE(SetCurrentDirectoryW(L"c:\\windows"));
    FindCurrentDrive();
    EXPECT_STREQ(launcher.driveString, L"C:");
    SetCurrentDirectoryW(saved);
}

}  // namespace
