// Driving the real AutoPlay.exe as a user would: start it on a copy of the sample disc, find
// its windows, buttons and message boxes and answer them, move and click the real mouse, press
// real keys, read the client area back as pixels, and read what the started programs logged.
// Every wait is bounded.
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

// The client area of a window as it is on the screen (or the pixels of a picture), read as
// top-down 32-bit pixels.
class Screenshot {
  public:
    explicit Screenshot(HWND window);
    explicit Screenshot(HBITMAP picture);

    int Width() const { return width_; }
    int Height() const { return height_; }
    Rgb At(int x, int y) const;
    // Pixels that differ between two shots of the same size, inside a rectangle.
    int DifferingPixels(const Screenshot& other, const RECT& area) const;
    // Saves the shot as NAME.bmp in AUTOPLAY_SCREENSHOT_DIR when that is set (the README's
    // pictures are made this way, scripts/screenshots.sh); nothing otherwise.
    void SaveForReadme(const std::wstring& name) const;

  private:
    int width_ = 0;
    int height_ = 0;
    std::vector<std::uint32_t> pixels_;
};

int ColorDistance(Rgb a, Rgb b);
// Waits until two shots of the window in a row are equal (its painting has settled); the last.
Screenshot SettledShot(HWND window, DWORD timeoutMs = 5000);

// A child window of the launcher as a user and a screen reader see it.
struct ButtonSeen {
    HWND window = nullptr;
    std::wstring className;
    std::wstring text;
    int id = 0;
    RECT place{};  // in the launcher's client area
    bool visible = false;
};
std::vector<ButtonSeen> ChildButtons(HWND launcher);
// The visible child with this control id, or null.
HWND VisibleButton(HWND launcher, int id);

// The real mouse, moved or clicked at a point of a window's client area.
void MoveMouse(HWND window, POINT client);
void Click(HWND window, POINT client);
// A real key press, as the keyboard sends it, with a key held down (VK_SHIFT, VK_MENU) or not.
void PressKey(WORD virtualKey, WORD modifier = 0);
// The window that has the keyboard focus in the thread that owns `window`.
HWND FocusInThreadOf(HWND window);

// A program started for a test; killed when the test ends if still running.
class TestProcess {
  public:
    TestProcess() = default;
    ~TestProcess();
    TestProcess(const TestProcess&) = delete;
    TestProcess& operator=(const TestProcess&) = delete;

    // Starts `program` with `arguments` (may be empty) in `folder`.
    bool Start(const std::wstring& program, const std::wstring& arguments,
               const std::wstring& folder);
    // The exit code, or nothing when the process still runs after `timeoutMs`.
    std::optional<DWORD> WaitForExit(DWORD timeoutMs);
    DWORD Id() const { return id_; }

  private:
    void Release();
    HANDLE process_ = nullptr;
    DWORD id_ = 0;
};

// The processor time so far of a process's threads, in milliseconds. Wine answers
// GetProcessTimes for another process with the caller's own times, but reads each thread's
// time from the system.
double ProcessorMs(DWORD processId);

// The message box a process shows, as the user reads it.
struct MessageBoxSeen {
    HWND window = nullptr;
    std::wstring caption;
    std::wstring text;
    std::vector<int> buttons;  // control ids of its push buttons
};
std::optional<MessageBoxSeen> WaitForMessageBox(DWORD processId, DWORD timeoutMs = kWindowWaitMs);
// A visible message box of any process with this caption.
std::optional<MessageBoxSeen> WaitForMessageBoxTitled(const std::wstring& caption,
                                                      DWORD timeoutMs = kWindowWaitMs);
// Presses one of the box's buttons (IDOK, IDCANCEL, ...) and waits for the box to go.
bool PressButton(const MessageBoxSeen& box, int buttonId);
// Expects a message box of the process with this caption, text and buttons, and answers it.
void AnswerMessageBox(DWORD processId, const std::wstring& caption, const std::wstring& text,
                      const std::vector<int>& buttons, int answer);

// Visible top-level windows of a process with the given class (null: any class).
std::vector<HWND> TopLevelWindows(DWORD processId, const wchar_t* className = nullptr);
HWND WaitForWindow(DWORD processId, const wchar_t* className, DWORD timeoutMs = kWindowWaitMs);
// Waits for a window of this class in any process (a program the launcher started) and closes
// it; false when none came or it stayed.
bool CloseWindowOf(const wchar_t* className);

// The sample disc as the build assembles it, copied for one test into a folder of its own
// (its name has a space), so that a test may change it without touching the build.
class SampleDisc {
  public:
    SampleDisc();
    // Removes the copy; programs started from it get a few seconds to close first.
    ~SampleDisc();
    SampleDisc(const SampleDisc&) = delete;
    SampleDisc& operator=(const SampleDisc&) = delete;

    // With a trailing backslash.
    const std::wstring& Root() const { return root_; }
    std::wstring Path(const std::wstring& relativePath) const { return root_ + relativePath; }
    std::wstring Launcher() const { return Path(L"AutoPlay.exe"); }

    // Rewrites ORVAK.INI for another edition of the disc.
    void SetEdition(int sku) const;
    // Takes a file, or a folder with everything in it, off the disc.
    void Remove(const std::wstring& relativePath) const;
    // Takes a file away for a while, and puts it back.
    void MoveAside(const std::wstring& relativePath) const;
    void PutBack(const std::wstring& relativePath) const;

  private:
    std::wstring root_;
};

// The companion programs' log for one test (set in this process's environment, so every
// program started from here inherits it), removed when the test ends. Each line is split at its
// tabs: program, arguments, folder.
using LogLine = std::vector<std::wstring>;
class CompanionLog {
  public:
    CompanionLog();
    ~CompanionLog();
    CompanionLog(const CompanionLog&) = delete;
    CompanionLog& operator=(const CompanionLog&) = delete;

    std::vector<LogLine> Lines() const;
    // Waits for the line after those already checked, and checks it. Folders compare as
    // Windows compares them: in any case, with or without a final backslash.
    void ExpectNext(const std::wstring& program, const std::wstring& arguments,
                    const std::wstring& folder);

  private:
    std::wstring path_;
    std::size_t checked_ = 0;
};

// The launcher on its own copy of the sample disc (edition 1), with the product's and the
// locale's keys gone before and after. Whatever the launcher, the programs it started or the
// disc's installer left is closed or taken away when the test ends.
class LauncherTest : public testing::Test {
  protected:
    void SetUp() override;
    void TearDown() override;

    // Starts the launcher (in `folder`, the disc's root when empty) and waits until its window
    // is painted with the mouse at rest on it; false after a failure otherwise.
    bool Start(const std::wstring& arguments, const std::wstring& folder = L"");
    // Puts the mouse where it lights nothing; the window as it then settles.
    Screenshot Rest() const;
    // Clicks the visible button carrying `id` with the real mouse, in its middle.
    bool Press(int id) const;
    // Opens the fold-out panel of `opener` unless `id` already shows, then presses `id`.
    bool PressInPanel(int opener, int id) const;
    // Closes the launcher's window; its exit code.
    std::optional<DWORD> CloseLauncher();
    bool StillRunning();
    // Runs the disc's setup.exe from its Setup folder, as the launcher does; its exit code.
    std::optional<DWORD> RunSetup(const std::wstring& arguments);

    SampleDisc disc;
    CompanionLog log;
    TestProcess launcher;
    HWND window = nullptr;

  private:
    bool gameInstalled_ = false;
};

#endif
