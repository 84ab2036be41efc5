// How the launcher finds its disc root and current drive.
#include <gtest/gtest.h>

#include <string>

#include "platform/text_win.h"
#include "shell/launcher_state.h"
#include "shell/startup_win.h"
#include "test_support_win.h"

namespace {

std::wstring OwnFolderUpperCased() { return UpperCased(TestProgramFolder()); }

TEST(DiscRoot, FolderOfTheProgramAsInvokedUpperCased) {
    FindDiscRoot(L"d:\\autoplay.exe");
    EXPECT_STREQ(launcher.rootPath, L"D:\\");
    FindDiscRoot(L"e:\\Games\\Disc One\\AutoPlay.exe");
    EXPECT_STREQ(launcher.rootPath, L"E:\\GAMES\\DISC ONE\\");
}

TEST(DiscRoot, FallsBackToTheProgramsOwnFolder) {
    FindDiscRoot(L"autoplay.exe");
    EXPECT_EQ(std::wstring(launcher.rootPath), OwnFolderUpperCased());
    FindDiscRoot(nullptr);
    EXPECT_EQ(std::wstring(launcher.rootPath), OwnFolderUpperCased());
    std::wstring tooLong = L"C:\\" + std::wstring(300, L'a') + L"\\autoplay.exe";
    FindDiscRoot(tooLong.c_str());
    EXPECT_EQ(std::wstring(launcher.rootPath), OwnFolderUpperCased());
    EXPECT_LT(std::wstring(launcher.rootPath).size(), kRootPathCapacity);
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
