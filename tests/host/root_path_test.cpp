#include "shell/root_path.h"

#include <gtest/gtest.h>

namespace {

TEST(DiscRoot, KeepsTheFolderWithItsTrailingBackslash) {
    EXPECT_EQ(FolderWithTrailingBackslash(L"D:\\AUTOPLAY.EXE", kRootPathCapacity),
              std::optional<std::wstring>(L"D:\\"));
    EXPECT_EQ(FolderWithTrailingBackslash(L"C:\\GAMES\\DISC\\AUTOPLAY.EXE", kRootPathCapacity),
              std::optional<std::wstring>(L"C:\\GAMES\\DISC\\"));
    EXPECT_EQ(FolderWithTrailingBackslash(L"\\\\SERVER\\SHARE\\A.EXE", kRootPathCapacity),
              std::optional<std::wstring>(L"\\\\SERVER\\SHARE\\"));
}

TEST(DiscRoot, NoFolderOrTooLongGivesNothing) {
    EXPECT_FALSE(FolderWithTrailingBackslash(L"AUTOPLAY.EXE", kRootPathCapacity));
    EXPECT_FALSE(FolderWithTrailingBackslash(L"", kRootPathCapacity));
    // 259 characters of folder fit with the terminator; 260 do not.
    std::wstring fits = L"C:\\" + std::wstring(255, L'A') + L"\\";
    ASSERT_EQ(fits.size(), 259u);
    EXPECT_EQ(FolderWithTrailingBackslash(fits + L"X.EXE", kRootPathCapacity),
              std::optional<std::wstring>(fits));
    std::wstring tooLong = L"C:\\" + std::wstring(256, L'A') + L"\\";
    EXPECT_FALSE(FolderWithTrailingBackslash(tooLong + L"X.EXE", kRootPathCapacity));
}

TEST(DiscRoot, FilesBesideTheRootMustFitTheirBuffer) {
    EXPECT_EQ(PathInFolder(L"D:\\", L"ORVAK.INI", kRootPathCapacity),
              std::optional<std::wstring>(L"D:\\ORVAK.INI"));
    std::wstring root = L"C:\\" + std::wstring(246, L'A') + L"\\";  // 250 characters
    EXPECT_TRUE(PathInFolder(root, L"ORVAK.INI", kRootPathCapacity));
    EXPECT_FALSE(PathInFolder(root + L"B", L"ORVAK.INI", kRootPathCapacity));
}

TEST(CurrentDrive, LetterUpperCasedOrAtSignForNetworkPaths) {
    EXPECT_EQ(DriveLetterOfDirectory(L"d:\\games"), L'D');
    EXPECT_EQ(DriveLetterOfDirectory(L"\\\\server\\share"), L'@');
    EXPECT_EQ(DriveLetterOfDirectory(L""), L'@');
    EXPECT_EQ(DriveLetterOfDirectory(L"x"), L'@');
}

}  // namespace
