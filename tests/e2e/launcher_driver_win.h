// Driving the real AutoPlay.exe as a user would, on a copy of the sample disc: windows, the real
// mouse and keys, pixels, and the log the started programs write. Every wait is bounded.
#ifndef AUTOPLAY_TESTS_LAUNCHER_DRIVER_WIN_H
#define AUTOPLAY_TESTS_LAUNCHER_DRIVER_WIN_H

#include <gtest/gtest.h>
#include <windows.h>

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "test_support_win.h"

constexpr DWORD kWindowWaitMs = 20000;
// Where no button, caption or panel ever is: the mouse rests here between steps.
constexpr POINT kRestPoint{600, 470};

// Polls `done` until it holds or `timeoutMs` passes; the last answer.
bool WaitUntil(const std::function<bool()>& done, DWORD timeoutMs = 10000);
bool SameTextIgnoringCase(const std::wstring& a, const std::wstring& b);
std::wstring TextOfWindow(HWND window);

// A window's client area as the screen shows it, or a picture, as 32-bit pixels.
class Screenshot {
  public:
    explicit Screenshot(HWND window);
    explicit Screenshot(HBITMAP picture);

    int Width() const { return width_; }
    int Height() const { return height_; }
    Rgb At(int x, int y) const;
    // Pixels inside `area` farther than `tolerance` (ColorDistance) from the other shot's.
    int DifferingPixels(const Screenshot& other, const RECT& area, int tolerance = 0) const;
    // As NAME.bmp in AUTOPLAY_SCREENSHOT_DIR when that is set (scripts/screenshots.sh).
    void SaveForReadme(const std::wstring& name) const;

  private:
    int width_ = 0;
    int height_ = 0;
    std::vector<std::uint32_t> pixels_;
};

int ColorDistance(Rgb a, Rgb b);
// The window once two shots in a row are equal (its painting has settled), or the last.
Screenshot SettledShot(HWND window, DWORD timeoutMs = 5000);

// A child window of the launcher as a user and a screen reader see it.
struct ButtonSeen {
    HWND window = nullptr;
    std::wstring className;
    std::wstring text;
    int id = 0;
    bool visible = false;
    RECT place{};  // in the launcher's client area
};
std::vector<ButtonSeen> ChildButtons(HWND launcher);
HWND VisibleButton(HWND launcher, int id);

// The real mouse and keyboard, at a point of a window's client area.
void MoveMouse(HWND window, POINT client);
void Click(HWND window, POINT client);
void PressKey(WORD virtualKey, WORD modifier = 0);
// The window with the keyboard focus in the thread that owns `window`.
HWND FocusInThreadOf(HWND window);

// A program started for a test; killed when the test ends if still running.
class TestProcess {
  public:
    TestProcess() = default;
    ~TestProcess();
    TestProcess(const TestProcess&) = delete;
    TestProcess& operator=(const TestProcess&) = delete;

    bool Start(const std::wstring& program, const std::wstring& arguments,
               const std::wstring& folder);
    // The exit code, or nothing while it still runs after `timeoutMs`.
    std::optional<DWORD> WaitForExit(DWORD timeoutMs);
    DWORD Id() const { return id_; }

  private:
    void Release();
    HANDLE process_ = nullptr;
    DWORD id_ = 0;
};

// The processor time so far of a process's threads, in ms. Wine answers GetProcessTimes for
// another process with the caller's own times, but reads each thread's from the system.
double ProcessorMs(DWORD processId);
// Expects a process left alone for five seconds to use under 1 % of one core; prints `what`.
void ExpectIdle(DWORD processId, const char* what);

struct MessageBoxSeen {
    HWND window = nullptr;
    std::wstring caption;
    std::wstring text;
    std::vector<int> buttons;  // control ids of its push buttons
};
// A message box of the process (0: of any process) with this caption (null: any caption).
std::optional<MessageBoxSeen> WaitForMessageBox(DWORD processId, const wchar_t* caption = nullptr,
                                                DWORD timeoutMs = kWindowWaitMs);
// Presses one of the box's buttons (IDOK, IDCANCEL, ...) and waits for the box to go.
bool PressButton(const MessageBoxSeen& box, int buttonId);
// Expects a message box of the process with this caption, text and buttons, and answers it.
void AnswerMessageBox(DWORD processId, const std::wstring& caption, const std::wstring& text,
                      const std::vector<int>& buttons, int answer);

// Visible top-level windows of a process (0: any) with this class and caption (null: any).
std::vector<HWND> TopLevelWindows(DWORD processId, const wchar_t* className = nullptr,
                                  const wchar_t* caption = nullptr);
HWND WaitForWindow(DWORD processId, const wchar_t* className, const wchar_t* caption = nullptr,
                   DWORD timeoutMs = kWindowWaitMs);
// Waits for a window of this class in any process and closes it; whether it came and went.
bool CloseWindowOf(const wchar_t* className);

// The built sample disc, copied for one test into a folder of its own whose name has a space.
class SampleDisc {
  public:
    SampleDisc();

    // With a trailing backslash.
    const std::wstring& Root() const { return root_; }
    std::wstring Path(const std::wstring& relativePath) const { return root_ + relativePath; }
    std::wstring Launcher() const { return Path(L"AutoPlay.exe"); }

    // Rewrites ORVAK.INI for another edition of the disc.
    void SetEdition(int sku) const;
    // Takes a file or folder off the disc, for the test or until it is put back.
    void MoveAside(const std::wstring& relativePath) const;
    void PutBack(const std::wstring& relativePath) const;

  private:
    TempFolder folder_;  // removed with the copy when the test ends
    std::wstring root_;
};

// A folder the installer makes: Program Files\Orvak, or the named one ("The Vemo") in it.
std::wstring InstalledFolder(const std::wstring& name);

// The started programs' log, named in the environment every program started from here inherits.
using LogLine = std::vector<std::wstring>;  // program, arguments, folder
class CompanionLog {
  public:
    CompanionLog();
    ~CompanionLog();

    std::vector<LogLine> Lines() const;
    // Waits for the line after those already checked and checks it; folders compare as
    // Windows compares them (any case, with or without a final backslash).
    void ExpectNext(const std::wstring& program, const std::wstring& arguments,
                    const std::wstring& folder);

  private:
    TempFolder folder_;
    std::wstring path_;
    std::size_t checked_ = 0;
};

// The launcher on its own copy of the sample disc (edition 1), the product gone before and after;
// whatever it, its started programs or the installer left is closed or taken away at the end.
class LauncherTest : public testing::Test {
  protected:
    void SetUp() override;
    void TearDown() override;

    // Starts the launcher in `folder` (else the disc's root) and waits for its painted window.
    bool Start(const std::wstring& arguments, const std::wstring& folder = L"");
    // Puts the mouse where it lights nothing; the window as it then settles.
    Screenshot Rest() const;
    // Clicks the middle of the visible button `id` with the real mouse.
    bool Press(int id) const;
    // Opens the fold-out panel of `opener` unless `id` already shows, then presses `id`.
    bool PressInPanel(int opener, int id) const;
    // Closes the launcher's window; its exit code.
    std::optional<DWORD> CloseLauncher();
    bool StillRunning();
    // Runs the disc's setup.exe from its Setup folder, as the launcher does; its exit code.
    std::optional<DWORD> RunSetup(const std::wstring& arguments);
    // A second launcher started now ends at once without showing a window.
    void ExpectSecondLauncherEndsAtOnce() const;

    SampleDisc disc;
    CompanionLog log;
    TestProcess launcher;
    HWND window = nullptr;

  private:
    bool gameInstalled_ = false;
};

// What the shell opens addresses, help pages and videos with: the classes keys are set aside (so
// nothing is associated, not even Wine's own browser) and put back when the test ends.
class ShellAssociations {
  public:
    ShellAssociations();
    ~ShellAssociations();
    ShellAssociations(const ShellAssociations&) = delete;
    ShellAssociations& operator=(const ShellAssociations&) = delete;

    // http and https addresses open with `program`, given the address.
    void OpenWebAddressesWith(const std::wstring& program) const;
    // Files ending in `extension` (".htm", ".mpg") open with `program`, given the file.
    void OpenFilesWith(const wchar_t* extension, const std::wstring& program) const;
    // Everything above opens with the test viewer.
    void OpenEverythingWithViewer() const;
    // Nothing is associated again.
    void Forget() const;
};

// The logging viewer built beside the tests.
std::wstring ViewerProgram();

#endif
