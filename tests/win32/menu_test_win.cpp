// The picture buttons and the menu controller in this process, against the real registry.
#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
#include <new>
#include <tuple>

#include "graphics/masked_blend.h"
#include "locale/catalogue_win.h"
#include "locale/config_win.h"
#include "locale/picture_ids.h"
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
void operator delete(void* block, std::size_t) noexcept {
    operator delete(block);
}

namespace {

// The compositing rule written out plainly, pixel by pixel.
Rgb Composite(Rgb a, Rgb b, std::uint8_t m) {
    if (m == 0) return b;
    if (m == 255) return a;
    auto mix = [m](int x, int y) {
        return static_cast<std::uint8_t>((x * m + y * (255 - m)) >> 8);
    };
    return {mix(a.r, b.r), mix(a.g, b.g), mix(a.b, b.b)};
}

BOOL CALLBACK CountWindow(HWND, LPARAM count) {
    ++*reinterpret_cast<int*>(count);
    return TRUE;
}

class MenuTest : public DiscTest {
  protected:
    void SetUp() override {
        DiscTest::SetUp();
        // Pixels that differ from their neighbours, so a rectangle copied from the wrong place
        // shows.
        disc.WriteFile(FindLanguage(kUsEnglish)->backgroundFile,
                       BmpFile(640, 480, 24, [](int x, int y) {
                           return Rgb{std::uint8_t(y * 5 + x), std::uint8_t(x ^ y),
                                      std::uint8_t(x * 7 + y * 3)};
                       }));
        LoadCatalogue();
        WNDCLASSW parentClass{};
        parentClass.lpfnWndProc = DefWindowProcW;
        parentClass.hInstance = launcher.instance;
        parentClass.lpszClassName = L"MenuTestParent";
        RegisterClassW(&parentClass);
        parent = CreateWindowExW(0, L"MenuTestParent", L"", WS_POPUP | WS_VISIBLE, 0, 0, 640, 480,
                                 nullptr, nullptr, launcher.instance, nullptr);
        launcher.mainWindow = parent;
        launcher.languageBase = kUsEnglish;
        launcher.languageKnown = true;
        launcher.discSku = 1;
    }
    void TearDown() override {
        menu->DestroyAllButtons();
        DestroyWindow(parent);
        launcher.mainWindow = nullptr;
        DiscTest::TearDown();
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
    int ChildWindows() {
        int count = 0;
        EnumChildWindows(parent, CountWindow, reinterpret_cast<LPARAM>(&count));
        return count;
    }
    // The state a paint leaves: the working copy holds the pristine background.
    void Repaint() { CopyDibPixels(launcher.workingBackground.get(), BackgroundFor(kUsEnglish)); }

    HWND parent = nullptr;
    std::unique_ptr<MenuController> menu = std::make_unique<MenuController>();
};

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
        // No label, so that every pixel is the face's.
        std::unique_ptr<LauncherButton> button(
            c.circular ? new VemoLauncherButton(parent, c.image, 1, 0, c.x, c.y, c.width, c.height,
                                                true, kActiveLanguage)
                       : new LauncherButton(parent, c.image, 1, 0, c.x, c.y, c.width, c.height,
                                            true, kActiveLanguage));
        Surface surface(c.width, c.height);
        button->DrawItem(surface.Dc(), c.itemState);
        EXPECT_EQ(button->lastState, c.state);
        const DibBitmap* face =
            c.circular ? IconPictureFor(c.state, c.image) : PlateFor(c.state, c.image);
        const DibBitmap* mask =
            c.circular ? IconMaskFor(c.state, c.image) : catalogue.opaqueMask.get();
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

TEST_F(MenuTest, ALatchedPlateShowsItsNormalFaceAndAButtonWithoutPicturesDrawsNothing) {
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

// Which buttons each screen shows, where and with which labels, is checked on the real
// launcher; here that each button takes the picture and hit circle of its layout entry.
TEST_F(MenuTest, EachButtonTakesThePictureAndHitCircleOfItsLayout) {
    std::vector<PanelButtonLayout> plates = InfoPanelButtons();
    for (const auto& more : {GamesPanelButtons(), PlayPanelButtons()}) {
        plates.insert(plates.end(), more.begin(), more.end());
    }
    for (LanguageBase base : {kUsEnglish, kFrench}) {  // the Play picture follows the language
        SCOPED_TRACE(base);
        Fresh();
        launcher.languageBase = base;
        menu->BuildMainMenu(parent);
        for (const MainButtonLayout& item :
             MainPageButtons(launcher.discSku, launcher.productSku, base)) {
            SCOPED_TRACE(item.button.id);
            LauncherButton* button = Button(item.button.id);
            ASSERT_TRUE(button && button->IsShaped());
            EXPECT_EQ(button->imageIndex, item.button.imageIndex);
            const auto* circular = static_cast<VemoLauncherButton*>(button);
            const HitCircle& circle = item.button.circle;
            EXPECT_EQ(std::make_tuple(circular->centerX, circular->centerY, circular->radius),
                      std::make_tuple(circle.centerX, circle.centerY, circle.radius));
        }
        for (const PanelButtonLayout& item : plates) {
            SCOPED_TRACE(item.id);
            ASSERT_TRUE(Button(item.id));
            EXPECT_FALSE(Button(item.id)->IsShaped());
            EXPECT_EQ(Button(item.id)->imageIndex, PanelSlotFor(item.page, item.slot)->imageIndex);
        }
    }
    // The language list's plates in order, each name drawn in its own language's font, and the
    // list's own About button.
    Fresh();
    launcher.discSku = 2;
    launcher.languageBase = kNoLanguage;
    launcher.languageKnown = false;
    menu->BuildLanguageList(parent);
    const auto& page = menu->pages[LanguagePage];
    ASSERT_EQ(page.size(), 13u);
    for (std::size_t i = 0; i + 1 < page.size(); ++i) {
        SCOPED_TRACE(page[i]->id);
        EXPECT_EQ(page[i]->imageIndex, static_cast<std::int32_t>(kFirstListPlate + i));
        EXPECT_EQ(page[i]->labelLanguage, *LanguageOfCommand(page[i]->id));
    }
    EXPECT_EQ(page.back()->imageIndex, kListAboutIconKey);
}

TEST_F(MenuTest, OnTheListTheCheckChangesNoButtonALanguageIsChosenOnceAndItsAboutIsDrawn) {
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
    for (LauncherButton* button : menu->pages[LanguagePage]) {
        EXPECT_EQ(button->visible, button->id != 1000) << button->id;  // 500 and 506
    }
    menu->OnCommand(506);  // Español
    ASSERT_EQ(launcher.languageBase, kSpanish);
    const std::size_t buttons = menu->allButtons.size();
    menu->OnCommand(500);  // the choice is made once
    EXPECT_EQ(launcher.languageBase, kSpanish);
    EXPECT_EQ(menu->allButtons.size(), buttons);
    // Both About buttons share id 1000: the list's, created first, is the one drawn.
    Surface surface(162, 117);
    menu->DrawButton(surface.Dc(), 1000, 0);
    EXPECT_EQ(menu->pages[LanguagePage].back()->lastState, kNormal);
    EXPECT_EQ(menu->pages[MainPage][0]->lastState, kNotDrawn);
    menu->DrawButton(surface.Dc(), 4242, 0);  // no button: nothing happens
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
    const HANDLE deep = CreateFileW((L"\\\\?\\" + tooLong + L"\\Vemo.exe").c_str(), GENERIC_WRITE,
                                    0, nullptr, CREATE_ALWAYS, 0, nullptr);
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
        if (!row.installed) continue;
        EXPECT_EQ(menu->installPath, folder);
        // Once seen, the marker's removal alone does not uninstall the game.
        RegDeleteValueW(key->Get(), L"EP8Installed");
        menu->CheckInstallation();
        EXPECT_TRUE(menu->installed);
    }
}

}  // namespace
