#include "launcher_driver_win.h"

// After windows.h, whose types it uses.
#include <tlhelp32.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>

#include "locale/config_win.h"

bool WaitUntil(const std::function<bool()>& done, DWORD timeoutMs) {
    const DWORD start = GetTickCount();
    for (;;) {
        if (done()) return true;
        if (GetTickCount() - start > timeoutMs) return false;
        Sleep(50);
    }
}

bool SameTextIgnoringCase(const std::wstring& a, const std::wstring& b) {
    return CompareStringOrdinal(a.c_str(), static_cast<int>(a.size()), b.c_str(),
                                static_cast<int>(b.size()), TRUE) == CSTR_EQUAL;
}

std::wstring TextOfWindow(HWND window) {
    int length = GetWindowTextLengthW(window);
    std::wstring text(static_cast<std::size_t>(length) + 1, L'\0');
    GetWindowTextW(window, text.data(), length + 1);
    text.resize(static_cast<std::size_t>(length));
    return text;
}

namespace {

std::wstring ClassNameOf(HWND window) {
    wchar_t name[128] = {};
    GetClassNameW(window, name, 128);
    return name;
}

}  // namespace

Screenshot::Screenshot(HWND window) {
    RECT client{};
    GetClientRect(window, &client);
    width_ = client.right;
    height_ = client.bottom;
    POINT origin{0, 0};
    ClientToScreen(window, &origin);
    BITMAPINFO info = TopDownInfo(width_, height_);
    HDC screen = GetDC(nullptr);
    HDC memory = CreateCompatibleDC(screen);
    void* bits = nullptr;
    HBITMAP bitmap = CreateDIBSection(memory, &info, DIB_RGB_COLORS, &bits, nullptr, 0);
    HGDIOBJ previous = SelectObject(memory, bitmap);
    BitBlt(memory, 0, 0, width_, height_, screen, origin.x, origin.y, SRCCOPY);
    GdiFlush();
    if (bits) {
        pixels_.assign(static_cast<const std::uint32_t*>(bits),
                       static_cast<const std::uint32_t*>(bits) + width_ * height_);
    }
    SelectObject(memory, previous);
    DeleteObject(bitmap);
    DeleteDC(memory);
    ReleaseDC(nullptr, screen);
}

Screenshot::Screenshot(HBITMAP picture) {
    BITMAP info{};
    GetObjectW(picture, sizeof(info), &info);
    width_ = info.bmWidth;
    height_ = info.bmHeight;
    BITMAPINFO layout = TopDownInfo(width_, height_);
    pixels_.resize(static_cast<std::size_t>(width_ * height_));
    HDC screen = GetDC(nullptr);
    GetDIBits(screen, picture, 0, static_cast<UINT>(height_), pixels_.data(), &layout,
              DIB_RGB_COLORS);
    ReleaseDC(nullptr, screen);
}

Rgb Screenshot::At(int x, int y) const {
    if (x < 0 || y < 0 || x >= width_ || y >= height_ || pixels_.empty()) return {0, 0, 0};
    std::uint32_t p = pixels_[static_cast<std::size_t>(y * width_ + x)];
    return {static_cast<std::uint8_t>(p >> 16), static_cast<std::uint8_t>(p >> 8),
            static_cast<std::uint8_t>(p)};
}

int Screenshot::DifferingPixels(const Screenshot& other, const RECT& area) const {
    int count = 0;
    for (int y = area.top; y < area.bottom; ++y) {
        for (int x = area.left; x < area.right; ++x) {
            if (At(x, y) != other.At(x, y)) ++count;
        }
    }
    return count;
}

void Screenshot::SaveForReadme(const std::wstring& name) const {
    wchar_t folder[MAX_PATH];
    DWORD length = GetEnvironmentVariableW(L"AUTOPLAY_SCREENSHOT_DIR", folder, MAX_PATH);
    if (length == 0 || length >= MAX_PATH) return;
    BITMAPINFO info = TopDownInfo(width_, height_);
    BITMAPFILEHEADER file{};
    file.bfType = 0x4D42;
    file.bfOffBits = sizeof(file) + sizeof(info.bmiHeader);
    file.bfSize = file.bfOffBits + static_cast<DWORD>(pixels_.size() * 4);
    const std::wstring path = std::wstring(folder) + L"\\" + name + L".bmp";
    HANDLE out = CreateFileW(path.c_str(), GENERIC_WRITE, 0, nullptr, CREATE_ALWAYS,
                             FILE_ATTRIBUTE_NORMAL, nullptr);
    if (out == INVALID_HANDLE_VALUE) return;
    DWORD written = 0;
    WriteFile(out, &file, sizeof(file), &written, nullptr);
    WriteFile(out, &info.bmiHeader, sizeof(info.bmiHeader), &written, nullptr);
    WriteFile(out, pixels_.data(), static_cast<DWORD>(pixels_.size() * 4), &written, nullptr);
    CloseHandle(out);
}

int ColorDistance(Rgb a, Rgb b) {
    return std::abs(a.r - b.r) + std::abs(a.g - b.g) + std::abs(a.b - b.b);
}

Screenshot SettledShot(HWND window, DWORD timeoutMs) {
    const DWORD start = GetTickCount();
    Screenshot last(window);
    for (;;) {
        Sleep(250);
        Screenshot now(window);
        RECT whole{0, 0, now.Width(), now.Height()};
        bool settled = now.Width() == last.Width() && now.DifferingPixels(last, whole) == 0;
        last = now;
        if (settled || GetTickCount() - start > timeoutMs) return last;
    }
}

namespace {

void SendMouse(DWORD flags, POINT screen) {
    INPUT input{};
    input.type = INPUT_MOUSE;
    // Absolute coordinates run from 0 to 65535 over the primary screen.
    const int width = GetSystemMetrics(SM_CXSCREEN);
    const int height = GetSystemMetrics(SM_CYSCREEN);
    input.mi.dx = static_cast<LONG>((screen.x * 65536 + width / 2) / width);
    input.mi.dy = static_cast<LONG>((screen.y * 65536 + height / 2) / height);
    input.mi.dwFlags = flags | MOUSEEVENTF_ABSOLUTE;
    SendInput(1, &input, sizeof(input));
}

}  // namespace

std::vector<ButtonSeen> ChildButtons(HWND launcher) {
    std::vector<ButtonSeen> found;
    for (HWND child = nullptr; (child = FindWindowExW(launcher, child, nullptr, nullptr));) {
        ButtonSeen seen{child,
                        ClassNameOf(child),
                        TextOfWindow(child),
                        GetDlgCtrlID(child),
                        {},
                        IsWindowVisible(child) != FALSE};
        GetWindowRect(child, &seen.place);
        MapWindowPoints(nullptr, launcher, reinterpret_cast<POINT*>(&seen.place), 2);
        found.push_back(seen);
    }
    return found;
}

HWND VisibleButton(HWND launcher, int id) {
    for (const ButtonSeen& button : ChildButtons(launcher)) {
        if (button.visible && button.id == id) return button.window;
    }
    return nullptr;
}

void MoveMouse(HWND window, POINT client) {
    POINT screen = client;
    ClientToScreen(window, &screen);
    SendMouse(MOUSEEVENTF_MOVE, screen);
    Sleep(100);
}

void Click(HWND window, POINT client) {
    MoveMouse(window, client);
    POINT screen = client;
    ClientToScreen(window, &screen);
    SendMouse(MOUSEEVENTF_LEFTDOWN, screen);
    Sleep(50);
    SendMouse(MOUSEEVENTF_LEFTUP, screen);
    Sleep(100);
}

void PressKey(WORD virtualKey, WORD modifier) {
    std::vector<INPUT> inputs;
    auto key = [&inputs](WORD code, bool up) {
        INPUT input{};
        input.type = INPUT_KEYBOARD;
        input.ki.wVk = code;
        input.ki.wScan = static_cast<WORD>(MapVirtualKeyW(code, MAPVK_VK_TO_VSC));
        input.ki.dwFlags = up ? KEYEVENTF_KEYUP : 0;
        inputs.push_back(input);
    };
    if (modifier) key(modifier, false);
    key(virtualKey, false);
    key(virtualKey, true);
    if (modifier) key(modifier, true);
    SendInput(static_cast<UINT>(inputs.size()), inputs.data(), sizeof(INPUT));
    Sleep(100);
}

HWND FocusInThreadOf(HWND window) {
    GUITHREADINFO info{};
    info.cbSize = sizeof(info);
    if (!GetGUIThreadInfo(GetWindowThreadProcessId(window, nullptr), &info)) return nullptr;
    return info.hwndFocus;
}

TestProcess::~TestProcess() {
    Release();
}

void TestProcess::Release() {
    if (!process_) return;
    if (WaitForSingleObject(process_, 0) == WAIT_TIMEOUT) {
        TerminateProcess(process_, 99);
        WaitForSingleObject(process_, 5000);
    }
    CloseHandle(process_);
    process_ = nullptr;
}

bool TestProcess::Start(const std::wstring& program, const std::wstring& arguments,
                        const std::wstring& folder) {
    Release();
    std::wstring commandLine = L"\"" + program + L"\"";
    if (!arguments.empty()) commandLine += L" " + arguments;
    STARTUPINFOW startup{};
    startup.cb = sizeof(startup);
    PROCESS_INFORMATION info{};
    // Under a loaded Wine the new process now and then fails during its own start-up; that
    // says nothing about the program, so a few bounded attempts are allowed.
    DWORD error = 0;
    for (int attempt = 0; attempt < 3; ++attempt) {
        std::wstring writable = commandLine;
        if (CreateProcessW(program.c_str(), writable.data(), nullptr, nullptr, FALSE, 0, nullptr,
                           folder.empty() ? nullptr : folder.c_str(), &startup, &info)) {
            CloseHandle(info.hThread);
            process_ = info.hProcess;
            id_ = info.dwProcessId;
            return true;
        }
        error = GetLastError();
        if (error == ERROR_FILE_NOT_FOUND || error == ERROR_PATH_NOT_FOUND) break;
        std::fprintf(stderr, "CreateProcess failed with error %lu; trying again\n", error);
        Sleep(500);
    }
    ADD_FAILURE() << "CreateProcess failed with error " << error;
    return false;
}

std::optional<DWORD> TestProcess::WaitForExit(DWORD timeoutMs) {
    if (!process_ || WaitForSingleObject(process_, timeoutMs) != WAIT_OBJECT_0) return std::nullopt;
    DWORD code = 0;
    GetExitCodeProcess(process_, &code);
    return code;
}

double ProcessorMs(DWORD processId) {
    HANDLE snapshot = CreateToolhelp32Snapshot(TH32CS_SNAPTHREAD, 0);
    if (snapshot == INVALID_HANDLE_VALUE) return 0;
    auto ms = [](const FILETIME& t) {
        return static_cast<double>(static_cast<ULONGLONG>(t.dwHighDateTime) << 32 |
                                   t.dwLowDateTime) /
               10000.0;
    };
    double total = 0;
    THREADENTRY32 entry{};
    entry.dwSize = sizeof(entry);
    for (BOOL more = Thread32First(snapshot, &entry); more; more = Thread32Next(snapshot, &entry)) {
        if (entry.th32OwnerProcessID != processId) continue;
        HANDLE thread = OpenThread(THREAD_QUERY_LIMITED_INFORMATION, FALSE, entry.th32ThreadID);
        if (!thread) continue;
        FILETIME created, ended, kernel, user;
        if (GetThreadTimes(thread, &created, &ended, &kernel, &user)) {
            total += ms(kernel) + ms(user);
        }
        CloseHandle(thread);
    }
    CloseHandle(snapshot);
    return total;
}

namespace {

MessageBoxSeen ReadMessageBox(HWND window) {
    MessageBoxSeen box{window, TextOfWindow(window), L"", {}};
    for (HWND child = nullptr; (child = FindWindowExW(window, child, nullptr, nullptr));) {
        if (SameTextIgnoringCase(ClassNameOf(child), L"Button")) {
            box.buttons.push_back(GetDlgCtrlID(child));
        } else if (SameTextIgnoringCase(ClassNameOf(child), L"Static") &&
                   GetDlgCtrlID(child) == 0xFFFF) {
            box.text = TextOfWindow(child);
        }
    }
    std::sort(box.buttons.begin(), box.buttons.end());
    return box;
}

}  // namespace

std::vector<HWND> TopLevelWindows(DWORD processId, const wchar_t* className) {
    std::vector<HWND> found;
    for (HWND window = nullptr; (window = FindWindowExW(nullptr, window, className, nullptr));) {
        DWORD owner = 0;
        GetWindowThreadProcessId(window, &owner);
        if (owner == processId && IsWindowVisible(window)) found.push_back(window);
    }
    return found;
}

HWND WaitForWindow(DWORD processId, const wchar_t* className, DWORD timeoutMs) {
    std::vector<HWND> windows;
    WaitUntil([&] { return !(windows = TopLevelWindows(processId, className)).empty(); },
              timeoutMs);
    return windows.empty() ? nullptr : windows.front();
}

bool CloseWindowOf(const wchar_t* className) {
    HWND shown = nullptr;
    if (!WaitUntil([&] { return (shown = FindWindowW(className, nullptr)) != nullptr; },
                   kWindowWaitMs)) {
        return false;
    }
    PostMessageW(shown, WM_CLOSE, 0, 0);
    return WaitUntil([&] { return !IsWindow(shown); }, kWindowWaitMs);
}

std::optional<MessageBoxSeen> WaitForMessageBox(DWORD processId, DWORD timeoutMs) {
    HWND window = WaitForWindow(processId, L"#32770", timeoutMs);
    if (!window) return std::nullopt;
    return ReadMessageBox(window);
}

std::optional<MessageBoxSeen> WaitForMessageBoxTitled(const std::wstring& caption,
                                                      DWORD timeoutMs) {
    HWND window = nullptr;
    if (!WaitUntil(
            [&] {
                window = FindWindowW(L"#32770", caption.c_str());
                return window && IsWindowVisible(window);
            },
            timeoutMs)) {
        return std::nullopt;
    }
    return ReadMessageBox(window);
}

bool PressButton(const MessageBoxSeen& box, int buttonId) {
    HWND button = GetDlgItem(box.window, buttonId);
    if (!button) return false;
    PostMessageW(button, BM_CLICK, 0, 0);
    return WaitUntil([&] { return !IsWindow(box.window) || !IsWindowVisible(box.window); },
                     kWindowWaitMs);
}

void AnswerMessageBox(DWORD processId, const std::wstring& caption, const std::wstring& text,
                      const std::vector<int>& buttons, int answer) {
    std::optional<MessageBoxSeen> box = WaitForMessageBox(processId);
    ASSERT_TRUE(box) << "nothing was said";
    EXPECT_EQ(box->caption, caption);
    EXPECT_EQ(box->text, text);
    EXPECT_EQ(box->buttons, buttons);
    EXPECT_TRUE(PressButton(*box, answer));
}

SampleDisc::SampleDisc() {
    wchar_t base[MAX_PATH];
    GetTempPathW(MAX_PATH, base);
    static unsigned counter = 0;
    root_ = std::wstring(base) + L"Vemo disc-" + std::to_wstring(GetCurrentProcessId()) + L"-" +
            std::to_wstring(++counter) + L"\\";
    RemoveTree(root_);
    std::error_code error;
    std::filesystem::copy(TestProgramFolder() + L"..\\disc", root_,
                          std::filesystem::copy_options::recursive, error);
    EXPECT_FALSE(error) << "the built sample disc could not be copied: " << error.message();
}

SampleDisc::~SampleDisc() {
    WaitUntil(
        [&] {
            RemoveTree(root_);
            return GetFileAttributesW(root_.c_str()) == INVALID_FILE_ATTRIBUTES;
        },
        5000);
}

void SampleDisc::SetEdition(int sku) const {
    std::ofstream ini(std::filesystem::path(Path(L"ORVAK.INI")), std::ios::binary);
    ini << "[SKU]\r\nSKU=" << sku << "\r\n";
    EXPECT_TRUE(ini.flush()) << "ORVAK.INI could not be written";
}

void SampleDisc::Remove(const std::wstring& relativePath) const {
    std::error_code error;
    EXPECT_GT(std::filesystem::remove_all(Path(relativePath), error), 0u) << "nothing to remove";
}

void SampleDisc::MoveAside(const std::wstring& relativePath) const {
    ASSERT_TRUE(MoveFileW(Path(relativePath).c_str(), Path(relativePath + L".away").c_str()));
}

void SampleDisc::PutBack(const std::wstring& relativePath) const {
    ASSERT_TRUE(MoveFileW(Path(relativePath + L".away").c_str(), Path(relativePath).c_str()));
}

CompanionLog::CompanionLog() {
    wchar_t base[MAX_PATH];
    GetTempPathW(MAX_PATH, base);
    path_ = std::wstring(base) + L"autoplay-companions-" + std::to_wstring(GetCurrentProcessId()) +
            L".log";
    DeleteFileW(path_.c_str());
    SetEnvironmentVariableW(L"VEMO_COMPANION_LOG", path_.c_str());
}

CompanionLog::~CompanionLog() {
    SetEnvironmentVariableW(L"VEMO_COMPANION_LOG", nullptr);
    DeleteFileW(path_.c_str());
}

std::vector<LogLine> CompanionLog::Lines() const {
    std::vector<LogLine> lines;
    std::ifstream file(std::filesystem::path(path_), std::ios::binary);
    const std::string bytes{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    std::wstring text(bytes.size(), L'\0');
    text.resize(static_cast<std::size_t>(
        MultiByteToWideChar(CP_UTF8, 0, bytes.data(), static_cast<int>(bytes.size()), text.data(),
                            static_cast<int>(text.size()))));
    std::size_t start = 0;
    for (std::size_t end = text.find(L"\r\n"); end != std::wstring::npos;
         start = end + 2, end = text.find(L"\r\n", start)) {
        const std::wstring line = text.substr(start, end - start);
        LogLine fields;
        std::size_t fieldStart = 0;
        for (std::size_t tab = line.find(L'\t'); tab != std::wstring::npos;
             fieldStart = tab + 1, tab = line.find(L'\t', fieldStart)) {
            fields.push_back(line.substr(fieldStart, tab - fieldStart));
        }
        fields.push_back(line.substr(fieldStart));
        lines.push_back(fields);
    }
    return lines;
}

void CompanionLog::ExpectNext(const std::wstring& program, const std::wstring& arguments,
                              const std::wstring& folder) {
    std::vector<LogLine> lines;
    WaitUntil([&] { return (lines = Lines()).size() > checked_; }, kWindowWaitMs);
    ASSERT_GT(lines.size(), checked_) << "nothing more was started";
    const LogLine& line = lines[checked_++];
    ASSERT_EQ(line.size(), 3u);
    EXPECT_EQ(line[0], program);
    EXPECT_EQ(line[1], arguments);
    auto bare = [](std::wstring path) {
        if (!path.empty() && path.back() == L'\\') path.pop_back();
        return path;
    };
    EXPECT_TRUE(SameTextIgnoringCase(bare(line[2]), bare(folder)))
        << "started in " << line[2] << ", not in " << folder;
}

namespace {

// The windows of the programs the commands start, closed when a test ends.
const wchar_t* const kStartedWindowClasses[] = {L"Brask", L"VemoCreatorWindow", L"TrivexWindow",
                                                L"KelpaWindow", L"Notepad"};

void ForgetTheProduct() {
    DeleteMachineKey(L"Software\\Orvak");
    DeleteMachineKey(kUninstallKeyPath);
}

}  // namespace

void LauncherTest::SetUp() {
    ForgetTheProduct();
    disc.SetEdition(1);
}

void LauncherTest::TearDown() {
    for (const wchar_t* className : kStartedWindowClasses) {
        while (HWND started = FindWindowW(className, nullptr)) {
            PostMessageW(started, WM_CLOSE, 0, 0);
            if (!WaitUntil([&] { return !IsWindow(started); }, kWindowWaitMs)) break;
        }
    }
    CloseLauncher();
    if (gameInstalled_) RunSetup(L"-u -s");
    ForgetTheProduct();
}

bool LauncherTest::Start(const std::wstring& arguments, const std::wstring& folder) {
    window = nullptr;
    if (!launcher.Start(disc.Launcher(), arguments, folder.empty() ? disc.Root() : folder)) {
        return false;
    }
    window = WaitForWindow(launcher.Id(), L"LauncherAppClass");
    if (!window) {
        ADD_FAILURE() << "the launcher showed no window";
        return false;
    }
    Rest();
    return true;
}

Screenshot LauncherTest::Rest() const {
    MoveMouse(window, kRestPoint);
    WaitUntil([&] { return FocusInThreadOf(window) == window; }, 3000);
    return SettledShot(window);
}

bool LauncherTest::Press(int id) const {
    HWND button = nullptr;
    if (!WaitUntil([&] { return (button = VisibleButton(window, id)) != nullptr; }, 5000)) {
        ADD_FAILURE() << "no visible button " << id;
        return false;
    }
    RECT place{};
    GetWindowRect(button, &place);
    POINT middle{(place.left + place.right) / 2, (place.top + place.bottom) / 2};
    if (!WaitUntil([&] { return WindowFromPoint(middle) == button; }, 5000)) {
        ADD_FAILURE() << "something lies over button " << id;
        return false;
    }
    ScreenToClient(window, &middle);
    Click(window, middle);
    return true;
}

bool LauncherTest::PressInPanel(int opener, int id) const {
    if (!VisibleButton(window, id) && !Press(opener)) return false;
    return Press(id);
}

std::optional<DWORD> LauncherTest::CloseLauncher() {
    for (HWND shown : TopLevelWindows(launcher.Id(), L"LauncherAppClass")) {
        PostMessageW(shown, WM_CLOSE, 0, 0);
    }
    return launcher.WaitForExit(kWindowWaitMs);
}

bool LauncherTest::StillRunning() {
    return !launcher.WaitForExit(0) && IsWindow(window);
}

std::optional<DWORD> LauncherTest::RunSetup(const std::wstring& arguments) {
    TestProcess setup;
    if (!setup.Start(disc.Path(L"Setup\\setup.exe"), arguments, disc.Path(L"Setup"))) {
        return std::nullopt;
    }
    gameInstalled_ = arguments.find(L"-u") == std::wstring::npos;
    return setup.WaitForExit(3 * kWindowWaitMs);
}
