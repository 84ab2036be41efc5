// Driving the real AutoPlay.exe as a user would: start it from a disc folder, find the
// windows and message boxes it shows, answer them, and read what its companions logged.
// Every wait is bounded.
#ifndef AUTOPLAY_TESTS_E2E_SUPPORT_WIN_H
#define AUTOPLAY_TESTS_E2E_SUPPORT_WIN_H

#include <windows.h>

#include <optional>
#include <string>
#include <vector>

#include "test_support_win.h"

constexpr DWORD kWindowWaitMs = 20000;

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
    HANDLE process_ = nullptr;
    DWORD id_ = 0;
};

// The message box a process shows, as the user reads it.
struct MessageBoxSeen {
    HWND window = nullptr;
    std::wstring caption;
    std::wstring text;
    std::vector<int> buttons;  // control ids of its push buttons
};

// Waits for a visible message box of process `processId`.
std::optional<MessageBoxSeen> WaitForMessageBox(DWORD processId, DWORD timeoutMs = kWindowWaitMs);
// Waits for a visible message box of any process with this caption.
std::optional<MessageBoxSeen> WaitForMessageBoxTitled(const std::wstring& caption,
                                                      DWORD timeoutMs = kWindowWaitMs);
// Presses one of the box's buttons (IDOK, IDCANCEL, ...) and waits for the box to go.
bool PressButton(const MessageBoxSeen& box, int buttonId);
// Visible top-level windows of a process with the given class (null: any class).
std::vector<HWND> TopLevelWindows(DWORD processId, const wchar_t* className = nullptr);
// Waits until the process has a visible top-level window of that class.
HWND WaitForWindow(DWORD processId, const wchar_t* className, DWORD timeoutMs = kWindowWaitMs);

// A disc folder for one test: AutoPlay.exe copied in, plus whatever the test adds.
class DiscFolder {
public:
    DiscFolder();

    const std::wstring& Root() const { return folder_.Path(); }
    std::wstring Launcher() const { return Root() + L"AutoPlay.exe"; }
    void AddFile(const std::wstring& relativePath, const std::string& bytes) const;
    // Copies a program built beside the tests (e.g. setup.exe) into the disc.
    void AddBuiltProgram(const std::wstring& builtName, const std::wstring& relativePath) const;
    // The two files that tell the launcher Disc 1 is in the drive.
    void AddDiscOneFiles() const;

private:
    TempFolder folder_;
};

// The companion programs' log for one test (set in this process's environment, so every
// program started from here inherits it), removed when the test ends.
class CompanionLog {
public:
    CompanionLog();
    ~CompanionLog();
    CompanionLog(const CompanionLog&) = delete;
    CompanionLog& operator=(const CompanionLog&) = delete;

    // The lines logged so far, each split at its tabs (program, arguments, folder).
    std::vector<std::vector<std::wstring>> Lines() const;
    // Waits until at least `count` lines are there.
    std::vector<std::vector<std::wstring>> WaitForLines(std::size_t count,
                                                        DWORD timeoutMs = kWindowWaitMs) const;

private:
    std::wstring path_;
};

bool SameTextIgnoringCase(const std::wstring& a, const std::wstring& b);

#endif
