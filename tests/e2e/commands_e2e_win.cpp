// Every command clicked on the real launcher: what it starts, and what the user is told.
#include <gtest/gtest.h>
// clang-format off
#include <windows.h>
#include <psapi.h>  // after the types windows.h declares
// clang-format on

#include <cstring>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iterator>
#include <optional>
#include <string>
#include <vector>

#include "launcher_driver_win.h"
#include "locale/config_win.h"
#include "platform/registry_win.h"
#include "test_support_win.h"

namespace {

// The text of a UTF-16 file with a byte-order mark, as the disc's readme files are written.
std::wstring Utf16File(const std::wstring& path) {
    std::ifstream file(std::filesystem::path(path), std::ios::binary);
    const std::string bytes{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    std::wstring text(bytes.size() / sizeof(wchar_t), L'\0');
    std::memcpy(text.data(), bytes.data(), text.size() * sizeof(wchar_t));
    if (!text.empty() && text[0] == 0xFEFF) text.erase(0, 1);
    return text;
}

// GetWindowText does not ask another program's control for its text; the message does.
std::wstring EditText(HWND edit) {
    DWORD_PTR length = 0;
    SendMessageTimeoutW(edit, WM_GETTEXTLENGTH, 0, 0, SMTO_ABORTIFHUNG, 5000, &length);
    std::wstring text(length + 1, L'\0');
    DWORD_PTR copied = 0;
    SendMessageTimeoutW(edit, WM_GETTEXT, text.size(), reinterpret_cast<LPARAM>(text.data()),
                        SMTO_ABORTIFHUNG, 5000, &copied);
    text.resize(copied);
    return text;
}

// Whether a process has loaded common controls 6, which lives in the side-by-side store (the
// system folder's library is version 5).
bool HasCommonControls6(DWORD processId) {
    UniqueHandle process(
        OpenProcess(PROCESS_QUERY_INFORMATION | PROCESS_VM_READ, FALSE, processId));
    HMODULE modules[1024];
    DWORD bytes = 0;
    if (!process || !EnumProcessModules(process.Get(), modules, sizeof(modules), &bytes)) {
        ADD_FAILURE() << "the launcher's modules cannot be read";
        return false;
    }
    for (DWORD i = 0; i < bytes / sizeof(HMODULE) && i < std::size(modules); ++i) {
        wchar_t path[MAX_PATH] = {};
        GetModuleFileNameExW(process.Get(), modules[i], path, MAX_PATH);
        std::wstring name = path;
        for (wchar_t& c : name) c = static_cast<wchar_t>(towlower(c));
        if (name.find(L"common-controls") != std::wstring::npos &&
            name.find(L"\\comctl32.dll") != std::wstring::npos) {
            return true;
        }
    }
    return false;
}

class Commands : public LauncherTest {
  protected:
    // Waits for Notepad, and checks that it is the system folder's and shows `file`.
    void ExpectSystemNotepadShowing(const std::wstring& file) {
        HWND notepad = WaitForWindow(0, L"Notepad");
        ASSERT_TRUE(notepad) << "Notepad did not open";
        DWORD processId = 0;
        GetWindowThreadProcessId(notepad, &processId);
        UniqueHandle process(OpenProcess(PROCESS_QUERY_LIMITED_INFORMATION, FALSE, processId));
        wchar_t image[MAX_PATH] = {}, system[MAX_PATH] = {};
        DWORD length = MAX_PATH;
        QueryFullProcessImageNameW(process.Get(), 0, image, &length);
        GetSystemDirectoryW(system, MAX_PATH);
        EXPECT_TRUE(SameTextIgnoringCase(image, system + std::wstring(L"\\notepad.exe"))) << image;
        // The window shows before its edit control exists and before the file is read into
        // it, on a loaded machine seconds before.
        const std::wstring text = Utf16File(file);
        EXPECT_TRUE(WaitUntil(
            [&] {
                HWND edit = FindWindowExW(notepad, nullptr, L"Edit", nullptr);
                return edit && EditText(edit) == text;
            },
            kWindowWaitMs))
            << "Notepad shows " << TextOfWindow(notepad);
        EXPECT_TRUE(CloseWindowOf(L"Notepad"));
    }

    // The disc's installer swapped for the logging viewer, which ends at once: the commands'
    // tests need only see how it was started.
    void UseViewerAsInstaller() const {
        ASSERT_TRUE(
            CopyFileW(ViewerProgram().c_str(), disc.Path(L"Setup\\setup.exe").c_str(), FALSE));
    }

    ShellAssociations shell;
};

struct LanguageRow {
    const wchar_t* option;
    const wchar_t* installerParameters;
    const wchar_t* readme;   // in the disc's Support folder
    const wchar_t* address;  // as the browser is given it
};

// Every language's installer id, readme and regional site, which reaches the browser as an
// http address (the shell takes a bare host name for one only when it starts with "www.").
const LanguageRow kLanguageRows[] = {
    {L"-l0409", L"-l0009", L"readme.txt", L"http://www.vemo.example"},
    {L"-l040c", L"-l040c", L"Lisezmoi.txt", L"http://www.fr.vemo.example"},
    {L"-l0407", L"-l0007", L"Liesmich.txt", L"http://www.de.vemo.example"},
    {L"-l041d", L"-l001d", L"Lasmig.TXT", L"http://www.se.vemo.example"},
    {L"-l0413", L"-l0013", L"Leesmij.txt", L"http://www.nl.vemo.example"},
    {L"-l0416", L"-l0416", L"Leia-me.txt", L"http://www.br.vemo.example"},
    {L"-l0c0a", L"-l000a", L"Leeme.txt", L"http://www.es.vemo.example"},
    {L"-l0410", L"-l0010", L"Leggimi.txt", L"http://www.it.vemo.example"},
    {L"-l0415", L"-l0015", L"ReadmeP.txt", L"http://www.vemo.example"},
    {L"-l0411", L"-l0011", L"readmeJ.txt", L"http://www.jp.vemo.example"},
    {L"-l0404", L"-l0404", L"readmeTC.txt", L"http://www.tw.vemo.example"},
    {L"-l0804", L"-l0804", L"readmeSC.txt", L"http://www.vemo.example"},
    {L"-l041e", L"-l001e", L"readmeTh.txt", L"http://www.vemo.example"},
    {L"-l0412", L"-l0012", L"readmeKo.txt", L"http://kr.vemo.example/index.html"},
    {L"-l0809", L"-l0009", L"readmeUK.txt", L"http://www.uk.vemo.example"},
    {L"-l0414", L"-l0014", L"readmeNO.txt", L"http://www.no.vemo.example"},
    {L"-l040b", L"-l000b", L"readmeFI.txt", L"http://www.vemo.example"},
    {L"-l0406", L"-l0006", L"readmeDN.txt", L"http://www.dk.vemo.example"},
};

// Started from another folder, with a Notepad planted there, first on the PATH and on the disc:
// a plain program search would find one of those before the system's.
TEST_F(Commands, EachLanguageInstallsOpensItsReadmeInTheSystemNotepadAndItsRegionalSite) {
    UseViewerAsInstaller();
    shell.OpenEverythingWithViewer();
    TempFolder current;
    for (const std::wstring& planted :
         {disc.Path(L"notepad.exe"), disc.Path(L"Support\\notepad.exe"),
          current.Path() + L"notepad.exe"}) {
        ASSERT_TRUE(CopyFileW(ViewerProgram().c_str(), planted.c_str(), FALSE));
    }
    wchar_t path[32767] = {};
    GetEnvironmentVariableW(L"PATH", path, 32767);
    const std::wstring oldPath = path;
    for (const LanguageRow& row : kLanguageRows) {
        SCOPED_TRACE(testing::Message() << "launcher " << row.option);
        SetEnvironmentVariableW(L"PATH", (current.Path() + L";" + oldPath).c_str());
        const bool started = Start(row.option, current.Path());
        SetEnvironmentVariableW(L"PATH", oldPath.c_str());
        ASSERT_TRUE(started);

        ASSERT_TRUE(Press(101));
        log.ExpectNext(L"setup.exe", row.installerParameters, disc.Path(L"Setup"));

        ASSERT_TRUE(PressInPanel(108, 301));
        ExpectSystemNotepadShowing(disc.Path(L"Support\\") + row.readme);

        // Anything the readme command started has logged long before the web site's browser.
        ASSERT_TRUE(Press(107));
        log.ExpectNext(L"viewer.exe", L"\"" + std::wstring(row.address) + L"\"", current.Path());
        EXPECT_TRUE(StillRunning());
        CloseLauncher();  // it holds on to its current folder
    }
}

TEST_F(Commands, PanelCommandsStartTheSupportToolOrHelpPageTheRegistrationAndTheDemos) {
    shell.OpenEverythingWithViewer();
    struct Row {
        int edition;
        const wchar_t* option;
        int opener;
        int id;
        const wchar_t* program;
        const wchar_t* arguments;
        const wchar_t* folder;       // on the disc
        const wchar_t* windowClass;  // of the window it shows, if any
    };
    const Row rows[] = {
        {1, L"-l0409", 108, 302, L"Trivex.exe", L"", L"Support", L"TrivexWindow"},
        {3, L"-l0404", 108, 302, L"Trivex.exe", L"", L"Support", L"TrivexWindow"},
        {2, L"-l040c", 108, 302, L"viewer.exe", L"\"IX_Help_Fr.htm\"", L"Support\\ix help\\fr-fr",
         nullptr},
        {6, L"-l0409", 108, 302, L"viewer.exe", L"\"IX_Help_Select.htm\"", L"Support\\ix help",
         nullptr},
        {1, L"-l0409", 108, 303, L"Kelpa.exe", L"", L"Support", L"KelpaWindow"},
        {1, L"-l0409", 103, 601, L"viewer.exe", L"\"vemo2.mpg\"", L"Demos", nullptr},
        {1, L"-l0409", 103, 602, L"viewer.exe", L"\"vemo2duskaro.mpg\"", L"Demos", nullptr},
        {1, L"-l0409", 103, 603, L"viewer.exe", L"\"vemo2lorrel.mpg\"", L"Demos", nullptr},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message()
                     << "edition " << row.edition << ", " << row.option << ", button " << row.id);
        disc.SetEdition(row.edition);
        ASSERT_TRUE(Start(row.option));
        ASSERT_TRUE(PressInPanel(row.opener, row.id));
        log.ExpectNext(row.program, row.arguments, disc.Path(row.folder));
        if (row.windowClass) {
            EXPECT_TRUE(CloseWindowOf(row.windowClass));
        }
        EXPECT_TRUE(WaitForMessageBox(launcher.Id(), nullptr, 1000) == std::nullopt);
        EXPECT_TRUE(StillRunning());
        CloseLauncher();
    }
}

// Each play command starts its program and ends the launcher; once the game is gone it starts
// nothing, and Install comes back.
TEST_F(Commands, PlayCommandsStartTheGameOrCreatorAndEndTheLauncherOrNothingOnceItIsGone) {
    auto removeProgram = [] {
        const std::wstring program = InstalledFolder(L"The Vemo") + L"\\Vemo.exe";
        EXPECT_TRUE(WaitUntil([&] { return DeleteFileW(program.c_str()) != FALSE; }));
    };
    auto removeFolderValue = [] {
        RegistryKey product = CreateKeyForWriting(HKEY_LOCAL_MACHINE, kProductKeyPath);
        EXPECT_EQ(RegDeleteValueW(product.Get(), L"VEMO_DATA"), ERROR_SUCCESS);
    };
    struct Row {
        int id;
        const wchar_t* program;
        const wchar_t* arguments;
        const wchar_t* windowClass;
        const wchar_t* title;  // also the program's folder
        std::function<void()> removeTheGame;
    };
    const Row rows[] = {
        {150, L"Vemo.exe", L"", L"Brask", L"The Vemo", removeProgram},
        {151, L"Vemo.exe", L"-r1024x768", L"Brask", L"The Vemo", removeFolderValue},
        {152, L"TheVemoCreator.exe", L"", L"VemoCreatorWindow", L"The Vemo Creator", removeProgram},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.id);
        ASSERT_EQ(RunSetup(L"-s -l0409"), std::optional<DWORD>(0));
        log.ExpectNext(L"setup.exe", L"-s -l0409", disc.Path(L"Setup"));
        ASSERT_TRUE(Start(L"-l0409"));
        ASSERT_TRUE(PressInPanel(102, row.id));
        EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
        log.ExpectNext(row.program, row.arguments, InstalledFolder(row.title));
        EXPECT_TRUE(WaitForWindow(0, row.windowClass, row.title));
        // While the game's window is open a launcher ends at once, without a word.
        if (row.id != 152) ExpectSecondLauncherEndsAtOnce();
        EXPECT_TRUE(CloseWindowOf(row.windowClass));

        ASSERT_TRUE(Start(L"-l0409"));
        ASSERT_TRUE(Press(102));
        ASSERT_TRUE(VisibleButton(window, row.id)) << "the play panel did not open";
        row.removeTheGame();
        const std::size_t started = log.Lines().size();
        ASSERT_TRUE(Press(row.id));
        EXPECT_TRUE(WaitForMessageBox(launcher.Id(), nullptr, 1000) == std::nullopt) << "a message";
        EXPECT_TRUE(StillRunning());
        // Install is back, and the play panel has gone with the Play button.
        EXPECT_TRUE(WaitUntil([&] { return VisibleButton(window, 101) != nullptr; }, 5000))
            << "Install is not shown";
        EXPECT_EQ(VisibleButton(window, 102), nullptr);
        EXPECT_EQ(VisibleButton(window, 150), nullptr);
        EXPECT_EQ(log.Lines().size(), started) << "something was started";
        CloseLauncher();
    }
}

struct Messages {
    const wchar_t* option;
    const wchar_t* installerParameters;
    const wchar_t* discCaption;
    const wchar_t* discText;
    const wchar_t* noBrowserCaption;
    const wchar_t* noBrowserText;
    const wchar_t* browserFailedCaption;
    const wchar_t* browserFailedText;
    const wchar_t* demoCaption;
    const wchar_t* demoText;  // %s: the demo's file
};

const Messages kMessages[] = {
    {L"-l0409", L"-l0009", L"Insert Disc 1",
     L"To continue with this operation, please insert Disc 1 into the CD-ROM drive and click OK.",
     L"Can't find browser", L"I'm afraid Autoplay cannot find an internet browser on your system.",
     L"Can't run browser", L"I'm afraid Autoplay was unable to run an internet browser.",
     L"Can't run demo", L"Sorry.  The demo %s can't be found on this CD."},
    {L"-l0415", L"-l0015", L"Włóż płytę 1",
     L"Aby kontynuować tę operację, włóż płytę 1 do napędu CD-ROM i kliknij przycisk OK.",
     L"Nie znaleziono przeglądarki",
     L"Niestety program Autoplay nie może odnaleźć w systemie przeglądarki internetowej.",
     L"Nie można uruchomić przeglądarki",
     L"Niestety program Autoplay nie mógł uruchomić przeglądarki internetowej.",
     L"Nie można uruchomić wersji demo",
     L"Przepraszamy.  Nie można odnaleźć wersji demo %s na tej płycie CD."},
};
const std::vector<int> kOkCancel = {IDOK, IDCANCEL};
const std::vector<int> kOk = {IDOK};

TEST_F(Commands, WithoutDiscOneCommandsAskUntilCancelledAndFailuresAreToldInTheMenusLanguage) {
    UseViewerAsInstaller();
    for (const Messages& expected : kMessages) {
        SCOPED_TRACE(testing::Message() << "launcher " << expected.option);
        disc.MoveAside(L"Setup\\data2.cab");
        ASSERT_TRUE(Start(expected.option));
        const DWORD id = launcher.Id();
        const std::pair<int, int> asking[] = {{0, 101},   {108, 301}, {108, 302}, {108, 303},
                                              {103, 601}, {103, 602}, {103, 603}};
        for (const auto& [opener, command] : asking) {
            SCOPED_TRACE(command);
            ASSERT_TRUE(opener ? PressInPanel(opener, command) : Press(command));
            // OK with the disc still missing asks again; Cancel drops the command.
            for (int answer : {IDOK, IDCANCEL}) {
                AnswerMessageBox(id, expected.discCaption, expected.discText, kOkCancel, answer);
            }
        }

        // The web site never asks for the disc. Nothing opens web addresses (Wine's shell
        // answers "no association", 31), then a program that is not there does ("not found").
        ASSERT_TRUE(Press(107));
        AnswerMessageBox(id, expected.noBrowserCaption, expected.noBrowserText, kOk, IDOK);
        shell.OpenWebAddressesWith(TestProgramFolder() + L"no-such-browser.exe");
        ASSERT_TRUE(Press(107));
        AnswerMessageBox(id, expected.browserFailedCaption, expected.browserFailedText, kOk, IDOK);
        shell.Forget();

        // OK once the disc is back carries on with the command.
        ASSERT_TRUE(Press(101));
        std::optional<MessageBoxSeen> prompt = WaitForMessageBox(id);
        ASSERT_TRUE(prompt);
        disc.PutBack(L"Setup\\data2.cab");
        ASSERT_TRUE(PressButton(*prompt, IDOK));
        log.ExpectNext(L"setup.exe", expected.installerParameters, disc.Path(L"Setup"));

        // A demo missing from the disc, then a demo with no player for it.
        auto demoText = [&](const wchar_t* file) {
            std::wstring text = expected.demoText;
            return text.replace(text.find(L"%s"), 2, file);
        };
        shell.OpenFilesWith(L".mpg", ViewerProgram());
        disc.MoveAside(L"Demos\\vemo2.mpg");
        ASSERT_TRUE(PressInPanel(103, 601));
        AnswerMessageBox(id, expected.demoCaption, demoText(L"vemo2.mpg"), kOk, IDOK);
        disc.PutBack(L"Demos\\vemo2.mpg");
        shell.Forget();
        ASSERT_TRUE(PressInPanel(103, 602));
        AnswerMessageBox(id, expected.demoCaption, demoText(L"vemo2duskaro.mpg"), kOk, IDOK);

        // Exit never asks for the disc either.
        disc.MoveAside(L"Setup\\data2.cab");
        ASSERT_TRUE(Press(110));
        EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
        disc.PutBack(L"Setup\\data2.cab");
    }
    EXPECT_EQ(log.Lines().size(), 2u) << "only the two installers were started";
}

TEST_F(Commands, AboutBoxShowsItsPictureLeavesTheLauncherIdleAndClosesButNotWithEscape) {
    ASSERT_TRUE(Start(L"-l0409"));
    // The system's style for the box, and not for the menu's own buttons at start-up.
    EXPECT_FALSE(HasCommonControls6(launcher.Id()));
    ASSERT_TRUE(Press(1000));
    HWND box = WaitForWindow(launcher.Id(), L"#32770");
    ASSERT_TRUE(box) << "no About box";
    EXPECT_TRUE(HasCommonControls6(launcher.Id()));
    EXPECT_FALSE(IsWindowEnabled(window)) << "the box is not modal";
    HWND picture = FindWindowExW(box, nullptr, L"Static", nullptr);
    ASSERT_TRUE(picture);
    EXPECT_EQ(GetWindowLongW(picture, GWL_STYLE) & SS_TYPEMASK, SS_BITMAP);
    EXPECT_EQ(TextOfWindow(GetDlgItem(box, IDOK)), L"&OK");

    // Picture 241 of the launcher's resources is what the box shows.
    SettledShot(box).SaveForReadme(L"about");
    HMODULE program = LoadLibraryExW(disc.Launcher().c_str(), nullptr,
                                     LOAD_LIBRARY_AS_DATAFILE | LOAD_LIBRARY_AS_IMAGE_RESOURCE);
    HBITMAP resource = static_cast<HBITMAP>(
        LoadImageW(program, MAKEINTRESOURCEW(241), IMAGE_BITMAP, 0, 0, LR_CREATEDIBSECTION));
    ASSERT_TRUE(resource);
    const Screenshot shown = SettledShot(picture);
    EXPECT_EQ(std::vector<int>({shown.Width(), shown.Height()}), std::vector<int>({400, 488}));
    EXPECT_EQ(shown.DifferingPixels(Screenshot(resource), {0, 0, 400, 488}, 6), 0)
        << "points of the box that are not the picture";
    DeleteObject(resource);
    FreeLibrary(program);

    // The mouse rests off the box: Wine polls it every 10 ms over a control that tracks it.
    MoveMouse(GetDesktopWindow(), {GetSystemMetrics(SM_CXSCREEN) - 1, 0});
    ASSERT_GT(ProcessorMs(launcher.Id()), 0) << "the launcher's processor time cannot be read";
    ExpectIdle(launcher.Id(), "with the About box open");

    const struct {
        const char* how;
        void (*act)(HWND box);
        bool closes;
    } rows[] = {
        {"Escape", [](HWND) { PressKey(VK_ESCAPE); }, false},
        {"Enter", [](HWND) { PressKey(VK_RETURN); }, true},
        {"a click on OK",
         [](HWND about) {
             Click(GetDlgItem(about, IDOK), {20, 10});
         },
         true},
        {"the system menu's Close",
         [](HWND) {
             PressKey(VK_SPACE, VK_MENU);
             Sleep(200);
             PressKey('C');
         },
         true},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.how);
        if (!box) {
            ASSERT_TRUE(Press(1000));
            box = WaitForWindow(launcher.Id(), L"#32770");
            ASSERT_TRUE(box) << "no About box";
        }
        ASSERT_TRUE(WaitUntil([&] { return GetForegroundWindow() == box; }, 5000));
        row.act(box);
        if (row.closes) {
            EXPECT_TRUE(WaitUntil([&] { return !IsWindow(box); }, kWindowWaitMs));
            box = nullptr;
            EXPECT_TRUE(WaitUntil([&] { return IsWindowEnabled(window) != FALSE; }, 5000));
        } else {
            Sleep(1000);
            EXPECT_TRUE(IsWindowVisible(box)) << "the box closed";
        }
        EXPECT_TRUE(StillRunning());
    }
}

}  // namespace
