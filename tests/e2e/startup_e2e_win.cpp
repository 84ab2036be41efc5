// The launcher started as a user starts it: from a folder that is not its disc, beside a
// running game, and twice.
#include <gtest/gtest.h>

#include "e2e_support_win.h"
#include "locale/config_win.h"
#include "test_support_win.h"

namespace {

const wchar_t kNotOnDiscText[] =
    L"Autoplay will only run from The Vemo installation CD.  Exiting now.";
const wchar_t kInsertDiscText[] =
    L"To continue with this operation, please insert Disc 1 into the CD-ROM drive and click OK.";

class LauncherStartup : public testing::Test {
protected:
    void SetUp() override {
        DeleteMachineKey(kProductKeyPath);
        DeleteMachineKey(kUninstallKeyPath);
    }
    void TearDown() override {
        DeleteMachineKey(kProductKeyPath);
        DeleteMachineKey(kUninstallKeyPath);
    }

    // Starts the launcher and expects the not-on-disc notice; returns it.
    std::optional<MessageBoxSeen> StartExpectingNotOnDiscNotice(TestProcess& launcher) {
        EXPECT_TRUE(launcher.Start(disc.Launcher(), L"", disc.Root()));
        std::optional<MessageBoxSeen> notice = WaitForMessageBox(launcher.Id());
        EXPECT_TRUE(notice.has_value()) << "no message box appeared";
        if (notice) {
            EXPECT_EQ(notice->caption, L"");
            EXPECT_EQ(notice->text, kNotOnDiscText);
            EXPECT_EQ(notice->buttons, std::vector<int>{IDOK});
        }
        return notice;
    }

    DiscFolder disc;
    CompanionLog log;
};

TEST_F(LauncherStartup, OffTheDiscItSaysSoThenAsksForDiscOneUntilCancelled) {
    TestProcess launcher;
    auto notice = StartExpectingNotOnDiscNotice(launcher);
    ASSERT_TRUE(notice);
    EXPECT_TRUE(TopLevelWindows(launcher.Id(), L"LauncherAppClass").empty());
    ASSERT_TRUE(PressButton(*notice, IDOK));

    auto prompt = WaitForMessageBox(launcher.Id());
    ASSERT_TRUE(prompt) << "the Install command did not ask for Disc 1";
    EXPECT_EQ(prompt->caption, L"Insert Disc 1");
    EXPECT_EQ(prompt->text, kInsertDiscText);
    EXPECT_EQ(prompt->buttons, (std::vector<int>{IDOK, IDCANCEL}));

    // OK with the disc still missing asks again; Cancel gives up and the launcher ends.
    ASSERT_TRUE(PressButton(*prompt, IDOK));
    auto again = WaitForMessageBox(launcher.Id());
    ASSERT_TRUE(again);
    EXPECT_EQ(again->caption, L"Insert Disc 1");
    ASSERT_TRUE(PressButton(*again, IDCANCEL));
    EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    EXPECT_TRUE(log.Lines().empty()) << "nothing may be installed without the disc";
}

TEST_F(LauncherStartup, OffTheDiscWithTheSetupFilesItStartsTheInstallerInUsEnglish) {
    disc.AddDiscOneFiles();
    disc.AddBuiltProgram(L"setup.exe", L"Setup\\setup.exe");
    TestProcess launcher;
    auto notice = StartExpectingNotOnDiscNotice(launcher);
    ASSERT_TRUE(notice);
    ASSERT_TRUE(PressButton(*notice, IDOK));

    auto lines = log.WaitForLines(1);
    ASSERT_EQ(lines.size(), 1u);
    ASSERT_EQ(lines[0].size(), 3u);
    EXPECT_EQ(lines[0][0], L"setup.exe");
    EXPECT_EQ(lines[0][1], L"-l0009");
    EXPECT_TRUE(SameTextIgnoringCase(lines[0][2], disc.Root() + L"Setup"))
        << "the installer ran in another folder";
    // The installer asks before it installs; the user declines.
    auto question = WaitForMessageBoxTitled(L"The Vemo Vodizuri Virezazida Setup");
    ASSERT_TRUE(question) << "the installer did not ask";
    EXPECT_NE(question->text.find(L"English"), std::wstring::npos);
    ASSERT_TRUE(PressButton(*question, IDCANCEL));
    EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    EXPECT_TRUE(TopLevelWindows(launcher.Id(), L"#32770").empty());
}

TEST_F(LauncherStartup, OffTheDiscWithTheProductInstalledItOnlySaysSo) {
    ScopedMachineKey uninstall(kUninstallKeyPath);
    disc.AddDiscOneFiles();
    disc.AddBuiltProgram(L"setup.exe", L"Setup\\setup.exe");
    TestProcess launcher;
    auto notice = StartExpectingNotOnDiscNotice(launcher);
    ASSERT_TRUE(notice);
    ASSERT_TRUE(PressButton(*notice, IDOK));
    EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    EXPECT_TRUE(log.Lines().empty());
}

TEST_F(LauncherStartup, SecondLauncherEndsAtOnceWhileTheFirstRuns) {
    TestProcess first;
    auto notice = StartExpectingNotOnDiscNotice(first);
    ASSERT_TRUE(notice);

    TestProcess second;
    ASSERT_TRUE(second.Start(disc.Launcher(), L"", disc.Root()));
    EXPECT_EQ(second.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    EXPECT_TRUE(TopLevelWindows(second.Id()).empty());
    // The first one is still there, waiting for its user.
    EXPECT_FALSE(first.WaitForExit(0).has_value());
    EXPECT_TRUE(IsWindowVisible(notice->window));
    ASSERT_TRUE(PressButton(*notice, IDOK));
    ScopedMachineKey uninstall(kUninstallKeyPath);  // nothing more to ask after the notice
    if (auto prompt = WaitForMessageBox(first.Id(), 2000)) PressButton(*prompt, IDCANCEL);
    EXPECT_TRUE(first.WaitForExit(kWindowWaitMs).has_value());
}

LRESULT CALLBACK GameWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    return DefWindowProcW(window, message, wParam, lParam);
}

TEST_F(LauncherStartup, RunningGameMakesItEndWithoutAWord) {
    WNDCLASSW gameClass{};
    gameClass.lpfnWndProc = GameWindowProc;
    gameClass.hInstance = GetModuleHandleW(nullptr);
    gameClass.lpszClassName = L"Brask";
    RegisterClassW(&gameClass);
    HWND game = CreateWindowExW(0, L"Brask", L"The Vemo", WS_OVERLAPPEDWINDOW, 0, 0, 200, 100,
                                nullptr, nullptr, GetModuleHandleW(nullptr), nullptr);
    ASSERT_TRUE(game);

    TestProcess launcher;
    ASSERT_TRUE(launcher.Start(disc.Launcher(), L"", disc.Root()));
    std::optional<DWORD> exitCode = launcher.WaitForExit(kWindowWaitMs);
    EXPECT_EQ(exitCode, std::optional<DWORD>(0));
    EXPECT_TRUE(TopLevelWindows(launcher.Id()).empty());
    DestroyWindow(game);
    UnregisterClassW(L"Brask", GetModuleHandleW(nullptr));
}

}  // namespace
