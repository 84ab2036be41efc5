// What the user sees on the sample disc, and what the launcher holds and spends meanwhile.
// With AUTOPLAY_SCREENSHOT_DIR set the screens are saved for the README.
#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <cstdio>
#include <optional>
#include <string>
#include <thread>
#include <vector>

#include "launcher_driver_win.h"
#include "locale/config_win.h"
#include "shell/window_win.h"
#include "test_support_win.h"

namespace {

RECT Rect(int x, int y, int width, int height) {
    return {x, y, x + width, y + height};
}

POINT Centre(const RECT& r) {
    return {(r.left + r.right) / 2, (r.top + r.bottom) / 2};
}

// A button as it should be: control id, label (string offset in its language) and place.
struct Documented {
    int id;
    int labelOffset;
    RECT place;
};

const Documented kAbout{1000, 1, Rect(9, 346, 162, 117)};
const Documented kInstall{101, 1, Rect(186, 162, 85, 96)};
const Documented kPlay{102, 2, Rect(186, 162, 85, 96)};
const Documented kMoreGames{103, 3, Rect(330, 268, 73, 79)};
const Documented kWebSite{107, 7, Rect(272, 225, 66, 67)};
const Documented kMoreInformation{108, 8, Rect(372, 323, 73, 87)};
const Documented kReadme{301, 12, Rect(372, 323, 73, 87)};
const Documented kExit{110, 10, Rect(405, 411, 54, 54)};
// Hit circle centres in the window; Install and Play share one place.
constexpr POINT kPlayCircle{226, 212};
constexpr POINT kMoreGamesCircle{363, 310};
constexpr POINT kMoreInformationCircle{409, 371};

const std::vector<Documented> kInfoPanel = {{303, 32, Rect(416, 28, 209, 49)},
                                            {302, 13, Rect(416, 81, 209, 49)},
                                            {301, 12, Rect(416, 133, 209, 49)}};
const std::vector<Documented> kGamesPanel = {{601, 72, Rect(416, 29, 209, 49)},
                                             {602, 78, Rect(416, 81, 209, 49)},
                                             {603, 77, Rect(416, 133, 209, 49)}};
const std::vector<Documented> kPlayPanel = {{150, 69, Rect(295, 19, 209, 49)},
                                            {151, 70, Rect(295, 71, 209, 49)},
                                            {152, 71, Rect(295, 123, 209, 49)}};

// Each edition's language list: id, the language's own name, and its 212 x 50 button's place.
struct Listed {
    int id;
    const wchar_t* name;
    int x;
    int y;
};

using LanguageList = std::vector<Listed>;
const LanguageList kEdition1 = {{500, L"English", 84, 151}, {506, L"Español", 84, 202}};
const LanguageList kEdition2 = {
    {508, L"Polski", 84, 151},   {501, L"Français", 84, 202},       {502, L"Deutsch", 84, 253},
    {512, L"Italiano", 84, 304}, {503, L"Svenska", 300, 151},       {504, L"Nederlands", 300, 202},
    {506, L"Español", 300, 253}, {505, L"Português(BR)", 300, 304}, {519, L"English", 300, 355},
    {514, L"Norsk", 84, 355},    {515, L"Suomeksi", 84, 100},       {513, L"Dansk", 300, 100}};
const LanguageList kEdition3 = {{509, L"繁體中文", 84, 151},
                                {511, L"ไทย", 84, 202},
                                {518, L"한국어", 84, 253},
                                {500, L"English", 84, 304}};
const LanguageList kEdition4 = {{510, L"简体中文版", 84, 151}, {500, L"English", 84, 202}};
const LanguageList kEdition6 = {{514, L"Norsk", 84, 151},
                                {515, L"Suomeksi", 84, 202},
                                {513, L"Dansk", 84, 253},
                                {519, L"English", 84, 304}};

// A label in the launcher's program file: the string at its language's base plus its offset.
std::wstring Label(const std::wstring& program, LanguageBase base, int offset) {
    HMODULE module = LoadLibraryExW(program.c_str(), nullptr,
                                    LOAD_LIBRARY_AS_DATAFILE | LOAD_LIBRARY_AS_IMAGE_RESOURCE);
    wchar_t text[256] = {};
    const int length = module ? LoadStringW(module, base + offset, text, 256) : 0;
    if (module) FreeLibrary(module);
    return std::wstring(text, static_cast<std::size_t>(std::max(length, 0)));
}

// One child window as a user and a screen reader see it.
std::wstring Describe(const std::wstring& className, int id, const std::wstring& text,
                      const RECT& place, bool shown) {
    return className + L" " + std::to_wstring(id) + L" \"" + text + L"\" at " +
           std::to_wstring(place.left) + L"," + std::to_wstring(place.top) + L" " +
           std::to_wstring(place.right - place.left) + L"x" +
           std::to_wstring(place.bottom - place.top) + (shown ? L" shown" : L" hidden");
}

std::vector<std::wstring> Sorted(std::vector<std::wstring> lines) {
    std::sort(lines.begin(), lines.end());
    return lines;
}

std::vector<std::wstring> ChildrenSeen(HWND launcher) {
    std::vector<std::wstring> seen;
    for (const ButtonSeen& child : ChildButtons(launcher)) {
        seen.push_back(Describe(child.className, child.id, child.text, child.place, child.visible));
    }
    return Sorted(seen);
}

// The language list's buttons, and its own About button that is never shown.
std::vector<std::wstring> ListButtons(const LanguageList& languages, bool shown,
                                      const std::wstring& aboutLabel) {
    std::vector<std::wstring> list = {
        Describe(L"Button", kAbout.id, aboutLabel, kAbout.place, false)};
    for (const Listed& language : languages) {
        list.push_back(Describe(L"Button", language.id, language.name,
                                Rect(language.x, language.y, 212, 50), shown));
    }
    return list;
}

// Whether the visible panel plates (the only buttons 209 pixels wide) are the panel's, no more.
bool OnlyPlatesOf(HWND launcher, const std::vector<Documented>& panel) {
    std::vector<int> shown, wanted;
    for (const ButtonSeen& button : ChildButtons(launcher)) {
        if (button.visible && button.place.right - button.place.left == 209) {
            shown.push_back(button.id);
        }
    }
    for (const Documented& plate : panel) wanted.push_back(plate.id);
    std::sort(shown.begin(), shown.end());
    std::sort(wanted.begin(), wanted.end());
    return shown == wanted;
}

// A plate is laid over what its place showed before through a mask of 251 or 252, not 255,
// so a plate drawn again after its hover face keeps a trace of it, a few levels at most.
constexpr int kPlateTrace = 12;

// Another program's window, in front of the launcher, answering messages from a thread of its
// own; in a corner, clear of the launcher, so that nothing of the launcher needs a repaint.
class OtherProgramWindow {
  public:
    ~OtherProgramWindow() {
        stop_ = true;
        thread_.join();
    }
    std::atomic<HWND> window{nullptr};

  private:
    std::atomic<bool> stop_{false};
    std::thread thread_{[this] {
        HWND own = CreateWindowExW(0, L"STATIC", L"Another program", WS_POPUP | WS_VISIBLE, 0, 0,
                                   120, 80, nullptr, nullptr, nullptr, nullptr);
        SetForegroundWindow(own);
        window = own;
        for (MSG message; !stop_;) {
            MsgWaitForMultipleObjects(0, nullptr, FALSE, 50, QS_ALLINPUT);
            while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) DispatchMessageW(&message);
        }
        DestroyWindow(own);
    }};
};

// The GDI objects or windows the launcher says it holds; -1 when it does not answer.
LRESULT HeldByLauncher(HWND window, WPARAM what) {
    static const UINT message = RegisterWindowMessageW(kGuiObjectCountsMessageName);
    DWORD_PTR answer = 0;
    if (!SendMessageTimeoutW(window, message, what, 0, SMTO_ABORTIFHUNG, 5000, &answer)) return -1;
    return static_cast<LRESULT>(answer);
}

using Menu = LauncherTest;

TEST_F(Menu, EachEditionOffersItsLanguagesOrSettlesOneAndTheChoiceWritesItsLocale) {
    struct Row {
        int edition;               // 0: the disc has no ORVAK.INI
        const LanguageList* list;  // the list it shows, if any
        int click;                 // the language clicked there
        LanguageBase base;
        bool moreGames;  // the More Games button and its panel exist
        bool readme;     // Readme stands at the More Information place
        const wchar_t* locale;
        const wchar_t* listShot;
        const wchar_t* menuShot;
    };
    const Row rows[] = {
        {1, &kEdition1, 506, kSpanish, true, false, L"es", L"language-list", nullptr},
        // Edition 2 has no More Games button and no games panel.
        {2, &kEdition2, 502, kGerman, false, false, L"de", L"languages-edition2", L"menu-de"},
        // The product editions these lists stand for put Readme at More Information.
        {3, &kEdition3, 511, kThai, true, true, L"th", nullptr, nullptr},
        {4, &kEdition4, 500, kUsEnglish, true, true, L"en_US", nullptr, nullptr},
        {5, nullptr, 0, kJapanese, true, true, L"ja", nullptr, L"menu-ja"},
        {6, &kEdition6, 514, kNorwegian, true, false, L"no", nullptr, nullptr},
        {0, nullptr, 0, kUsEnglish, true, false, L"en_US", nullptr, nullptr},
        {7, nullptr, 0, kUsEnglish, true, false, L"en_US", nullptr, nullptr},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << "disc edition " << row.edition);
        DeleteMachineKey(kLocaleKeyPath);
        row.edition ? disc.SetEdition(row.edition) : disc.MoveAside(L"ORVAK.INI");
        ASSERT_TRUE(Start(L""));
        const LanguageList list = row.list ? *row.list : LanguageList{};
        if (row.list) {
            EXPECT_EQ(ChildrenSeen(window), Sorted(ListButtons(list, true, L"")));
            EXPECT_EQ(MachineText(kLocaleKeyPath, L""), std::nullopt)
                << "the list wrote a locale before any choice";
            if (row.listShot) SettledShot(window).SaveForReadme(row.listShot);
            auto chosen = std::find_if(list.begin(), list.end(),
                                       [&](const Listed& l) { return l.id == row.click; });
            ASSERT_NE(chosen, list.end());
            Click(window, Centre(Rect(chosen->x, chosen->y, 212, 50)));
            ASSERT_TRUE(WaitUntil([&] { return VisibleButton(window, kExit.id) != nullptr; }))
                << "the main menu did not come";
        }
        // Without a list, the list's About button takes the settled language's label.
        const std::wstring program = disc.Launcher();
        std::vector<std::wstring> expected =
            ListButtons(list, false, row.list ? L"" : Label(program, row.base, 71));
        // Every button of the main page and its panels, no panel open, the game not installed.
        auto add = [&](const Documented& button, bool shown) {
            expected.push_back(Describe(L"Button", button.id,
                                        Label(program, row.base, button.labelOffset), button.place,
                                        shown));
        };
        for (const Documented* shown :
             {&kAbout, &kInstall, &kWebSite, &kExit, row.readme ? &kReadme : &kMoreInformation}) {
            add(*shown, true);
        }
        add(kPlay, false);
        for (const Documented& plate : kInfoPanel) add(plate, false);
        for (const Documented& plate : kPlayPanel) add(plate, false);
        if (row.moreGames) {
            add(kMoreGames, true);
            for (const Documented& plate : kGamesPanel) add(plate, false);
        }
        const Screenshot shot = Rest();
        EXPECT_EQ(ChildrenSeen(window), Sorted(expected));
        EXPECT_EQ(MachineText(kLocaleKeyPath, L""), std::optional<std::wstring>(row.locale));
        if (row.menuShot) shot.SaveForReadme(row.menuShot);
        ASSERT_EQ(CloseLauncher(), std::optional<DWORD>(0));
    }
}

TEST_F(Menu, InstallingWhileTheLauncherRunsTurnsInstallIntoPlayOnceItIsActiveAgain) {
    ASSERT_TRUE(Start(L"-l0409"));
    ASSERT_TRUE(VisibleButton(window, kInstall.id));
    ASSERT_FALSE(VisibleButton(window, kPlay.id));
    const Screenshot withInstall = SettledShot(window);
    {
        OtherProgramWindow other;
        ASSERT_TRUE(WaitUntil([&] {
            return other.window && GetForegroundWindow() == other.window;
        })) << "the launcher could not be left for another window";
        ASSERT_EQ(RunSetup(L"-s -l0409"), std::optional<DWORD>(0));
        Sleep(500);
        // Nothing has told the launcher yet: it neither was activated nor repainted.
        EXPECT_TRUE(VisibleButton(window, kInstall.id));

        Click(window, kRestPoint);  // the user comes back to it
        bool together = false;
        EXPECT_TRUE(WaitUntil([&] {
            const bool install = VisibleButton(window, kInstall.id) != nullptr;
            const bool play = VisibleButton(window, kPlay.id) != nullptr;
            together = together || (install && play);
            return play && !install;
        })) << "Play did not replace Install";
        EXPECT_FALSE(together) << "Install and Play were visible together";
        EXPECT_EQ(GetForegroundWindow(), window);
    }
    const Screenshot switched = Rest();
    ASSERT_EQ(CloseLauncher(), std::optional<DWORD>(0));

    // A launcher started with the game installed shows how the caption beside Play reads.
    ASSERT_TRUE(Start(L"-l0409"));
    EXPECT_TRUE(VisibleButton(window, kPlay.id));
    EXPECT_FALSE(VisibleButton(window, kInstall.id));
    const Screenshot withPlay = SettledShot(window);
    const RECT caption{0, 205, 185, 240};  // ends at (187, 237), left of the button
    ASSERT_GT(withPlay.DifferingPixels(withInstall, caption), 20)
        << "the captions cannot be told apart";
    EXPECT_EQ(switched.DifferingPixels(withPlay, caption), 0) << "the caption does not say Play";
    EXPECT_EQ(switched.DifferingPixels(withPlay, kPlay.place), 0) << "the Play face is not drawn";
}

TEST_F(Menu, EachPanelOpensAndClosesWithItsButtonAndAnotherButtonSwitchesPanels) {
    ASSERT_EQ(RunSetup(L"-s -l0409"), std::optional<DWORD>(0));
    ASSERT_TRUE(Start(L"-l0409"));
    ASSERT_TRUE(VisibleButton(window, kPlay.id)) << "the game counts as not installed";
    const Screenshot closed = SettledShot(window);

    struct Row {
        const char* name;
        const Documented& opener;
        POINT circle;
        const std::vector<Documented>& plates;
        RECT backdrop;
        const wchar_t* screenshot;
    };
    const Row rows[] = {
        {"play", kPlay, kPlayCircle, kPlayPanel, Rect(271, 55, 240, 149), L"menu-panel-play"},
        {"games", kMoreGames, kMoreGamesCircle, kGamesPanel, Rect(403, 54, 237, 252),
         L"menu-panel-games"},
        {"information", kMoreInformation, kMoreInformationCircle, kInfoPanel,
         Rect(403, 67, 237, 256), L"menu-panel-info"},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        Click(window, row.circle);
        EXPECT_TRUE(WaitUntil([&] { return OnlyPlatesOf(window, row.plates); }))
            << "the panel's plates, and only they, should show";
        const Screenshot open = Rest();
        EXPECT_GT(open.DifferingPixels(closed, row.opener.place), 200)
            << "the opener is not latched";
        EXPECT_GT(open.DifferingPixels(closed, row.backdrop), 5000) << "no backdrop";
        open.SaveForReadme(row.screenshot);

        Click(window, row.circle);
        EXPECT_TRUE(WaitUntil([&] { return OnlyPlatesOf(window, {}); })) << "the panel stayed";
        const Screenshot again = Rest();
        EXPECT_EQ(again.DifferingPixels(closed, {0, 0, 640, 480}), 0) << "closing left a trace";
    }

    // Another opener while a panel is open: the first panel closes, the new one opens.
    Click(window, kPlayCircle);
    ASSERT_TRUE(WaitUntil([&] { return OnlyPlatesOf(window, kPlayPanel); }));
    Click(window, kMoreGamesCircle);
    EXPECT_TRUE(WaitUntil([&] { return OnlyPlatesOf(window, kGamesPanel); }))
        << "the play panel's plates should go and the games panel's come";
    const Screenshot switched = Rest();
    EXPECT_EQ(switched.DifferingPixels(closed, kPlay.place), 0) << "Play stayed latched";
    EXPECT_GT(switched.DifferingPixels(closed, kMoreGames.place), 200)
        << "More Games is not latched";
}

TEST_F(Menu, TheMouseLightsACircleInsideItAndAPlateAnywhereOnIt) {
    ASSERT_TRUE(Start(L"-l0409"));
    HWND install = VisibleButton(window, kInstall.id);
    ASSERT_TRUE(install);
    const Screenshot before = SettledShot(window);
    // The mouse moved to `at`; the window once `lit` has the focus.
    auto hover = [&](POINT at, HWND lit) {
        MoveMouse(window, at);
        EXPECT_TRUE(WaitUntil([&] { return FocusInThreadOf(window) == lit; }));
        return SettledShot(window);
    };

    const Screenshot lit = hover(kPlayCircle, install);  // the Install circle's centre
    EXPECT_GT(lit.DifferingPixels(before, kInstall.place), 500) << "the hover face did not show";
    lit.SaveForReadme(L"menu-hover");
    const Screenshot off = hover({188, 164}, window);  // inside the window, outside the circle
    EXPECT_EQ(off.DifferingPixels(before, kInstall.place), 0) << "the hover face stayed";

    // A plate of an open panel takes the focus wherever the mouse is on it.
    Click(window, kMoreInformationCircle);
    ASSERT_TRUE(WaitUntil([&] { return OnlyPlatesOf(window, kInfoPanel); }));
    const Screenshot open = Rest();
    const Documented& registration = kInfoPanel[0];
    const Documented& support = kInfoPanel[1];
    const Screenshot plateLit = hover({registration.place.left + 3, registration.place.top + 3},
                                      VisibleButton(window, registration.id));
    EXPECT_GT(plateLit.DifferingPixels(open, registration.place, kPlateTrace), 100)
        << "the plate did not light";
    const Screenshot moved = hover(Centre(support.place), VisibleButton(window, support.id));
    EXPECT_EQ(moved.DifferingPixels(open, registration.place, kPlateTrace), 0)
        << "the first plate stayed lit";
    EXPECT_GT(moved.DifferingPixels(open, support.place, kPlateTrace), 100)
        << "the second plate did not light";
}

// Toggles the information panel by a click on its button, off the centre in turns: two clicks
// on one spot would make a double click, which toggles nothing. Whether it came out as asked.
bool ToggleInformationPanel(HWND window, bool open) {
    Click(window, {kMoreInformationCircle.x + (open ? -8 : 8), kMoreInformationCircle.y});
    return WaitUntil([&] { return (VisibleButton(window, kInfoPanel[0].id) != nullptr) == open; },
                     3000);
}

// Wine answers GetGuiResources with 0: the launcher counts its GDI objects and windows itself.
TEST_F(Menu, GuiObjectsStayFlatOverHoversAndPanelTogglesAndTheWaitingMenuIdles) {
    ASSERT_TRUE(Start(L"-l0409"));
    const LRESULT gdiBefore = HeldByLauncher(window, kGdiHandlesHeld);
    const LRESULT windowsBefore = HeldByLauncher(window, kWindowsHeld);
    ASSERT_GE(gdiBefore, 1) << "the painted background's bitmap is not counted";
    ASSERT_GT(windowsBefore, static_cast<LRESULT>(ChildButtons(window).size()));
    HWND install = VisibleButton(window, kInstall.id);

    int hovers = 0;
    for (int i = 0; i < 200; ++i) {
        const bool onButton = i % 2 == 0;
        MoveMouse(window, onButton ? kPlayCircle : kRestPoint);
        HWND lit = onButton ? install : window;
        if (WaitUntil([&] { return FocusInThreadOf(window) == lit; }, 3000)) ++hovers;
    }
    EXPECT_EQ(hovers, 200);
    const double beforeToggles = ProcessorMs(launcher.Id());
    int toggles = 0;
    for (int i = 0; i < 100; ++i) toggles += ToggleInformationPanel(window, i % 2 == 0);
    EXPECT_EQ(toggles, 100);
    // The idle reading below means something only if the toggles' repaints show in it.
    EXPECT_GT(ProcessorMs(launcher.Id()), beforeToggles) << "the processor time read is stuck";

    Rest();
    const LRESULT gdiAfter = HeldByLauncher(window, kGdiHandlesHeld);
    const LRESULT windowsAfter = HeldByLauncher(window, kWindowsHeld);
    std::printf("GDI objects held %ld -> %ld, windows %ld -> %ld over %d hovers, %d toggles\n",
                static_cast<long>(gdiBefore), static_cast<long>(gdiAfter),
                static_cast<long>(windowsBefore), static_cast<long>(windowsAfter), hovers, toggles);
    EXPECT_EQ(gdiAfter, gdiBefore);
    EXPECT_EQ(windowsAfter, windowsBefore);
    Sleep(1000);
    ExpectIdle(launcher.Id(), "of the waiting main menu");
}

// Points of the window where neither buttons nor captions ever are.
const POINT kPlainPoints[] = {{620, 10}, {600, 470}, {150, 300}, {10, 150}, {480, 360}};

// Caption pixels in the band ending at a caption's point: darker and bluer than the picture.
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

// A popup without a caption, its client area the background's size, centred on the screen.
void ExpectCentredPopup(HWND window) {
    EXPECT_EQ(TextOfWindow(window), L"AutoPlay");
    const int width = 640 + 2 * GetSystemMetrics(SM_CXDLGFRAME);
    const int height = 480 + 2 * GetSystemMetrics(SM_CYDLGFRAME);
    const int left = (GetSystemMetrics(SM_CXFULLSCREEN) - width) >> 1;
    const int top = (GetSystemMetrics(SM_CYFULLSCREEN) - height) >> 1;
    RECT frame{}, client{};
    GetWindowRect(window, &frame);
    GetClientRect(window, &client);
    EXPECT_EQ(std::vector<LONG>(
                  {frame.left, frame.top, frame.right, frame.bottom, client.right, client.bottom}),
              std::vector<LONG>({left, top, left + width, top + height, 640, 480}));
    const LONG style = GetWindowLongW(window, GWL_STYLE);
    EXPECT_TRUE(style & WS_POPUP);
    EXPECT_NE(style & WS_CAPTION, WS_CAPTION) << "the window must have no caption";
}

using Screens = LauncherTest;

// The README's languages; the others' backgrounds are the disc check's and the painting tests'.
TEST_F(Screens, EachLanguageShowsItsOwnBackgroundAndCaptionsInACentredPopup) {
    struct Row {
        const wchar_t* option;
        const wchar_t* background;
        const wchar_t* name;
    };
    const Row rows[] = {
        {L"-l0409", L"Launcher\\AutoPlayBack.bmp", L"main-en"},
        {L"-l0407", L"Launcher\\AutoPlayBackDe.bmp", L"main-de"},
        {L"-l0411", L"Launcher\\AutoPlayBackJp.bmp", L"main-ja"},
        {L"-l0404", L"Launcher\\AutoPlayBackTC.bmp", L"main-zh-tw"},
        {L"-l041e", L"Launcher\\AutoPlayBackTh.bmp", L"main-th"},
        {L"-l0412", L"Launcher\\AutoPlayBackKo.bmp", L"main-ko"},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        ASSERT_TRUE(Start(row.option));
        ExpectCentredPopup(window);
        const Screenshot shot = SettledShot(window);
        shot.SaveForReadme(row.name);
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
