// The launcher started as a user starts it: from a folder that is not its disc, and twice.
#include <gtest/gtest.h>

#include "launcher_driver_win.h"
#include "locale/config_win.h"
#include "test_support_win.h"

namespace {

const wchar_t kNotOnDiscText[] =
    L"Autoplay will only run from The Vemo installation CD.  Exiting now.";
const wchar_t kInsertDiscText[] =
    L"To continue with this operation, please insert Disc 1 into the CD-ROM drive and click OK.";

class LauncherStartup : public LauncherTest {
  protected:
    // Starts the launcher where none of its backgrounds are, which tells it that it is not on
    // its disc, and answers the notice it shows.
    void StartOffTheDiscAndAnswerTheNotice() {
        disc.Remove(L"Launcher");
        ASSERT_TRUE(launcher.Start(disc.Launcher(), L"", disc.Root()));
        AnswerMessageBox(launcher.Id(), L"", kNotOnDiscText, {IDOK}, IDOK);
    }

    // An installer the launcher started may log its start after the launcher has gone.
    bool NothingStarted() const {
        return !WaitUntil([&] { return !log.Lines().empty(); }, 3000);
    }
};

TEST_F(LauncherStartup, OffTheDiscItSaysSoThenAsksForDiscOneUntilCancelled) {
    disc.Remove(L"Setup\\data2.cab");
    ASSERT_NO_FATAL_FAILURE(StartOffTheDiscAndAnswerTheNotice());
    // OK with the disc still missing asks again; Cancel gives up and the launcher ends.
    AnswerMessageBox(launcher.Id(), L"Insert Disc 1", kInsertDiscText, {IDOK, IDCANCEL}, IDOK);
    AnswerMessageBox(launcher.Id(), L"Insert Disc 1", kInsertDiscText, {IDOK, IDCANCEL}, IDCANCEL);
    EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    EXPECT_TRUE(NothingStarted()) << "nothing may be installed without the disc";
}

TEST_F(LauncherStartup, OffTheDiscWithTheSetupFilesItStartsTheInstallerInUsEnglish) {
    ASSERT_NO_FATAL_FAILURE(StartOffTheDiscAndAnswerTheNotice());
    log.ExpectNext(L"setup.exe", L"-l0009", disc.Path(L"Setup"));
    // The installer asks before it installs; the user declines.
    auto question = WaitForMessageBoxTitled(L"The Vemo Vodizuri Virezazida Setup");
    ASSERT_TRUE(question) << "the installer did not ask";
    EXPECT_NE(question->text.find(L"English"), std::wstring::npos);
    ASSERT_TRUE(PressButton(*question, IDCANCEL));
    EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
}

TEST_F(LauncherStartup, OffTheDiscWithTheProductInstalledItOnlySaysSo) {
    ScopedMachineKey uninstall(kUninstallKeyPath);
    ASSERT_NO_FATAL_FAILURE(StartOffTheDiscAndAnswerTheNotice());
    EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    EXPECT_TRUE(NothingStarted()) << "the installer was started";
}

TEST_F(LauncherStartup, SecondLauncherEndsAtOnceWhileTheFirstRuns) {
    disc.Remove(L"Launcher");
    ASSERT_TRUE(launcher.Start(disc.Launcher(), L"", disc.Root()));
    std::optional<MessageBoxSeen> notice = WaitForMessageBox(launcher.Id());
    ASSERT_TRUE(notice);

    TestProcess second;
    ASSERT_TRUE(second.Start(disc.Launcher(), L"", disc.Root()));
    EXPECT_EQ(second.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    EXPECT_TRUE(TopLevelWindows(second.Id()).empty());
    // The first one is still there, waiting for its user.
    EXPECT_FALSE(launcher.WaitForExit(0).has_value());
    EXPECT_TRUE(IsWindowVisible(notice->window));
    ScopedMachineKey uninstall(kUninstallKeyPath);  // nothing more to ask after the notice
    ASSERT_TRUE(PressButton(*notice, IDOK));
    EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
}

TEST_F(LauncherStartup, SecondLauncherBringsTheFirstBackRestoredAndInFront) {
    ASSERT_TRUE(Start(L"-l040c"));
    ShowWindow(window, SW_MINIMIZE);
    ASSERT_TRUE(WaitUntil([&] { return IsIconic(window) != FALSE; }, 5000));

    TestProcess second;
    ASSERT_TRUE(second.Start(disc.Launcher(), L"", disc.Root()));
    EXPECT_EQ(second.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    EXPECT_TRUE(TopLevelWindows(second.Id()).empty());
    EXPECT_TRUE(
        WaitUntil([&] { return !IsIconic(window) && GetForegroundWindow() == window; }, 5000))
        << "the first launcher stayed minimised or behind";
}

}  // namespace
