// What the user sees on the sample disc: each language's own background with its captions,
// and the language-selection picture. With AUTOPLAY_SCREENSHOT_DIR set, each screen is also
// saved there as a .bmp file (scripts/screenshots.sh turns them into the README's pictures).
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "e2e_support_win.h"
#include "launcher_driver_win.h"
#include "locale/config_win.h"
#include "sample_disc_win.h"
#include "test_support_win.h"

namespace {


// Points of the window where neither buttons nor captions ever are.
const POINT kPlainPoints[] = {{620, 10}, {600, 470}, {150, 300}, {10, 150}, {480, 360}};

void ExpectPictureShows(const Screenshot& shot, const Screenshot& picture) {
    for (POINT point : kPlainPoints) {
        SCOPED_TRACE(testing::Message() << "at " << point.x << "," << point.y);
        EXPECT_LE(ColorDistance(shot.At(point.x, point.y), picture.At(point.x, point.y)), 6);
    }
}

// Pixels written over the picture in the band that ends at a caption's point: the caption's
// dark blue text, darker and bluer than the light picture under it.
int CaptionInk(const Screenshot& shot, const Screenshot& picture, int right, int bottom) {
    int ink = 0;
    for (int y = bottom - 16; y < bottom; ++y) {
        for (int x = std::max(0, right - 200); x <= right; ++x) {
            Rgb c = shot.At(x, y);
            Rgb under = picture.At(x, y);
            if (ColorDistance(c, under) > 90 && c.b >= c.r && c.b >= c.g) ++ink;
        }
    }
    return ink;
}

class Screens : public testing::Test {
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

    std::optional<Screenshot> Show(const std::wstring& arguments) {
        if (!launcher.Start(disc.Launcher(), arguments, disc.Root())) return std::nullopt;
        HWND window = WaitForWindow(launcher.Id(), L"LauncherAppClass");
        if (!window) return std::nullopt;
        // Let the first paint land: two equal captures in a row, within a bound.
        std::optional<Screenshot> shot;
        DWORD start = GetTickCount();
        for (;;) {
            Sleep(300);
            Screenshot now(window);
            bool settled = shot && now.At(620, 10) == shot->At(620, 10) &&
                           now.At(150, 230) == shot->At(150, 230);
            shot = now;
            if (settled || GetTickCount() - start > 5000) break;
        }
        return shot;
    }

    SampleDisc disc;
    TestProcess launcher;
};

struct LanguageScreen {
    const wchar_t* option;
    const wchar_t* background;
    const wchar_t* name;
};

TEST_F(Screens, EachLanguageShowsItsOwnBackgroundAndCaptions) {
    const LanguageScreen screens[] = {
        {L"-l0409", L"Launcher\\AutoPlayBack.bmp", L"main-en"},
        {L"-l040c", L"Launcher\\AutoPlayBackFr.bmp", L"main-fr"},
        {L"-l0407", L"Launcher\\AutoPlayBackDe.bmp", L"main-de"},
        {L"-l0415", L"Launcher\\AutoPlayBackPo.bmp", L"main-pl"},
        {L"-l0411", L"Launcher\\AutoPlayBackJp.bmp", L"main-ja"},
        {L"-l0404", L"Launcher\\AutoPlayBackTC.bmp", L"main-zh-tw"},
        {L"-l0804", L"Launcher\\AutoPlayBackSC.bmp", L"main-zh-cn"},
        {L"-l041e", L"Launcher\\AutoPlayBackTh.bmp", L"main-th"},
        {L"-l0412", L"Launcher\\AutoPlayBackKo.bmp", L"main-ko"},
        {L"-l0406", L"Launcher\\AutoPlayBackDN.bmp", L"main-da"},
    };
    for (const LanguageScreen& screen : screens) {
        SCOPED_TRACE(testing::Message() << "option of " << wcslen(screen.option) << " chars, "
                                        << std::string(screen.name, screen.name + wcslen(screen.name)));
        std::optional<Screenshot> shot = Show(screen.option);
        ASSERT_TRUE(shot) << "no window";
        ASSERT_EQ(shot->Width(), 640);
        ASSERT_EQ(shot->Height(), 480);
        shot->SaveForReadme(screen.name);
        HBITMAP file = static_cast<HBITMAP>(LoadImageW(
            nullptr, disc.Path(screen.background).c_str(), IMAGE_BITMAP, 0, 0, LR_LOADFROMFILE));
        ASSERT_TRUE(file);
        Screenshot background(file);
        DeleteObject(file);
        ExpectPictureShows(*shot, background);
        // Every caption of the main menu is written beside its button.
        for (POINT end : {POINT{187, 237}, POINT{262, 278}, POINT{329, 332}, POINT{370, 391},
                          POINT{398, 443}}) {
            SCOPED_TRACE(testing::Message() << "caption ending at " << end.x << "," << end.y);
            EXPECT_GT(CaptionInk(*shot, background, end.x, end.y), 15);
        }
        for (HWND window : TopLevelWindows(launcher.Id(), L"LauncherAppClass")) {
            PostMessageW(window, WM_CLOSE, 0, 0);
        }
        ASSERT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    }
}

TEST_F(Screens, WithoutALanguageTheLanguageSelectionPictureShowsWithoutCaptions) {
    std::optional<Screenshot> shot = Show(L"");
    ASSERT_TRUE(shot) << "no window";
    shot->SaveForReadme(L"language-list");
    HMODULE program = LoadLibraryExW(disc.Launcher().c_str(), nullptr,
                                     LOAD_LIBRARY_AS_DATAFILE | LOAD_LIBRARY_AS_IMAGE_RESOURCE);
    ASSERT_TRUE(program);
    HBITMAP resource = static_cast<HBITMAP>(
        LoadImageW(program, MAKEINTRESOURCEW(377), IMAGE_BITMAP, 0, 0, LR_CREATEDIBSECTION));
    ASSERT_TRUE(resource);
    Screenshot list(resource);
    DeleteObject(resource);
    FreeLibrary(program);
    ExpectPictureShows(*shot, list);
    EXPECT_EQ(CaptionInk(*shot, list, 329, 332), 0);
    EXPECT_EQ(CaptionInk(*shot, list, 398, 443), 0);
}

}  // namespace
