// The launcher's window as the user sees it: its size and place, the picture it shows, and
// how it answers a second launcher.
#include <gtest/gtest.h>

#include "e2e_support_win.h"
#include "locale/config_win.h"
#include "test_support_win.h"

namespace {

class LauncherWindow : public testing::Test {
protected:
    void SetUp() override {
        DeleteMachineKey(kProductKeyPath);
        DeleteMachineKey(kUninstallKeyPath);
        DeleteMachineKey(kLocaleKeyPath);
        for (const LanguageInfo& language : Languages()) {
            disc.AddFile(language.backgroundFile, SolidBmpFile(640, 480, TestColorOf(language.base)));
        }
    }
    void TearDown() override {
        for (HWND window : TopLevelWindows(launcher.Id(), L"LauncherAppClass")) {
            PostMessageW(window, WM_CLOSE, 0, 0);
        }
        launcher.WaitForExit(kWindowWaitMs);
        DeleteMachineKey(kProductKeyPath);
        DeleteMachineKey(kLocaleKeyPath);
    }

    HWND Start(const std::wstring& arguments = L"") {
        if (!launcher.Start(disc.Launcher(), arguments, disc.Root())) return nullptr;
        HWND window = WaitForWindow(launcher.Id(), L"LauncherAppClass");
        EXPECT_TRUE(window) << "the launcher showed no window";
        if (window) WaitForPaint(window);
        return window;
    }

    // The background colour at a point of the client area that no caption covers.
    Rgb BackgroundColorOf(HWND window) {
        POINT corner{600, 20};
        ClientToScreen(window, &corner);
        return ScreenPixel(corner.x, corner.y);
    }

    void WaitForPaint(HWND window) {
        // The first paint follows the window's showing; give it a bounded moment.
        DWORD start = GetTickCount();
        Rgb first = BackgroundColorOf(window);
        while (GetTickCount() - start < 3000) {
            Sleep(100);
            Rgb now = BackgroundColorOf(window);
            if (now == first && now != Rgb{0, 0, 0}) break;
            first = now;
        }
    }

    DiscFolder disc;
    TestProcess launcher;
};

TEST_F(LauncherWindow, ClientAreaIsTheBackgroundAndTheWindowIsCentred) {
    ScopedMachineKey product(kProductKeyPath);
    product.SetText(L"VEMO_LANGUAGE", L"German");
    HWND window = Start();
    ASSERT_TRUE(window);
    wchar_t title[64] = {};
    GetWindowTextW(window, title, 64);
    EXPECT_STREQ(title, L"AutoPlay");
    RECT client{};
    GetClientRect(window, &client);
    EXPECT_EQ(client.right - client.left, 640);
    EXPECT_EQ(client.bottom - client.top, 480);
    RECT frame{};
    GetWindowRect(window, &frame);
    int width = frame.right - frame.left;
    int height = frame.bottom - frame.top;
    EXPECT_EQ(width, 640 + 2 * GetSystemMetrics(SM_CXDLGFRAME));
    EXPECT_EQ(height, 480 + 2 * GetSystemMetrics(SM_CYDLGFRAME));
    EXPECT_EQ(frame.left, (GetSystemMetrics(SM_CXFULLSCREEN) - width) >> 1);
    EXPECT_EQ(frame.top, (GetSystemMetrics(SM_CYFULLSCREEN) - height) >> 1);
    LONG style = GetWindowLongW(window, GWL_STYLE);
    EXPECT_TRUE(style & WS_POPUP);
    EXPECT_FALSE((style & WS_CAPTION) == WS_CAPTION) << "the window must have no caption";
    EXPECT_EQ(BackgroundColorOf(window), TestColorOf(kGerman));
}

TEST_F(LauncherWindow, CommandLineLanguageChoosesTheBackground) {
    ScopedMachineKey product(kProductKeyPath);
    product.SetText(L"VEMO_LANGUAGE", L"German");
    for (const auto& [option, base] : {std::pair{L"-l0411", kJapanese}, std::pair{L"-l041e", kThai},
                                       std::pair{L"-l0c04", kSimplifiedChinese}}) {
        SCOPED_TRACE(base);
        HWND window = Start(option);
        ASSERT_TRUE(window);
        EXPECT_EQ(BackgroundColorOf(window), TestColorOf(base));
        PostMessageW(window, WM_CLOSE, 0, 0);
        EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    }
}

TEST_F(LauncherWindow, SecondLauncherBringsTheFirstBackRestoredAndInFront) {
    ScopedMachineKey product(kProductKeyPath);
    product.SetText(L"VEMO_LANGUAGE", L"French");
    HWND window = Start();
    ASSERT_TRUE(window);
    ShowWindow(window, SW_MINIMIZE);
    DWORD start = GetTickCount();
    while (!IsIconic(window) && GetTickCount() - start < 5000) Sleep(50);
    ASSERT_TRUE(IsIconic(window));

    TestProcess second;
    ASSERT_TRUE(second.Start(disc.Launcher(), L"", disc.Root()));
    EXPECT_EQ(second.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    start = GetTickCount();
    while ((IsIconic(window) || GetForegroundWindow() != window) && GetTickCount() - start < 5000) {
        Sleep(50);
    }
    EXPECT_FALSE(IsIconic(window));
    EXPECT_EQ(GetForegroundWindow(), window);
    EXPECT_TRUE(TopLevelWindows(second.Id()).empty());
}

TEST_F(LauncherWindow, ClosingTheWindowEndsTheLauncher) {
    HWND window = Start(L"-l0409");
    ASSERT_TRUE(window);
    PostMessageW(window, WM_CLOSE, 0, 0);
    EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
}

}  // namespace
