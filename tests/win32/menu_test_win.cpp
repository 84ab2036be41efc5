// The picture buttons and the menu controller in this process: what each screen builds, how
// buttons draw (read back as pixels), the panels, the installation check against the real
// registry, and a screen built while memory runs out.
#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
#include <new>
#include <set>

#include "actions/command_ids.h"
#include "graphics/masked_blend.h"
#include "locale/catalogue_win.h"
#include "locale/config_win.h"
#include "menu/menu_controller.h"
#include "shell/launcher_state.h"
#include "test_support_win.h"

// Allocations can be made to fail from a chosen one on; `liveAllocations` tells leaks.
namespace {
// Atomic: start-up reads the background files on a thread of its own.
std::atomic<long> failAfter{-1};
std::atomic<long> liveAllocations{0};
}  // namespace

void* operator new(std::size_t size) {
    long left = failAfter.load();
    while (left > 0 && !failAfter.compare_exchange_weak(left, left - 1)) {
    }
    if (left == 0) throw std::bad_alloc();
    void* block = std::malloc(size ? size : 1);
    if (!block) throw std::bad_alloc();
    ++liveAllocations;
    return block;
}
void operator delete(void* block) noexcept {
    if (!block) return;
    --liveAllocations;
    std::free(block);
}
void operator delete(void* block, std::size_t) noexcept { operator delete(block); }

namespace {

// A 24-bit picture whose pixels all differ from their neighbours, so a rectangle copied from
// the wrong place shows.
std::string PatternBmpFile(int width, int height) {
    std::string file = SolidBmpFile(width, height, {0, 0, 0});
    const std::size_t stride = (static_cast<std::size_t>(width) * 3 + 3) & ~std::size_t{3};
    const std::size_t pixels = file.size() - stride * static_cast<std::size_t>(height);
    for (int row = 0; row < height; ++row) {
        for (int x = 0; x < width; ++x) {
            char* p = &file[pixels + static_cast<std::size_t>(row) * stride + x * 3];
            p[0] = static_cast<char>(x * 7 + row * 3);
            p[1] = static_cast<char>(x ^ row);
            p[2] = static_cast<char>(row * 5 + x);
        }
    }
    return file;
}

// A pixel of a picture block, counted from the top (24-bit: its colour; 8-bit: its value in b).
Rgb PixelOf(const DibBitmap* picture, int x, int y) {
    const std::uint8_t* rows = nullptr;
    std::uint32_t stride = 0;
    std::uint16_t depth = 0;
    std::int32_t width = 0, height = 0;
    if (!DibRowInfo(picture, rows, stride, depth) || !DibDimensions(picture, width, height)) {
        return {0, 0, 0};
    }
    const std::uint8_t* p = rows + static_cast<std::size_t>(height - 1 - y) * stride + x * (depth / 8);
    return depth == 8 ? Rgb{0, 0, p[0]} : Rgb{p[2], p[1], p[0]};
}

// The compositing rule written out plainly, pixel by pixel.
Rgb Composite(Rgb a, Rgb b, std::uint8_t m) {
    if (m == 0) return b;
    if (m == 255) return a;
    auto mix = [m](int x, int y) { return static_cast<std::uint8_t>((x * m + y * (255 - m)) >> 8); };
    return {mix(a.r, b.r), mix(a.g, b.g), mix(a.b, b.b)};
}

// A 32-bit top-down memory surface a button draws into.
class Surface {
public:
    Surface(int width, int height) : width_(width) {
        BITMAPINFO info = TopDownInfo(width, height);
        dc_ = CreateCompatibleDC(nullptr);
        bitmap_ = CreateDIBSection(dc_, &info, DIB_RGB_COLORS, &bits_, nullptr, 0);
        previous_ = SelectObject(dc_, bitmap_);
    }
    ~Surface() {
        SelectObject(dc_, previous_);
        DeleteObject(bitmap_);
        DeleteDC(dc_);
    }
    HDC Dc() const { return dc_; }
    Rgb At(int x, int y) const {
        GdiFlush();
        const auto* p = static_cast<const std::uint8_t*>(bits_) + (y * width_ + x) * 4;
        return {p[2], p[1], p[0]};
    }

private:
    int width_;
    HDC dc_;
    HBITMAP bitmap_;
    HGDIOBJ previous_;
    void* bits_ = nullptr;
};

LRESULT CALLBACK ParentProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    return DefWindowProcW(window, message, wParam, lParam);
}

BOOL CALLBACK CountWindow(HWND, LPARAM count) {
    ++*reinterpret_cast<int*>(count);
    return TRUE;
}

// A button window's procedure, counting the show messages it gets.
int showMessages = 0;
WNDPROC buttonProc = nullptr;
LRESULT CALLBACK CountingButtonProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_SHOWWINDOW) ++showMessages;
    return CallWindowProcW(buttonProc, window, message, wParam, lParam);
}

class MenuTest : public testing::Test {
protected:
    void SetUp() override {
        ResetLauncherConfiguration();
        DeleteMachineKey(kProductKeyPath);
        DeleteMachineKey(kLocaleKeyPath);
        wcscpy_s(launcher.rootPath, disc.Path().c_str());
        disc.WriteFile(FindLanguage(kUsEnglish)->backgroundFile, PatternBmpFile(640, 480));
        LoadCatalogue();
        WNDCLASSW parentClass{};
        parentClass.lpfnWndProc = ParentProc;
        parentClass.hInstance = launcher.instance;
        parentClass.lpszClassName = L"MenuTestParent";
        RegisterClassW(&parentClass);
        parent = CreateWindowExW(0, L"MenuTestParent", L"", WS_POPUP | WS_VISIBLE, 0, 0, 640, 480,
                                 nullptr, nullptr, launcher.instance, nullptr);
        launcher.mainWindow = parent;
        launcher.openPanel = kNoPanel;
        launcher.languageBase = kUsEnglish;
        launcher.languageKnown = true;
        launcher.discSku = 1;
    }
    void TearDown() override {
        menu->DestroyAllButtons();
        DestroyWindow(parent);
        launcher.mainWindow = nullptr;
        ReleaseCatalogue();
        DeleteMachineKey(kProductKeyPath);
        DeleteMachineKey(kLocaleKeyPath);
    }

    // A controller as start-up makes it.
    void Fresh() {
        menu->DestroyAllButtons();
        menu = std::make_unique<MenuController>();
    }
    LauncherButton* Button(std::uint32_t id) {
        for (const auto& button : menu->allButtons) {
            if (button->id == id) return button.get();
        }
        return nullptr;
    }
    std::vector<std::uint32_t> Ids(std::int32_t page, bool onlyVisible = false) {
        std::vector<std::uint32_t> ids;
        for (LauncherButton* button : menu->pages[static_cast<std::size_t>(page)]) {
            if (!onlyVisible || button->visible) ids.push_back(button->id);
        }
        return ids;
    }
    int ChildWindows() {
        int count = 0;
        EnumChildWindows(parent, CountWindow, reinterpret_cast<LPARAM>(&count));
        return count;
    }
    // The state a paint leaves: the working copy holds the pristine background.
    void Repaint() { CopyDibPixels(launcher.workingBackground.get(), BackgroundFor(kUsEnglish)); }

    TempFolder disc;
    HWND parent = nullptr;
    std::unique_ptr<MenuController> menu = std::make_unique<MenuController>();
};

TEST_F(MenuTest, ShowCallsShowWindowOnlyOnAChangeAndSetWantedSaysWhetherItChanged) {
    LauncherButton button(parent, 0, 601, 0, 10, 10, 209, 49, false, kActiveLanguage);
    buttonProc = reinterpret_cast<WNDPROC>(SetWindowLongPtrW(
        button.window, GWLP_WNDPROC, reinterpret_cast<LONG_PTR>(CountingButtonProc)));
    showMessages = 0;
    button.Show(true);
    button.Show(true);
    EXPECT_EQ(showMessages, 1);
    EXPECT_TRUE(GetWindowLongW(button.window, GWL_STYLE) & WS_VISIBLE);
    button.Show(false);
    EXPECT_EQ(showMessages, 2);
    EXPECT_FALSE(button.SetWanted(true)) << "wanted from the start";
    EXPECT_TRUE(button.SetWanted(false));
    EXPECT_FALSE(button.SetWanted(false));
}

TEST_F(MenuTest, ACircularButtonIsHitStrictlyInsideItsCircleOnTheScreen) {
    VemoLauncherButton button(parent, 0, 101, 1, 186, 162, 85, 96, true, kActiveLanguage);
    POINT origin{0, 0};
    ClientToScreen(parent, &origin);
    const int cx = origin.x + 186 + 40, cy = origin.y + 162 + 50;
    EXPECT_FALSE(button.HitTest(cx, cy)) << "no circle before SetCircle";
    button.SetCircle(40, 50, 35);
    EXPECT_TRUE(button.HitTest(cx, cy));
    EXPECT_TRUE(button.HitTest(cx + 34, cy));
    EXPECT_FALSE(button.HitTest(cx + 35, cy)) << "a point at the radius is outside";
    EXPECT_FALSE(button.HitTest(cx, cy - 35));
    EXPECT_TRUE(button.IsShaped());
    LauncherButton plate(parent, 0, 601, 0, 10, 10, 209, 49, true, kActiveLanguage);
    EXPECT_FALSE(plate.IsShaped());
    EXPECT_TRUE(plate.HitTest(-5000, -5000));
}

TEST_F(MenuTest, ButtonsDrawTheirFaceCompositedOverTheBackgroundByThePlainRule) {
    struct Case {
        bool circular;
        std::int32_t image;
        std::int32_t x, y, width, height;
        std::uint32_t itemState;
        int state;
    };
    const Case cases[] = {
        {false, 4, 416, 28, 209, 49, 0, 0},       // information plate, normal
        {false, 9, 295, 19, 209, 49, 0x0011, 1},  // play plate, pressed
        {true, 0, 186, 162, 85, 96, 0x0010, 2},   // Install, focused
        {true, 10, 405, 411, 54, 54, 0, 0},       // Exit, normal
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(testing::Message() << "image " << c.image << " state " << c.state);
        Repaint();
        std::unique_ptr<LauncherButton> button;
        if (c.circular) {
            button = std::make_unique<VemoLauncherButton>(parent, c.image, 1, 0, c.x, c.y, c.width,
                                                          c.height, true, kActiveLanguage);
        } else {
            // No label, so that every pixel is the face's.
            button = std::make_unique<LauncherButton>(parent, c.image, 1, 0, c.x, c.y, c.width,
                                                      c.height, true, kActiveLanguage);
        }
        Surface surface(c.width, c.height);
        button->DrawItem(surface.Dc(), c.itemState);
        EXPECT_EQ(button->lastState, c.state);
        const DibBitmap* face = c.circular ? IconPictureFor(c.state, c.image) : PlateFor(c.state, c.image);
        const DibBitmap* mask = c.circular ? IconMaskFor(c.state, c.image) : catalogue.opaqueMask.get();
        const DibBitmap* background = BackgroundFor(kUsEnglish);
        int wrong = 0;
        for (int y = 0; y < c.height; ++y) {
            for (int x = 0; x < c.width; ++x) {
                Rgb expected = Composite(PixelOf(face, x, y), PixelOf(background, c.x + x, c.y + y),
                                         PixelOf(mask, x, y).b);
                if (surface.At(x, y) != expected) ++wrong;
            }
        }
        EXPECT_EQ(wrong, 0);
    }
}

TEST_F(MenuTest, ACircularButtonBackFromItsHoverFaceShowsNothingOfIt) {
    VemoLauncherButton button(parent, 0, 101, 1, 186, 162, 85, 96, true, kActiveLanguage);
    Repaint();
    Surface first(85, 96), hovered(85, 96), after(85, 96);
    button.DrawItem(first.Dc(), 0);
    button.DrawItem(hovered.Dc(), 0x0010);
    button.DrawItem(after.Dc(), 0);
    int changedByHover = 0, left = 0;
    for (int y = 0; y < 96; ++y) {
        for (int x = 0; x < 85; ++x) {
            if (hovered.At(x, y) != first.At(x, y)) ++changedByHover;
            if (after.At(x, y) != first.At(x, y)) ++left;
        }
    }
    EXPECT_GT(changedByHover, 500);
    EXPECT_EQ(left, 0) << "pixels of the hover face stayed behind";
}

TEST_F(MenuTest, ALatchedButtonDrawsLatchedAndAPlateWithoutALatchedFaceShowsItsNormalFace) {
    VemoLauncherButton opener(parent, 9, 108, 8, 372, 323, 73, 87, true, kActiveLanguage);
    opener.latched = true;
    Surface surface(73, 87);
    opener.DrawItem(surface.Dc(), 0x0011);
    EXPECT_EQ(opener.lastState, kLatched);
    LauncherButton plate(parent, 4, 303, 0, 416, 28, 209, 49, true, kActiveLanguage);
    plate.latched = true;
    Repaint();
    Surface latched(209, 49);
    plate.DrawItem(latched.Dc(), 0);
    Repaint();
    plate.latched = false;
    Surface normal(209, 49);
    plate.DrawItem(normal.Dc(), 0);
    EXPECT_EQ(latched.At(100, 5), normal.At(100, 5));
    // No face at all (an index without pictures): nothing is drawn and nothing breaks.
    VemoLauncherButton faceless(parent, 40, 1, 0, 0, 0, 50, 50, true, kActiveLanguage);
    Surface untouched(50, 50);
    faceless.DrawItem(untouched.Dc(), 0);
    EXPECT_EQ(untouched.At(25, 25), (Rgb{0, 0, 0}));
}

TEST_F(MenuTest, EachEditionBuildsItsLanguageListWithPlatesInOrderAndAHiddenAbout) {
    struct Edition {
        std::uint32_t discSku;
        std::uint32_t productSku;  // what the list stands for
        std::vector<std::uint32_t> ids;
        LanguageBase settled;
    };
    const Edition editions[] = {
        {1, 1, {500, 506}, kNoLanguage},
        {2, 2, {508, 501, 502, 512, 503, 504, 506, 505, 519, 514, 515, 513}, kNoLanguage},
        {3, 8, {509, 511, 518, 500}, kNoLanguage},
        {4, 9, {510, 500}, kNoLanguage},
        {5, 5, {}, kJapanese},
        {6, 1, {514, 515, 513, 519}, kNoLanguage},
        {0, 7, {}, kUsEnglish},
        {9, 7, {}, kUsEnglish},
    };
    for (const Edition& edition : editions) {
        SCOPED_TRACE(edition.discSku);
        Fresh();
        launcher.discSku = edition.discSku;
        launcher.productSku = 7;
        launcher.languageBase = kNoLanguage;
        launcher.languageKnown = false;
        menu->BuildLanguageList(parent);
        EXPECT_EQ(launcher.productSku, edition.productSku);
        EXPECT_EQ(launcher.languageBase, edition.settled);
        EXPECT_EQ(launcher.languageKnown, edition.settled != kNoLanguage);
        std::vector<std::uint32_t> ids = Ids(LanguagePage);
        ASSERT_FALSE(ids.empty());
        EXPECT_EQ(ids.back(), 1000u) << "the list ends with its About button";
        ids.pop_back();
        EXPECT_EQ(ids, edition.ids);
        const auto& page = menu->pages[LanguagePage];
        for (std::size_t i = 0; i + 1 < page.size(); ++i) {
            EXPECT_EQ(page[i]->imageIndex, static_cast<std::int32_t>(11 + i));
            // Each name in its own language and font.
            EXPECT_EQ(page[i]->labelLanguage, *LanguageOfCommand(page[i]->id));
            EXPECT_EQ(page[i]->label.empty(), false);
        }
        LauncherButton* about = page.back();
        EXPECT_EQ(about->imageIndex, 12);
        EXPECT_FALSE(about->wanted);
        EXPECT_EQ(about->x, 9);
        EXPECT_EQ(about->y, 346);
    }
}

struct MainRow {
    std::uint32_t id;
    std::int32_t image;
    const wchar_t* label;
    RECT place;  // left, top, width, height
    HitCircle circle;
};

TEST_F(MenuTest, TheMainPageHasItsDocumentedButtonsInEveryEdition) {
    const MainRow about{1000, 11, L"Install", {9, 346, 162, 117}, {74, 54, 60}};
    const MainRow install{101, 0, L"Install", {186, 162, 85, 96}, {40, 50, 35}};
    const MainRow play{102, 1, L"Play", {186, 162, 85, 96}, {40, 50, 35}};
    const MainRow games{103, 7, L"More Vemo Games", {330, 268, 73, 79}, {33, 42, 29}};
    const MainRow web{107, 6, L"Visit www.vemo.example", {272, 225, 66, 67}, {29, 31, 31}};
    const MainRow info{108, 9, L"More Information", {372, 323, 73, 87}, {37, 48, 26}};
    const MainRow readme{301, 9, L"Readme", {372, 323, 73, 87}, {37, 48, 26}};
    const MainRow exit{110, 10, L"Exit", {405, 411, 54, 54}, {26, 25, 23}};
    struct Menu {
        std::uint32_t discSku, productSku;
        LanguageBase base;
        std::vector<MainRow> rows;
    };
    const Menu menus[] = {
        {1, 1, kUsEnglish, {about, install, play, games, web, info, exit}},
        {2, 2, kUsEnglish, {about, install, play, web, info, exit}},
        {1, 5, kUsEnglish, {about, install, play, games, web, readme, exit}},
        {1, 4, kUsEnglish, {about, install, play, games, web, readme, exit}},
        {1, 3, kUsEnglish, {about, install, play, games, web, info, exit}},
    };
    for (const Menu& m : menus) {
        SCOPED_TRACE(testing::Message() << "disc " << m.discSku << " product " << m.productSku);
        Fresh();
        launcher.discSku = m.discSku;
        launcher.productSku = m.productSku;
        menu->BuildMainMenu(parent);
        const auto& page = menu->pages[MainPage];
        ASSERT_EQ(page.size(), m.rows.size());
        for (std::size_t i = 0; i < page.size(); ++i) {
            SCOPED_TRACE(m.rows[i].id);
            auto* button = static_cast<VemoLauncherButton*>(page[i]);
            EXPECT_EQ(button->id, m.rows[i].id);
            EXPECT_EQ(button->imageIndex, m.rows[i].image);
            EXPECT_EQ(button->label, m.rows[i].label);
            EXPECT_EQ(button->x, m.rows[i].place.left);
            EXPECT_EQ(button->y, m.rows[i].place.top);
            EXPECT_EQ(button->width, m.rows[i].place.right);
            EXPECT_EQ(button->height, m.rows[i].place.bottom);
            EXPECT_EQ(button->centerX, m.rows[i].circle.centerX);
            EXPECT_EQ(button->centerY, m.rows[i].circle.centerY);
            EXPECT_EQ(button->radius, m.rows[i].circle.radius);
            EXPECT_TRUE(button->IsShaped());
        }
        EXPECT_EQ(page[static_cast<std::size_t>(menu->installIndex)]->id, 101u);
        EXPECT_EQ(page[static_cast<std::size_t>(menu->playIndex)]->id, 102u);
        EXPECT_EQ(page[static_cast<std::size_t>(menu->infoIndex)]->imageIndex, 9);
        EXPECT_EQ(menu->gamesIndex, m.discSku == 2 ? -1 : 3);
        // Not installed: only Install is wanted.
        EXPECT_TRUE(page[1]->wanted);
        EXPECT_FALSE(page[2]->wanted);
        EXPECT_EQ(Ids(InfoPanel), (std::vector<std::uint32_t>{303, 302, 301}));
        const std::vector<std::uint32_t> demos =
            m.discSku == 2 ? std::vector<std::uint32_t>{} : std::vector<std::uint32_t>{601, 602, 603};
        EXPECT_EQ(Ids(GamesPanel), demos);
        EXPECT_EQ(Ids(PlayPanel), (std::vector<std::uint32_t>{150, 151, 152}));
    }
}

TEST_F(MenuTest, PanelPlatesHaveTheirPicturesPlacesAndLabels) {
    menu->BuildMainMenu(parent);
    struct Plate {
        std::uint32_t id;
        std::int32_t image, x, y;
        const wchar_t* label;
    };
    const Plate plates[] = {
        {303, 4, 416, 28, L"Electronic Registration"}, {302, 5, 416, 81, L"Trivex"},
        {301, 6, 416, 133, L"Readme"},                 {601, 0, 416, 29, L"The Vemo 2 PC"},
        {602, 1, 416, 81, L"The Vemo 2 Duskaro"},      {603, 2, 416, 133, L"The Vemo 2 Lorrel"},
        {150, 9, 295, 19, L"The Vemo 800x600"},        {151, 8, 295, 71, L"The Vemo 1024x768"},
        {152, 10, 295, 123, L"The Vemo Creator"},
    };
    for (const Plate& plate : plates) {
        SCOPED_TRACE(plate.id);
        LauncherButton* button = Button(plate.id);
        ASSERT_TRUE(button);
        EXPECT_FALSE(button->IsShaped());
        EXPECT_EQ(button->imageIndex, plate.image);
        EXPECT_EQ(button->x, plate.x);
        EXPECT_EQ(button->y, plate.y);
        EXPECT_EQ(button->width, 209);
        EXPECT_EQ(button->height, 49);
        EXPECT_EQ(button->label, plate.label);
        EXPECT_FALSE(button->visible);
    }
    // The Play picture by language.
    const std::pair<LanguageBase, std::int32_t> pictures[] = {
        {kFrench, 4}, {kGerman, 2}, {kSpanish, 5}, {kJapanese, 3}, {kUkEnglish, 1}, {kPolish, 1}};
    for (auto [base, image] : pictures) {
        SCOPED_TRACE(base);
        Fresh();
        launcher.languageBase = base;
        menu->BuildMainMenu(parent);
        EXPECT_EQ(Button(102)->imageIndex, image);
    }
    // Edition 4 in Polish keeps More Information; in any other language Readme takes its place.
    Fresh();
    launcher.productSku = 4;
    launcher.languageBase = kPolish;
    menu->BuildMainMenu(parent);
    EXPECT_EQ(menu->pages[MainPage][static_cast<std::size_t>(menu->infoIndex)]->id, 108u);
}

TEST_F(MenuTest, PanelsOpenCloseAndSwitchWithTheirButtons) {
    menu->StartMainMenu(parent);
    EXPECT_EQ(Ids(MainPage, true), (std::vector<std::uint32_t>{1000, 101, 103, 107, 108, 110}));
    menu->ShowPage(-1);
    menu->ShowPage(InfoPanel);
    EXPECT_TRUE(Ids(InfoPanel, true).empty()) << "a panel shows only while it is open";

    menu->OnCommand(kCmdInfoPanel);
    EXPECT_EQ(launcher.openPanel, 1u);
    EXPECT_TRUE(Button(108)->latched);
    EXPECT_EQ(Ids(InfoPanel, true), (std::vector<std::uint32_t>{303, 302, 301}));

    menu->OnCommand(kCmdGamesPanel);  // another panel button switches panels
    EXPECT_EQ(launcher.openPanel, 2u);
    EXPECT_FALSE(Button(108)->latched);
    EXPECT_TRUE(Button(103)->latched);
    EXPECT_TRUE(Ids(InfoPanel, true).empty());
    EXPECT_EQ(Ids(GamesPanel, true), (std::vector<std::uint32_t>{601, 602, 603}));

    menu->OnCommand(kCmdGamesPanel);  // its own button closes it
    EXPECT_EQ(launcher.openPanel, kNoPanel);
    EXPECT_FALSE(menu->panelOpen);
    EXPECT_FALSE(Button(103)->latched);
    EXPECT_TRUE(Ids(GamesPanel, true).empty());

    menu->OnCommand(kCmdInfoPanel);
    menu->OnCommand(kCmdExit + 1000);  // an id no button carries changes nothing
    EXPECT_TRUE(menu->panelOpen);
    EXPECT_EQ(Ids(MainPage, true).size(), 6u);
}

TEST_F(MenuTest, ALanguageButtonHidesTheListBuildsTheMenuInThatLanguageOnceAndWritesItsLocale) {
    launcher.languageBase = kNoLanguage;
    launcher.languageKnown = false;
    launcher.discSku = 2;
    menu->StartLanguageList(parent);
    EXPECT_EQ(Ids(LanguagePage, true).size(), 12u);
    menu->OnCommand(502);  // Deutsch
    EXPECT_EQ(launcher.languageBase, kGerman);
    EXPECT_TRUE(Ids(LanguagePage, true).empty());
    EXPECT_EQ(Button(101) ? Button(101)->label : L"", L"Installieren");
    EXPECT_EQ(MachineText(kLocaleKeyPath, L""), std::optional<std::wstring>(L"de"));
    const std::size_t buttons = menu->allButtons.size();
    menu->OnCommand(501);  // the choice is made once
    EXPECT_EQ(launcher.languageBase, kGerman);
    EXPECT_EQ(menu->allButtons.size(), buttons);
    // Both About buttons share id 1000: the list's, created first, is the one drawn.
    Surface surface(162, 117);
    menu->DrawButton(surface.Dc(), 1000, 0);
    EXPECT_EQ(menu->pages[LanguagePage].back()->lastState, kNormal);
    EXPECT_EQ(menu->pages[MainPage][0]->lastState, kNotDrawn);
    menu->DrawButton(surface.Dc(), 4242, 0);  // no button: nothing happens
}

TEST_F(MenuTest, DestroyingAllButtonsTwiceLeavesNothing) {
    menu->StartMainMenu(parent);
    menu->installPath = L"C:\\Games";
    ASSERT_GT(ChildWindows(), 0);
    menu->DestroyAllButtons();
    menu->DestroyAllButtons();
    EXPECT_TRUE(menu->allButtons.empty());
    EXPECT_TRUE(menu->buttonsByWindow.empty());
    for (const auto& page : menu->pages) EXPECT_TRUE(page.empty());
    EXPECT_TRUE(menu->installPath.empty());
    EXPECT_EQ(ChildWindows(), 0);
}

TEST_F(MenuTest, AScreenBuiltWhileMemoryRunsOutKeepsWhatItBuiltAndLeaksNothing) {
    {
        // Whatever the process sets up once, it sets up here, outside the counted runs.
        MenuController warmUp;
        warmUp.StartMainMenu(parent);
    }
    bool completed = false;
    for (long allowed = 0; !completed && allowed < 2000; ++allowed) {
        SCOPED_TRACE(allowed);
        const long before = liveAllocations;
        int windows = 0;
        std::size_t registered = 0;
        bool consistent = true;
        {
            MenuController partial;
            failAfter = allowed;
            partial.StartMainMenu(parent);
            completed = failAfter > 0;
            failAfter = -1;
            registered = partial.allButtons.size();
            windows = ChildWindows();
            for (const auto& button : partial.allButtons) {
                consistent &= IsWindow(button->window) &&
                              partial.ButtonForWindow(button->window) == button.get();
            }
            std::size_t inPages = 0;
            for (const auto& page : partial.pages) inPages += page.size();
            consistent &= inPages == registered && partial.buttonsByWindow.size() == registered;
        }
        const long leaked = liveAllocations - before;
        EXPECT_TRUE(consistent);
        EXPECT_EQ(windows, static_cast<int>(registered)) << "a window without its button";
        EXPECT_EQ(leaked, 0) << "memory left behind";
        EXPECT_EQ(ChildWindows(), 0);
    }
    EXPECT_TRUE(completed);
}

}  // namespace

namespace {

TEST_F(MenuTest, TheGameCountsAsInstalledWithItsValuesAndAProgramThatOpens) {
    TempFolder game;
    const std::wstring folder = game.Path().substr(0, game.Path().size() - 1);
    game.WriteFile(L"Vemo.exe", "MZ");
    // A real game folder of 251 characters: its program's path does not fit 260 characters.
    std::wstring tooLong = folder;
    while (tooLong.size() < 251) {
        tooLong += L"\\" + std::wstring(std::min<std::size_t>(60, 250 - tooLong.size()), L'x');
        CreateDirectoryW((L"\\\\?\\" + tooLong).c_str(), nullptr);
    }
    const HANDLE deep = CreateFileW((L"\\\\?\\" + tooLong + L"\\Vemo.exe").c_str(), GENERIC_WRITE, 0,
                                    nullptr, CREATE_ALWAYS, 0, nullptr);
    ASSERT_NE(deep, INVALID_HANDLE_VALUE) << "cannot make a long game folder here";
    CloseHandle(deep);
    struct Row {
        const char* name;
        bool version, marker;
        const std::wstring* data;
        bool dataAsNumber;
        bool installed;
    };
    const Row rows[] = {
        {"no product key", false, false, nullptr, false, false},
        {"everything", true, true, &folder, false, true},
        {"no Version", false, true, &folder, false, false},
        {"no EP8Installed", true, false, &folder, false, false},
        {"no VEMO_DATA", true, true, nullptr, false, false},
        {"VEMO_DATA not a text", true, true, &folder, true, false},
        {"VEMO_DATA too long", true, true, &tooLong, false, false},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.name);
        Fresh();
        std::unique_ptr<ScopedMachineKey> key;
        if (row.version || row.marker || row.data) {
            key = std::make_unique<ScopedMachineKey>(kProductKeyPath);
            if (row.version) key->SetText(L"Version", L"1.0");
            if (row.marker) key->SetDword(L"EP8Installed", 1);
            if (row.data && row.dataAsNumber) key->SetDword(L"VEMO_DATA", 7);
            if (row.data && !row.dataAsNumber) key->SetText(L"VEMO_DATA", *row.data);
        }
        menu->CheckInstallation();
        EXPECT_EQ(menu->installed, row.installed);
        if (row.installed) {
            EXPECT_EQ(menu->installPath, folder);
        }
    }
}

TEST_F(MenuTest, InstallAndPlayFollowTheInstallationWhileTheLauncherRuns) {
    TempFolder game;
    const std::wstring folder = game.Path().substr(0, game.Path().size() - 1);
    const std::wstring program = game.WriteFile(L"Vemo.exe", "MZ");
    menu->StartMainMenu(parent);
    EXPECT_TRUE(Button(101)->visible);
    EXPECT_FALSE(Button(102)->visible);

    ScopedMachineKey key(kProductKeyPath);
    key.SetText(L"Version", L"1.0");
    key.SetDword(L"EP8Installed", 1);
    key.SetText(L"VEMO_DATA", folder);
    menu->Refresh();
    EXPECT_FALSE(Button(101)->visible);
    EXPECT_TRUE(Button(102)->visible);
    EXPECT_EQ(menu->installPath, folder) << "a play command right after needs the folder";

    // Once seen, the marker's removal alone does not uninstall the game.
    RegDeleteValueW(key.Get(), L"EP8Installed");
    menu->CheckInstallation();
    EXPECT_TRUE(menu->installed);
    EXPECT_TRUE(Button(102)->visible);

    // The game's program deleted: Install comes back, and the play commands start nothing.
    ASSERT_TRUE(DeleteFileW(program.c_str()));
    menu->CheckInstallation();
    EXPECT_FALSE(menu->installed);
    EXPECT_TRUE(Button(101)->visible);
    EXPECT_FALSE(Button(102)->visible);
    EXPECT_FALSE(Button(101)->visible && Button(102)->visible);
}

TEST_F(MenuTest, BeforeTheMainMenuExistsTheCheckChangesNoButton) {
    TempFolder game;
    game.WriteFile(L"Vemo.exe", "MZ");
    ScopedMachineKey key(kProductKeyPath);
    key.SetText(L"Version", L"1.0");
    key.SetDword(L"EP8Installed", 1);
    key.SetText(L"VEMO_DATA", game.Path().substr(0, game.Path().size() - 1));
    launcher.languageKnown = false;
    launcher.languageBase = kNoLanguage;
    menu->StartLanguageList(parent);
    EXPECT_TRUE(menu->installed);
    EXPECT_EQ(menu->installIndex, -1);
    EXPECT_EQ(Ids(LanguagePage, true), (std::vector<std::uint32_t>{500, 506}));
}

}  // namespace
