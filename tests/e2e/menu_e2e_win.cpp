// The menu as a user meets it on the sample disc: the buttons of each screen, the language
// choice, Install turning into Play, the fold-out panels and the hover look.
#include <gtest/gtest.h>

#include "e2e_support_win.h"
#include "launcher_driver_win.h"
#include "locale/config_win.h"
#include "sample_disc_win.h"
#include "test_support_win.h"

namespace {

class Menu : public testing::Test {
protected:
    void SetUp() override {
        DeleteMachineKey(kProductKeyPath);
        DeleteMachineKey(kLocaleKeyPath);
    }
    void TearDown() override {
        for (HWND window : TopLevelWindows(launcher.Id(), L"LauncherAppClass")) {
            PostMessageW(window, WM_CLOSE, 0, 0);
        }
        launcher.WaitForExit(kWindowWaitMs);
        DeleteMachineKey(kLocaleKeyPath);
    }

    HWND Start(const std::wstring& arguments) {
        if (!launcher.Start(disc.Launcher(), arguments, disc.Root())) return nullptr;
        HWND window = WaitForWindow(launcher.Id(), L"LauncherAppClass");
        if (window) SettledShot(window);
        return window;
    }

    SampleDisc disc;
    TestProcess launcher;
};

TEST_F(Menu, TheMouseOnACircleLightsItsButtonAndItsCornerOutsideTheCircleDoesNot) {
    HWND window = Start(L"-l0409");
    ASSERT_TRUE(window);
    HWND install = VisibleButton(window, 101);
    ASSERT_TRUE(install);
    MoveMouse(window, {600, 20});
    const Screenshot before = SettledShot(window);
    const RECT face{186, 162, 271, 258};

    MoveMouse(window, {226, 212});  // the circle's centre
    EXPECT_TRUE(WaitUntil([&] { return FocusInThreadOf(window) == install; }));
    const Screenshot lit = SettledShot(window);
    EXPECT_GT(lit.DifferingPixels(before, face), 500) << "the hover face did not show";

    MoveMouse(window, {188, 164});  // inside the window, outside the circle
    EXPECT_TRUE(WaitUntil([&] { return FocusInThreadOf(window) == window; }));
    const Screenshot off = SettledShot(window);
    EXPECT_EQ(off.DifferingPixels(before, face), 0) << "the hover face stayed";
}

}  // namespace
