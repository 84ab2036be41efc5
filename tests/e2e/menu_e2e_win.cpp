// The menu as a user meets it on the sample disc: the buttons of each screen, the language
// choice, Install turning into Play, the fold-out panels, the hover look, and what the
// launcher holds and spends while it is used and while it waits. With AUTOPLAY_SCREENSHOT_DIR
// set, the screens are also saved for the README (scripts/screenshots.sh).
#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <cstdio>
#include <optional>
#include <string>
#include <thread>
#include <vector>

#include "e2e_support_win.h"
#include "launcher_driver_win.h"
#include "locale/config_win.h"
#include "sample_disc_win.h"
#include "shell/window_win.h"
#include "test_support_win.h"

namespace {

// Where no button, caption or panel ever is: the mouse rests here between steps.
constexpr POINT kRestPoint{600, 470};

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

// A language button of the list: its language's own name at its place (212 × 50).
struct Listed {
    int id;
    const wchar_t* name;
    int x;
    int y;
};

struct Edition {
    int number;
    std::vector<Listed> languages;
    bool readme;  // the product edition the list stands for puts Readme at More Information
};

const Edition kEditions[] = {
    {1, {{500, L"English", 84, 151}, {506, L"Español", 84, 202}}, false},
    {2,
     {{508, L"Polski", 84, 151},
      {501, L"Français", 84, 202},
      {502, L"Deutsch", 84, 253},
      {512, L"Italiano", 84, 304},
      {503, L"Svenska", 300, 151},
      {504, L"Nederlands", 300, 202},
      {506, L"Español", 300, 253},
      {505, L"Português(BR)", 300, 304},
      {519, L"English", 300, 355},
      {514, L"Norsk", 84, 355},
      {515, L"Suomeksi", 84, 100},
      {513, L"Dansk", 300, 100}},
     false},
    {3,
     {{509, L"繁體中文", 84, 151},
      {511, L"ไทย", 84, 202},
      {518, L"한국어", 84, 253},
      {500, L"English", 84, 304}},
     true},
    {4, {{510, L"简体中文版", 84, 151}, {500, L"English", 84, 202}}, true},
    {6,
     {{514, L"Norsk", 84, 151},
      {515, L"Suomeksi", 84, 202},
      {513, L"Dansk", 84, 253},
      {519, L"English", 84, 304}},
     false},
};

const Edition& EditionNumber(int number) {
    for (const Edition& edition : kEditions) {
        if (edition.number == number) return edition;
    }
    return kEditions[0];
}

// The launcher's own string sets, read from its program file: a label is the string at its
// language's base plus the label's offset.
class LauncherStrings {
  public:
    explicit LauncherStrings(const std::wstring& program)
        : module_(LoadLibraryExW(program.c_str(), nullptr,
                                 LOAD_LIBRARY_AS_DATAFILE | LOAD_LIBRARY_AS_IMAGE_RESOURCE)) {}
    ~LauncherStrings() {
        if (module_) FreeLibrary(module_);
    }
    LauncherStrings(const LauncherStrings&) = delete;
    LauncherStrings& operator=(const LauncherStrings&) = delete;

    std::wstring Get(LanguageBase base, int offset) const {
        wchar_t text[256] = {};
        int length = module_ ? LoadStringW(module_, base + offset, text, 256) : 0;
        return std::wstring(text, static_cast<std::size_t>(std::max(length, 0)));
    }

  private:
    HMODULE module_;
};

// One child window in a form that names everything a user and a screen reader see of it.
std::wstring Describe(const std::wstring& className, int id, const std::wstring& text,
                      const RECT& place, bool shown) {
    return className + L" " + std::to_wstring(id) + L" \"" + text + L"\" at " +
           std::to_wstring(place.left) + L"," + std::to_wstring(place.top) + L" " +
           std::to_wstring(place.right - place.left) + L"x" +
           std::to_wstring(place.bottom - place.top) + (shown ? L" shown" : L" hidden");
}

std::wstring Button(const Documented& button, const std::wstring& text, bool shown) {
    return Describe(L"Button", button.id, text, button.place, shown);
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
void AddLanguageList(std::vector<std::wstring>& expected, const std::vector<Listed>& languages,
                     bool shown, const std::wstring& aboutLabel) {
    for (const Listed& language : languages) {
        expected.push_back(
            Button({language.id, 0, Rect(language.x, language.y, 212, 50)}, language.name, shown));
    }
    expected.push_back(Button(kAbout, aboutLabel, false));
}

struct MainMenu {
    LanguageBase base;
    bool moreGames;  // the More Games button and its panel exist
    bool readme;     // Readme stands at the More Information place
    bool installed;
};

// Every button of the main page and its panels, as they stand with no panel open.
void AddMainMenu(std::vector<std::wstring>& expected, const LauncherStrings& strings,
                 const MainMenu& menu) {
    auto add = [&](const Documented& button, bool shown) {
        expected.push_back(Button(button, strings.Get(menu.base, button.labelOffset), shown));
    };
    add(kAbout, true);
    add(kInstall, !menu.installed);
    add(kPlay, menu.installed);
    if (menu.moreGames) add(kMoreGames, true);
    add(kWebSite, true);
    add(menu.readme ? kReadme : kMoreInformation, true);
    add(kExit, true);
    for (const Documented& plate : kInfoPanel) add(plate, false);
    if (menu.moreGames) {
        for (const Documented& plate : kGamesPanel) add(plate, false);
    }
    for (const Documented& plate : kPlayPanel) add(plate, false);
}

// The ids of the visible panel plates (the only buttons 209 pixels wide), in rising order.
std::vector<int> ShownPlates(HWND launcher) {
    std::vector<int> shown;
    for (const ButtonSeen& button : VisibleButtons(launcher)) {
        if (button.place.right - button.place.left == 209) shown.push_back(button.id);
    }
    std::sort(shown.begin(), shown.end());
    return shown;
}

// A plate is laid over what its place showed before through a mask of 251 or 252, not 255,
// so a plate drawn again after its hover face keeps a trace of it, a few levels at most.
int VisiblyDifferingPixels(const Screenshot& a, const Screenshot& b, const RECT& area) {
    int count = 0;
    for (int y = area.top; y < area.bottom; ++y) {
        for (int x = area.left; x < area.right; ++x) {
            if (ColorDistance(a.At(x, y), b.At(x, y)) > 12) ++count;
        }
    }
    return count;
}

std::vector<int> IdsOf(const std::vector<Documented>& panel) {
    std::vector<int> ids;
    for (const Documented& plate : panel) ids.push_back(plate.id);
    std::sort(ids.begin(), ids.end());
    return ids;
}

// A window of another program that the user switches to: it takes the foreground from a
// thread of its own, which keeps answering messages until the window goes.
class OtherProgramWindow {
  public:
    OtherProgramWindow() : thread_([this] { Run(); }) {}
    ~OtherProgramWindow() {
        stop_ = true;
        thread_.join();
    }
    OtherProgramWindow(const OtherProgramWindow&) = delete;
    OtherProgramWindow& operator=(const OtherProgramWindow&) = delete;

    HWND Get() const { return window_; }

  private:
    void Run() {
        // In a corner, clear of the launcher, so that nothing of the launcher needs a repaint.
        HWND window =
            CreateWindowExW(0, L"STATIC", L"Another program", WS_POPUP | WS_VISIBLE, 0, 0, 120, 80,
                            nullptr, nullptr, GetModuleHandleW(nullptr), nullptr);
        SetForegroundWindow(window);
        window_ = window;
        while (!stop_) {
            MsgWaitForMultipleObjects(0, nullptr, FALSE, 50, QS_ALLINPUT);
            MSG message;
            while (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE)) DispatchMessageW(&message);
        }
        DestroyWindow(window);
    }

    std::atomic<bool> stop_{false};
    std::atomic<HWND> window_{nullptr};
    std::thread thread_;
};

// What the launcher's window reports about the GDI objects and windows it holds; -1 when it
// does not answer.
LRESULT HeldByLauncher(HWND window, WPARAM what) {
    static const UINT message = RegisterWindowMessageW(kGuiObjectCountsMessageName);
    DWORD_PTR answer = 0;
    if (!SendMessageTimeoutW(window, message, what, 0, SMTO_ABORTIFHUNG, 5000, &answer)) return -1;
    return static_cast<LRESULT>(answer);
}

std::string ReadUnixFile(const std::wstring& path) {
    std::string bytes;
    HANDLE file = CreateFileW(path.c_str(), GENERIC_READ, FILE_SHARE_READ | FILE_SHARE_WRITE,
                              nullptr, OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file == INVALID_HANDLE_VALUE) return bytes;
    char chunk[4096];
    DWORD read = 0;
    // The files of /proc report no size: read until there is no more.
    while (bytes.size() < (1u << 20) && ReadFile(file, chunk, sizeof(chunk), &read, nullptr) &&
           read > 0) {
        bytes.append(chunk, read);
    }
    CloseHandle(file);
    return bytes;
}

std::string Narrow(const std::wstring& text) {
    return std::string(text.begin(), text.end());
}

// The launcher's Unix process folder under Z:\proc. Under Wine, GetProcessTimes answers for
// any process with the caller's own times, so CPU time is read where Linux keeps it. The
// launcher is the process whose command line names this test's disc and whose environment
// names this test run's Wine prefix (other runs on the machine have discs of the same name).
std::optional<std::wstring> LauncherUnixProcess(const std::wstring& discRoot) {
    std::wstring folder = discRoot.substr(0, discRoot.size() - 1);
    const std::string discName = Narrow(folder.substr(folder.rfind(L'\\') + 1));
    wchar_t prefix[MAX_PATH] = {};
    if (!GetEnvironmentVariableW(L"WINEPREFIX", prefix, MAX_PATH)) return std::nullopt;
    const std::string prefixEntry = std::string("WINEPREFIX=") + Narrow(prefix);
    WIN32_FIND_DATAW entry;
    HANDLE search = FindFirstFileW(L"Z:\\proc\\*", &entry);
    if (search == INVALID_HANDLE_VALUE) return std::nullopt;
    std::optional<std::wstring> found;
    do {
        const std::wstring pid = entry.cFileName;
        if (pid.empty() || pid.find_first_not_of(L"0123456789") != std::wstring::npos) continue;
        const std::wstring process = L"Z:\\proc\\" + pid + L"\\";
        const std::string commandLine = ReadUnixFile(process + L"cmdline");
        if (commandLine.find(discName + "\\AutoPlay.exe") == std::string::npos) continue;
        std::string environment = ReadUnixFile(process + L"environ");
        std::replace(environment.begin(), environment.end(), '\0', '\n');
        if (("\n" + environment).find("\n" + prefixEntry + "\n") != std::string::npos) {
            found = process;
        }
    } while (!found && FindNextFileW(search, &entry));
    FindClose(search);
    return found;
}

// User and system CPU time of a Unix process in clock ticks (1/100 s); -1 when unreadable.
long CpuTicks(const std::wstring& process) {
    const std::string stat = ReadUnixFile(process + L"stat");
    // The fields after the command name in parentheses: state is the first, utime the 12th.
    std::size_t close = stat.rfind(')');
    if (close == std::string::npos) return -1;
    std::vector<std::string> fields;
    std::size_t at = close + 1;
    while (fields.size() < 13) {
        std::size_t start = stat.find_first_not_of(' ', at);
        if (start == std::string::npos) return -1;
        at = stat.find(' ', start);
        fields.push_back(stat.substr(start, at - start));
    }
    return std::stol(fields[11]) + std::stol(fields[12]);
}

class Menu : public testing::Test {
  protected:
    void SetUp() override {
        DeleteMachineKey(kProductKeyPath);
        DeleteMachineKey(kLocaleKeyPath);
        disc.SetEdition(1);
    }
    void TearDown() override {
        CloseLauncher();
        if (gameInstalled) RunSetup(L"-u -s");
        DeleteMachineKey(kProductKeyPath);
        DeleteMachineKey(kUninstallKeyPath);
        DeleteMachineKey(kLocaleKeyPath);
    }

    // Starts the launcher and waits until it is painted with the mouse at rest on it.
    HWND Start(const std::wstring& arguments) {
        if (!launcher.Start(disc.Launcher(), arguments, disc.Root())) return nullptr;
        HWND window = WaitForWindow(launcher.Id(), L"LauncherAppClass");
        if (window) Rest(window);
        return window;
    }

    std::optional<DWORD> CloseLauncher() {
        for (HWND window : TopLevelWindows(launcher.Id(), L"LauncherAppClass")) {
            PostMessageW(window, WM_CLOSE, 0, 0);
        }
        return launcher.WaitForExit(kWindowWaitMs);
    }

    // Puts the mouse where it lights nothing; the window as it then settles.
    static Screenshot Rest(HWND window) {
        MoveMouse(window, kRestPoint);
        WaitUntil([&] { return FocusInThreadOf(window) == window; }, 3000);
        return SettledShot(window);
    }

    // Runs the disc's setup.exe from its Setup folder; its exit code.
    std::optional<DWORD> RunSetup(const std::wstring& arguments) {
        TestProcess setup;
        if (!setup.Start(disc.Path(L"Setup\\setup.exe"), arguments, disc.Path(L"Setup"))) {
            return std::nullopt;
        }
        std::optional<DWORD> code = setup.WaitForExit(3 * kWindowWaitMs);
        gameInstalled = arguments.find(L"-u") == std::wstring::npos;
        return code;
    }

    SampleDisc disc;
    TestProcess launcher;
    bool gameInstalled = false;
};

TEST_F(Menu, EachEditionOffersItsLanguagesOrSettlesOne) {
    const LauncherStrings strings(disc.Launcher());
    struct Row {
        int edition;  // 0: the disc has no ORVAK.INI
        std::optional<MainMenu> settled;
        const wchar_t* screenshot;
    };
    const Row rows[] = {
        {1, std::nullopt, nullptr},
        {2, std::nullopt, L"languages-edition2"},
        {3, std::nullopt, nullptr},
        {4, std::nullopt, nullptr},
        {5, MainMenu{kJapanese, true, true, false}, L"menu-ja"},
        {6, std::nullopt, nullptr},
        {0, MainMenu{kUsEnglish, true, false, false}, nullptr},
        {7, MainMenu{kUsEnglish, true, false, false}, nullptr},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << "disc edition " << row.edition);
        DeleteMachineKey(kLocaleKeyPath);
        if (row.edition == 0) {
            disc.Remove(L"ORVAK.INI");
        } else {
            disc.SetEdition(row.edition);
        }
        HWND window = Start(L"");
        ASSERT_TRUE(window) << "no window";
        std::vector<std::wstring> expected;
        if (row.settled) {
            // The list's About button takes the settled language's label; nothing else of the
            // list exists.
            AddLanguageList(expected, {}, false, strings.Get(row.settled->base, 71));
            AddMainMenu(expected, strings, *row.settled);
            EXPECT_EQ(
                MachineText(kLocaleKeyPath, L""),
                std::optional<std::wstring>(row.settled->base == kJapanese ? L"ja" : L"en_US"));
        } else {
            AddLanguageList(expected, EditionNumber(row.edition).languages, true, L"");
            EXPECT_EQ(MachineText(kLocaleKeyPath, L""), std::nullopt)
                << "the list wrote a locale before any choice";
        }
        EXPECT_EQ(ChildrenSeen(window), Sorted(expected));
        if (row.screenshot) SettledShot(window).SaveForReadme(row.screenshot);
        ASSERT_EQ(CloseLauncher(), std::optional<DWORD>(0));
    }
}

TEST_F(Menu, AClickOnALanguageShowsItsMainMenuAndWritesItsLocale) {
    const LauncherStrings strings(disc.Launcher());
    struct Row {
        int edition;
        int id;
        LanguageBase base;
        const wchar_t* locale;
        const wchar_t* screenshot;
    };
    const Row rows[] = {
        {2, 502, kGerman, L"de", L"menu-de"},  // edition 2: no More Games, no games panel
        {3, 511, kThai, L"th", nullptr},
        {6, 514, kNorwegian, L"no", nullptr},
        {1, 506, kSpanish, L"es", nullptr},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message()
                     << "disc edition " << row.edition << ", language " << row.id);
        const Edition& edition = EditionNumber(row.edition);
        disc.SetEdition(row.edition);
        DeleteMachineKey(kLocaleKeyPath);
        HWND window = Start(L"");
        ASSERT_TRUE(window) << "no window";
        auto chosen = std::find_if(edition.languages.begin(), edition.languages.end(),
                                   [&](const Listed& l) { return l.id == row.id; });
        ASSERT_NE(chosen, edition.languages.end());

        Click(window, Centre(Rect(chosen->x, chosen->y, 212, 50)));
        ASSERT_TRUE(WaitUntil([&] { return VisibleButton(window, kExit.id) != nullptr; }))
            << "the main menu did not come";
        const Screenshot shot = Rest(window);

        std::vector<std::wstring> expected;
        AddLanguageList(expected, edition.languages, false, L"");
        AddMainMenu(expected, strings, {row.base, row.edition != 2, edition.readme, false});
        EXPECT_EQ(ChildrenSeen(window), Sorted(expected));
        EXPECT_EQ(MachineText(kLocaleKeyPath, L""), std::optional<std::wstring>(row.locale));
        if (row.screenshot) shot.SaveForReadme(row.screenshot);
        ASSERT_EQ(CloseLauncher(), std::optional<DWORD>(0));
    }
}

TEST_F(Menu, TheProductEditionDecidesWhatStandsAtTheMoreInformationPlace) {
    const LauncherStrings strings(disc.Launcher());
    struct Row {
        DWORD productSku;
        const wchar_t* option;
        LanguageBase base;
        bool readme;
    };
    const Row rows[] = {
        {5, L"-l0409", kUsEnglish, true},
        {5, L"-l0415", kPolish, true},
        {4, L"-l0415", kPolish, false},
        {4, L"-l0407", kGerman, true},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message()
                     << "VEMO_SKU " << row.productSku << ", language " << row.base);
        ScopedMachineKey product(kProductKeyPath);
        product.SetDword(L"VEMO_SKU", row.productSku);
        HWND window = Start(row.option);
        ASSERT_TRUE(window) << "no window";
        std::vector<std::wstring> expected;
        AddMainMenu(expected, strings, {row.base, true, row.readme, false});
        EXPECT_EQ(ChildrenSeen(window), Sorted(expected));
        ASSERT_EQ(CloseLauncher(), std::optional<DWORD>(0));
    }
}

TEST_F(Menu, InstallingWhileTheLauncherRunsTurnsInstallIntoPlayOnceItIsActiveAgain) {
    HWND window = Start(L"-l0409");
    ASSERT_TRUE(window);
    ASSERT_TRUE(VisibleButton(window, kInstall.id));
    ASSERT_FALSE(VisibleButton(window, kPlay.id));
    const Screenshot withInstall = SettledShot(window);
    {
        OtherProgramWindow other;
        ASSERT_TRUE(WaitUntil([&] { return other.Get() && GetForegroundWindow() == other.Get(); }))
            << "the launcher could not be left for another window";
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
    const Screenshot switched = Rest(window);
    ASSERT_EQ(CloseLauncher(), std::optional<DWORD>(0));

    // A launcher started with the game installed shows how the caption beside Play reads.
    HWND fresh = Start(L"-l0409");
    ASSERT_TRUE(fresh);
    EXPECT_TRUE(VisibleButton(fresh, kPlay.id));
    EXPECT_FALSE(VisibleButton(fresh, kInstall.id));
    const Screenshot withPlay = SettledShot(fresh);
    const RECT caption{0, 205, 185, 240};  // ends at (187, 237), left of the button
    ASSERT_GT(withPlay.DifferingPixels(withInstall, caption), 20)
        << "the captions cannot be told apart";
    EXPECT_EQ(switched.DifferingPixels(withPlay, caption), 0) << "the caption does not say Play";
    EXPECT_EQ(switched.DifferingPixels(withPlay, kPlay.place), 0) << "the Play face is not drawn";

    ASSERT_EQ(CloseLauncher(), std::optional<DWORD>(0));
    EXPECT_EQ(RunSetup(L"-u -s"), std::optional<DWORD>(0));
}

TEST_F(Menu, EachPanelOpensAndClosesWithItsButtonAndAnotherButtonSwitchesPanels) {
    ASSERT_EQ(RunSetup(L"-s -l0409"), std::optional<DWORD>(0));
    HWND window = Start(L"-l0409");
    ASSERT_TRUE(window);
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
        EXPECT_TRUE(WaitUntil([&] { return ShownPlates(window) == IdsOf(row.plates); }))
            << "the panel's plates, and only they, should show";
        const Screenshot open = Rest(window);
        EXPECT_GT(open.DifferingPixels(closed, row.opener.place), 200)
            << "the opener is not latched";
        EXPECT_GT(open.DifferingPixels(closed, row.backdrop), 5000) << "no backdrop";
        open.SaveForReadme(row.screenshot);

        Click(window, row.circle);
        EXPECT_TRUE(WaitUntil([&] { return ShownPlates(window).empty(); })) << "the panel stayed";
        const Screenshot again = Rest(window);
        EXPECT_EQ(again.DifferingPixels(closed, {0, 0, 640, 480}), 0) << "closing left a trace";
    }

    // Another opener while a panel is open: the first panel closes, the new one opens.
    Click(window, kPlayCircle);
    ASSERT_TRUE(WaitUntil([&] { return ShownPlates(window) == IdsOf(kPlayPanel); }));
    Click(window, kMoreGamesCircle);
    EXPECT_TRUE(WaitUntil([&] { return ShownPlates(window) == IdsOf(kGamesPanel); }))
        << "the play panel's plates should go and the games panel's come";
    const Screenshot switched = Rest(window);
    EXPECT_EQ(switched.DifferingPixels(closed, kPlay.place), 0) << "Play stayed latched";
    EXPECT_GT(switched.DifferingPixels(closed, kMoreGames.place), 200)
        << "More Games is not latched";
    Click(window, kMoreGamesCircle);
    EXPECT_TRUE(WaitUntil([&] { return ShownPlates(window).empty(); }));

    ASSERT_EQ(CloseLauncher(), std::optional<DWORD>(0));
    EXPECT_EQ(RunSetup(L"-u -s"), std::optional<DWORD>(0));
}

TEST_F(Menu, TheMouseLightsACircleInsideItAndAPlateAnywhereOnIt) {
    HWND window = Start(L"-l0409");
    ASSERT_TRUE(window);
    HWND install = VisibleButton(window, kInstall.id);
    ASSERT_TRUE(install);
    const Screenshot before = SettledShot(window);

    MoveMouse(window, kPlayCircle);  // the Install circle's centre
    EXPECT_TRUE(WaitUntil([&] { return FocusInThreadOf(window) == install; }));
    const Screenshot lit = SettledShot(window);
    EXPECT_GT(lit.DifferingPixels(before, kInstall.place), 500) << "the hover face did not show";
    lit.SaveForReadme(L"menu-hover");

    MoveMouse(window, {188, 164});  // inside the window, outside the circle
    EXPECT_TRUE(WaitUntil([&] { return FocusInThreadOf(window) == window; }));
    const Screenshot off = SettledShot(window);
    EXPECT_EQ(off.DifferingPixels(before, kInstall.place), 0) << "the hover face stayed";

    // A plate of an open panel takes the focus wherever the mouse is on it.
    Click(window, kMoreInformationCircle);
    ASSERT_TRUE(WaitUntil([&] { return ShownPlates(window) == IdsOf(kInfoPanel); }));
    const Screenshot open = Rest(window);
    const Documented& registration = kInfoPanel[0];
    const Documented& support = kInfoPanel[1];
    HWND registrationPlate = VisibleButton(window, registration.id);
    HWND supportPlate = VisibleButton(window, support.id);
    MoveMouse(window, {registration.place.left + 3, registration.place.top + 3});
    EXPECT_TRUE(WaitUntil([&] { return FocusInThreadOf(window) == registrationPlate; }));
    const Screenshot plateLit = SettledShot(window);
    EXPECT_GT(VisiblyDifferingPixels(plateLit, open, registration.place), 100)
        << "the plate did not light";

    MoveMouse(window, Centre(support.place));
    EXPECT_TRUE(WaitUntil([&] { return FocusInThreadOf(window) == supportPlate; }));
    const Screenshot moved = SettledShot(window);
    EXPECT_EQ(VisiblyDifferingPixels(moved, open, registration.place), 0)
        << "the first plate stayed lit";
    EXPECT_GT(VisiblyDifferingPixels(moved, open, support.place), 100)
        << "the second plate did not light";
}

// Wine answers GetGuiResources with 0, so the launcher reports what its handle owners hold and
// how many windows its thread has.
TEST_F(Menu, GuiObjectsStayFlatOverHoversAndPanelToggles) {
    HWND window = Start(L"-l0409");
    ASSERT_TRUE(window);
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

    int toggles = 0;
    for (int i = 0; i < 100; ++i) {
        const bool opens = i % 2 == 0;
        // Two clicks on one spot would make a double click, which toggles nothing.
        Click(window, {kMoreInformationCircle.x + (opens ? -8 : 8), kMoreInformationCircle.y});
        if (WaitUntil([&] { return (VisibleButton(window, kInfoPanel[0].id) != nullptr) == opens; },
                      3000)) {
            ++toggles;
        }
    }
    EXPECT_EQ(toggles, 100);

    Rest(window);
    const LRESULT gdiAfter = HeldByLauncher(window, kGdiHandlesHeld);
    const LRESULT windowsAfter = HeldByLauncher(window, kWindowsHeld);
    std::printf("GDI objects held %ld -> %ld, windows %ld -> %ld over %d hovers, %d toggles\n",
                static_cast<long>(gdiBefore), static_cast<long>(gdiAfter),
                static_cast<long>(windowsBefore), static_cast<long>(windowsAfter), hovers, toggles);
    EXPECT_EQ(gdiAfter, gdiBefore);
    EXPECT_EQ(windowsAfter, windowsBefore);
}

TEST_F(Menu, TheWaitingMainMenuUsesAlmostNoCpu) {
    HWND window = Start(L"-l0409");
    ASSERT_TRUE(window);
    const std::optional<std::wstring> process = LauncherUnixProcess(disc.Root());
    ASSERT_TRUE(process) << "the launcher's process was not found under Z:\\proc";

    // The reading must see work when there is some: a few panel toggles repaint the window.
    const long beforeWork = CpuTicks(*process);
    for (int i = 0; i < 10; ++i) {
        Click(window, {kMoreInformationCircle.x + (i % 2 ? 8 : -8), kMoreInformationCircle.y});
        WaitUntil(
            [&] { return (VisibleButton(window, kInfoPanel[0].id) != nullptr) == (i % 2 == 0); },
            3000);
    }
    const long afterWork = CpuTicks(*process);
    ASSERT_GE(beforeWork, 0);
    EXPECT_GT(afterWork, beforeWork) << "the CPU time read does not follow the launcher's work";

    Rest(window);
    Sleep(1000);
    const long idleStart = CpuTicks(*process);
    Sleep(5000);
    const long idleEnd = CpuTicks(*process);
    const long idleMs = (idleEnd - idleStart) * 10;
    std::printf("CPU time: %ld ms for 10 panel toggles, %ld ms over 5 s of waiting\n",
                (afterWork - beforeWork) * 10, idleMs);
    EXPECT_LT(idleMs, 50) << "over 1 % of one core while nothing happens";
}

}  // namespace
