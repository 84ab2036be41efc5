// What the user sees on the sample disc: the launcher's window, and each language's own
// background with its captions. With AUTOPLAY_SCREENSHOT_DIR set, each screen is also saved
// there as a .bmp file (scripts/screenshots.sh turns them into the README's pictures).
#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <string>

#include "launcher_driver_win.h"
#include "test_support_win.h"

namespace {

// Points of the window where neither buttons nor captions ever are.
const POINT kPlainPoints[] = {{620, 10}, {600, 470}, {150, 300}, {10, 150}, {480, 360}};

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

// A popup without a caption, its client area the background's size, in the middle of the
// screen.
void ExpectCentredPopup(HWND window) {
    EXPECT_EQ(TextOfWindow(window), L"AutoPlay");
    RECT client{};
    GetClientRect(window, &client);
    EXPECT_EQ(client.right - client.left, 640);
    EXPECT_EQ(client.bottom - client.top, 480);
    RECT frame{};
    GetWindowRect(window, &frame);
    const int width = frame.right - frame.left;
    const int height = frame.bottom - frame.top;
    EXPECT_EQ(width, 640 + 2 * GetSystemMetrics(SM_CXDLGFRAME));
    EXPECT_EQ(height, 480 + 2 * GetSystemMetrics(SM_CYDLGFRAME));
    EXPECT_EQ(frame.left, (GetSystemMetrics(SM_CXFULLSCREEN) - width) >> 1);
    EXPECT_EQ(frame.top, (GetSystemMetrics(SM_CYFULLSCREEN) - height) >> 1);
    const LONG style = GetWindowLongW(window, GWL_STYLE);
    EXPECT_TRUE(style & WS_POPUP);
    EXPECT_NE(style & WS_CAPTION, WS_CAPTION) << "the window must have no caption";
}

using Screens = LauncherTest;

TEST_F(Screens, EachLanguageShowsItsOwnBackgroundAndCaptionsInACentredPopup) {
    struct Row {
        const wchar_t* option;
        const wchar_t* background;
        const char* name;
    };
    const Row rows[] = {
        {L"-l0409", L"Launcher\\AutoPlayBack.bmp", "main-en"},
        {L"-l040c", L"Launcher\\AutoPlayBackFr.bmp", "main-fr"},
        {L"-l0407", L"Launcher\\AutoPlayBackDe.bmp", "main-de"},
        {L"-l0415", L"Launcher\\AutoPlayBackPo.bmp", "main-pl"},
        {L"-l0411", L"Launcher\\AutoPlayBackJp.bmp", "main-ja"},
        {L"-l0404", L"Launcher\\AutoPlayBackTC.bmp", "main-zh-tw"},
        {L"-l0804", L"Launcher\\AutoPlayBackSC.bmp", "main-zh-cn"},
        {L"-l041e", L"Launcher\\AutoPlayBackTh.bmp", "main-th"},
        {L"-l0412", L"Launcher\\AutoPlayBackKo.bmp", "main-ko"},
        {L"-l0406", L"Launcher\\AutoPlayBackDN.bmp", "main-da"},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        ASSERT_TRUE(Start(row.option));
        ExpectCentredPopup(window);
        const Screenshot shot = SettledShot(window);
        shot.SaveForReadme(std::wstring(row.name, row.name + std::strlen(row.name)));
        HBITMAP file = static_cast<HBITMAP>(LoadImageW(nullptr, disc.Path(row.background).c_str(),
                                                       IMAGE_BITMAP, 0, 0, LR_LOADFROMFILE));
        ASSERT_TRUE(file);
        const Screenshot background(file);
        DeleteObject(file);
        for (POINT point : kPlainPoints) {
            SCOPED_TRACE(testing::Message() << "at " << point.x << "," << point.y);
            EXPECT_LE(ColorDistance(shot.At(point.x, point.y), background.At(point.x, point.y)), 6);
        }
        // Every caption of the main menu is written beside its button.
        for (POINT end : {POINT{187, 237}, POINT{262, 278}, POINT{329, 332}, POINT{370, 391},
                          POINT{398, 443}}) {
            SCOPED_TRACE(testing::Message() << "caption ending at " << end.x << "," << end.y);
            EXPECT_GT(CaptionInk(shot, background, end.x, end.y), 15);
        }
        ASSERT_EQ(CloseLauncher(), std::optional<DWORD>(0));
    }
}

}  // namespace
