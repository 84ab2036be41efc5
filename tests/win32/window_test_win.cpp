// The launcher's window procedure in this process, and a shutdown that leaves nothing behind.
#include <gtest/gtest.h>

#include <cstdlib>

#include "graphics/painting_win.h"
#include "locale/catalogue_win.h"
#include "locale/config_win.h"
#include "shell/launcher_state.h"
#include "shell/mouse_hook_win.h"
#include "shell/startup_win.h"
#include "shell/window_win.h"
#include "test_support_win.h"

namespace {

bool PaletteDisplay() { return std::getenv("AUTOPLAY_EXPECT_PALETTE_DISPLAY") != nullptr; }

class LauncherWindowProc : public DiscTest {
  protected:
    void SetUp() override {
        DiscTest::SetUp();
        disc.WriteFile(FindLanguage(kUsEnglish)->backgroundFile,
                       SolidBmpFile(640, 480, {250, 250, 250}));
        LoadCatalogue();
        WNDCLASSEXW windowClass{};
        windowClass.cbSize = sizeof(windowClass);
        windowClass.style = CS_VREDRAW | CS_HREDRAW | CS_OWNDC;
        windowClass.lpfnWndProc = MainWindowProc;
        windowClass.hInstance = launcher.instance;
        windowClass.lpszClassName = kWindowClassName;
        RegisterClassExW(&windowClass);
        window = CreateWindowExW(0, kWindowClassName, kWindowTitle, WS_POPUP, 0, 0, 640, 480,
                                 nullptr, nullptr, launcher.instance, nullptr);
        ASSERT_TRUE(window);
        launcher.mainWindow = window;
        launcher.languageBase = kUsEnglish;
        launcher.languageKnown = true;
        launcher.discSku = 1;
        launcher.menu.StartMainMenu(window);
        ShowWindow(window, SW_SHOWNORMAL);
        Pump();
    }
    void TearDown() override {
        UniqueHandle noMutex;
        ShutDownLauncher(noMutex, launcher.instance);
        ResetLauncherMenu();
        DiscTest::TearDown();
    }

    // Handles what the window has been sent, within a bound.
    void Pump() {
        MSG message;
        for (DWORD start = GetTickCount(); GetTickCount() - start < 300;) {
            while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) DispatchMessageW(&message);
            Sleep(10);
        }
    }

    // Installs the game as its installer would: its values, and its program in its folder.
    void InstallGame() {
        game.WriteFile(L"Vemo.exe", "MZ");
        product = std::make_unique<ScopedMachineKey>(kProductKeyPath);
        product->SetText(L"Version", L"1.0");
        product->SetDword(L"EP8Installed", 1);
        product->SetText(L"VEMO_DATA", game.Path().substr(0, game.Path().size() - 1));
    }

    LauncherButton* Button(std::uint32_t id) {
        for (const auto& button : launcher.menu.allButtons) {
            if (button->id == id) return button.get();
        }
        return nullptr;
    }

    // The left edge of the caption ending at (187, 237), read off the screen against the plain
    // background beside it (on a 256-colour display its colour is the nearest the screen has).
    int CaptionLeftEdge() {
        const Rgb plain = ScreenPixel(20, 230);
        for (int x = 80; x < 187; ++x) {
            for (int y = 223; y < 237; ++y) {
                if (ScreenPixel(x, y) != plain) return x;
            }
        }
        return 187;
    }

    int CaptionWidth(const wchar_t* text) {
        HDC dc = GetDC(window);
        HGDIOBJ old = SelectObject(dc, FontFor(kUsEnglish));
        SIZE size{};
        GetTextExtentPoint32W(dc, text, static_cast<int>(wcslen(text)), &size);
        SelectObject(dc, old);
        ReleaseDC(window, dc);
        return size.cx;
    }

    TempFolder game;
    std::unique_ptr<ScopedMachineKey> product;
    HWND window = nullptr;
};

TEST_F(LauncherWindowProc, ActivationFollowsTheUserAndShowsPlayOnceTheGameIsInstalled) {
    SendMessageW(window, WM_ACTIVATE, WA_INACTIVE, 0);
    EXPECT_FALSE(launcher.appActive);
    InstallGame();
    EXPECT_TRUE(Button(101)->visible) << "nothing changes before the launcher is active again";
    SendMessageW(window, WM_ACTIVATE, WA_CLICKACTIVE, 0);
    EXPECT_TRUE(launcher.appActive);
    EXPECT_FALSE(Button(101)->visible);
    EXPECT_TRUE(Button(102)->visible);
}

TEST_F(LauncherWindowProc, ThePaintWritesPlayBesideTheButtonOnceTheGameIsInstalled) {
    const int install = CaptionWidth(L"Install");
    const int play = CaptionWidth(L"Play");
    ASSERT_GT(install, play + 8);
    RedrawWindow(window, nullptr, nullptr, RDW_INVALIDATE | RDW_UPDATENOW | RDW_ALLCHILDREN);
    Pump();
    EXPECT_NEAR(CaptionLeftEdge(), 187 - install, 4);
    InstallGame();
    RedrawWindow(window, nullptr, nullptr, RDW_INVALIDATE | RDW_UPDATENOW | RDW_ALLCHILDREN);
    Pump();
    EXPECT_NEAR(CaptionLeftEdge(), 187 - play, 4) << "the caption still says Install";
}

TEST_F(LauncherWindowProc, APaletteChangeByAnotherWindowRepaintsOneByItselfDoesNot) {
    ValidateRect(window, nullptr);
    EXPECT_EQ(SendMessageW(window, WM_PALETTECHANGED, reinterpret_cast<WPARAM>(window), 0), 0);
    EXPECT_FALSE(GetUpdateRect(window, nullptr, FALSE));
    EXPECT_EQ(SendMessageW(window, WM_PALETTECHANGED, reinterpret_cast<WPARAM>(GetDesktopWindow()), 0), 0);
    RECT update{};
    EXPECT_TRUE(GetUpdateRect(window, &update, FALSE));
    EXPECT_EQ(update.right - update.left, 640);
    EXPECT_EQ(update.bottom - update.top, 480);
}

TEST_F(LauncherWindowProc, BecomingActiveOnAPaletteDisplayRealisesThePalette) {
    ASSERT_EQ(launcher.palette.Get() != nullptr, PaletteDisplay());
    ValidateRect(window, nullptr);
    LRESULT changed = SendMessageW(window, WM_QUERYNEWPALETTE, 0, 0);
    // Only where a palette exists can realising it change anything, and what changed is
    // repainted.
    if (!PaletteDisplay()) {
        EXPECT_EQ(changed, 0);
    }
    EXPECT_EQ(GetUpdateRect(window, nullptr, FALSE) != FALSE, changed == 1);
}

TEST_F(LauncherWindowProc, ShutdownLeavesNothingForTheGlobalsToRelease) {
    ASSERT_EQ(SetMouseHook(launcher.instance, window, true), 1);
    UniqueHandle mutex(CreateMutexW(nullptr, TRUE, nullptr));
    ShutDownLauncher(mutex, launcher.instance);
    EXPECT_FALSE(mutex);
    EXPECT_FALSE(IsWindow(window));
    EXPECT_EQ(launcher.mainWindow, nullptr);
    EXPECT_TRUE(launcher.menu.allButtons.empty());
    EXPECT_TRUE(launcher.menu.buttonsByWindow.empty());
    EXPECT_EQ(SetMouseHook(launcher.instance, nullptr, false), 0) << "the hook is still there";
    EXPECT_TRUE(catalogue.languageBackgrounds.empty());
    EXPECT_TRUE(catalogue.languageFonts.empty());
    for (HFONT font : catalogue.fontSlots) EXPECT_EQ(font, nullptr);
    for (const PictureTable& table : catalogue.iconPictures) EXPECT_TRUE(table.empty());
    EXPECT_EQ(catalogue.opaqueMask, nullptr);
    EXPECT_EQ(launcher.workingBackground, nullptr);
    EXPECT_FALSE(launcher.backgroundBitmap);
    EXPECT_FALSE(launcher.palette);
}

}  // namespace
