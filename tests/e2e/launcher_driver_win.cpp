#include "launcher_driver_win.h"

// After windows.h, whose types it uses.
#include <tlhelp32.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sstream>

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
    POINT origin{0, 0};
    ClientToScreen(window, &origin);
    WindowDc screen(nullptr);
    MemoryDc memory(CreateCompatibleDC(screen.Get()));
    UniqueGdi<HBITMAP> copy(CreateCompatibleBitmap(screen.Get(), client.right, client.bottom));
    {
        SelectionGuard selected(memory.Get(), copy.Get());
        BitBlt(memory.Get(), 0, 0, client.right, client.bottom, screen.Get(), origin.x, origin.y,
               SRCCOPY);
    }
    *this = Screenshot(copy.Get());
}

Screenshot::Screenshot(HBITMAP picture) {
    BITMAP info{};
    GetObjectW(picture, sizeof(info), &info);
    width_ = info.bmWidth;
    height_ = info.bmHeight;
    BITMAPINFO layout = TopDownInfo(width_, height_);
    pixels_.resize(static_cast<std::size_t>(width_ * height_));
    WindowDc screen(nullptr);
    GetDIBits(screen.Get(), picture, 0, static_cast<UINT>(height_), pixels_.data(), &layout,
              DIB_RGB_COLORS);
}

Rgb Screenshot::At(int x, int y) const {
    if (x < 0 || y < 0 || x >= width_ || y >= height_ || pixels_.empty()) return {0, 0, 0};
    std::uint32_t p = pixels_[static_cast<std::size_t>(y * width_ + x)];
    return {static_cast<std::uint8_t>(p >> 16), static_cast<std::uint8_t>(p >> 8),
            static_cast<std::uint8_t>(p)};
}

int Screenshot::DifferingPixels(const Screenshot& other, const RECT& area, int tolerance) const {
    int count = 0;
    for (int y = area.top; y < area.bottom; ++y) {
        for (int x = area.left; x < area.right; ++x) {
            if (ColorDistance(At(x, y), other.At(x, y)) > tolerance) ++count;
        }
    }
    return count;
}

void Screenshot::SaveForReadme(const std::wstring& name) const {
    const wchar_t* folder = _wgetenv(L"AUTOPLAY_SCREENSHOT_DIR");
    if (!folder) return;
    const BITMAPINFO info = TopDownInfo(width_, height_);
    const DWORD headers = sizeof(BITMAPFILEHEADER) + sizeof(info.bmiHeader);
    const DWORD pixelBytes = static_cast<DWORD>(pixels_.size() * 4);
    const BITMAPFILEHEADER file{0x4D42, headers + pixelBytes, 0, 0, headers};
    std::ofstream out(std::filesystem::path(std::wstring(folder) + L"\\" + name + L".bmp"),
                      std::ios::binary);
    out.write(reinterpret_cast<const char*>(&file), sizeof(file));
    out.write(reinterpret_cast<const char*>(&info.bmiHeader), sizeof(info.bmiHeader));
    out.write(reinterpret_cast<const char*>(pixels_.data()), pixelBytes);
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

void SendMouse(HWND window, POINT client, DWORD flags) {
    POINT screen = client;
    ClientToScreen(window, &screen);
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
        ButtonSeen seen{child, ClassNameOf(child), TextOfWindow(child), GetDlgCtrlID(child),
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
    SendMouse(window, client, MOUSEEVENTF_MOVE);
    Sleep(100);
}

void Click(HWND window, POINT client) {
    MoveMouse(window, client);
    SendMouse(window, client, MOUSEEVENTF_LEFTDOWN);
    Sleep(50);
    SendMouse(window, client, MOUSEEVENTF_LEFTUP);
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
    auto ms = [](FILETIME t) {
        return (static_cast<ULONGLONG>(t.dwHighDateTime) << 32 | t.dwLowDateTime) / 10000.0;
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

void ExpectIdle(DWORD processId, const char* what) {
    const double before = ProcessorMs(processId);
    const DWORD start = GetTickCount();
    Sleep(5000);
    const double used = ProcessorMs(processId) - before;
    const DWORD elapsed = GetTickCount() - start;
    std::printf("processor time %s: %.1f ms in %lu ms\n", what, used,
                static_cast<unsigned long>(elapsed));
    EXPECT_LT(used, elapsed * 0.01) << "over 1 % of one core while nothing happens";
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

std::vector<HWND> TopLevelWindows(DWORD processId, const wchar_t* className,
                                  const wchar_t* caption) {
    std::vector<HWND> found;
    for (HWND window = nullptr; (window = FindWindowExW(nullptr, window, className, caption));) {
        DWORD owner = 0;
        GetWindowThreadProcessId(window, &owner);
        if ((!processId || owner == processId) && IsWindowVisible(window)) found.push_back(window);
    }
    return found;
}

HWND WaitForWindow(DWORD processId, const wchar_t* className, const wchar_t* caption,
                   DWORD timeoutMs) {
    std::vector<HWND> windows;
    WaitUntil([&] { return !(windows = TopLevelWindows(processId, className, caption)).empty(); },
              timeoutMs);
    return windows.empty() ? nullptr : windows.front();
}

bool CloseWindowOf(const wchar_t* className) {
    HWND shown = WaitForWindow(0, className);
    if (!shown) return false;
    PostMessageW(shown, WM_CLOSE, 0, 0);
    return WaitUntil([&] { return !IsWindow(shown); }, kWindowWaitMs);
}

std::optional<MessageBoxSeen> WaitForMessageBox(DWORD processId, const wchar_t* caption,
                                                DWORD timeoutMs) {
    HWND window = WaitForWindow(processId, L"#32770", caption, timeoutMs);
    if (!window) return std::nullopt;
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

SampleDisc::SampleDisc() : root_(folder_.Path() + L"Vemo disc\\") {
    std::error_code error;
    std::filesystem::copy(TestProgramFolder() + L"..\\disc", root_,
                          std::filesystem::copy_options::recursive, error);
    EXPECT_FALSE(error) << "the built sample disc could not be copied: " << error.message();
}

void SampleDisc::SetEdition(int sku) const {
    std::ofstream ini(std::filesystem::path(Path(L"ORVAK.INI")), std::ios::binary);
    ini << "[SKU]\r\nSKU=" << sku << "\r\n";
    EXPECT_TRUE(ini.flush()) << "ORVAK.INI could not be written";
}

void SampleDisc::MoveAside(const std::wstring& relativePath) const {
    ASSERT_TRUE(MoveFileW(Path(relativePath).c_str(), Path(relativePath + L".away").c_str()));
}

void SampleDisc::PutBack(const std::wstring& relativePath) const {
    ASSERT_TRUE(MoveFileW(Path(relativePath + L".away").c_str(), Path(relativePath).c_str()));
}

std::wstring InstalledFolder(const std::wstring& name) {
    const std::wstring maker = _wgetenv(L"ProgramFiles") + std::wstring(L"\\Orvak");
    return name.empty() ? maker : maker + L"\\" + name;
}

CompanionLog::CompanionLog() : path_(folder_.Path() + L"companions.log") {
    SetEnvironmentVariableW(L"VEMO_COMPANION_LOG", path_.c_str());
}

CompanionLog::~CompanionLog() {
    SetEnvironmentVariableW(L"VEMO_COMPANION_LOG", nullptr);
}

std::vector<LogLine> CompanionLog::Lines() const {
    std::ifstream file(std::filesystem::path(path_), std::ios::binary);
    const std::string bytes{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    std::wstring text(bytes.size(), L'\0');
    text.resize(static_cast<std::size_t>(
        MultiByteToWideChar(CP_UTF8, 0, bytes.data(), static_cast<int>(bytes.size()), text.data(),
                            static_cast<int>(text.size()))));
    std::vector<LogLine> lines;
    std::wistringstream rows(text);
    for (std::wstring row; std::getline(rows, row, L'\n');) {
        if (row.empty() || row.back() != L'\r') break;  // a line still being written
        row.pop_back();
        LogLine& fields = lines.emplace_back();
        std::wistringstream parts(row + L'\t');
        for (std::wstring field; std::getline(parts, field, L'\t');) fields.push_back(field);
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
    SetEnvironmentVariableW(L"VEMO_SETUP_SILENT", nullptr);
    RemoveTree(InstalledFolder(L""));
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

void LauncherTest::ExpectSecondLauncherEndsAtOnce() const {
    TestProcess second;
    ASSERT_TRUE(second.Start(disc.Launcher(), L"", disc.Root()));
    EXPECT_EQ(second.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    EXPECT_TRUE(TopLevelWindows(second.Id()).empty()) << "the second launcher showed a window";
}

namespace {

// HKEY_CLASSES_ROOT merges the machine's and the user's classes: both are set aside.
const HKEY kHives[] = {HKEY_LOCAL_MACHINE, HKEY_CURRENT_USER};
const wchar_t kClasses[] = L"Software\\Classes\\";
const wchar_t kTestKeys[] = L"Software\\AutoPlay tests";
const wchar_t* const kNames[] = {
    L"http", L"https", L".htm", L".mpg", L"AutoPlayTests.htm", L"AutoPlayTests.mpg"};

void DeleteKey(HKEY hive, const std::wstring& path) {
    if (RegDeleteTreeW(hive, path.c_str()) == ERROR_SUCCESS) RegDeleteKeyW(hive, path.c_str());
}

// Moves a key with everything below it over whatever `to` held; nothing when `from` is absent.
void MoveKey(HKEY hive, const std::wstring& from, const std::wstring& to) {
    DeleteKey(hive, to);
    HKEY source = nullptr, target = nullptr;
    if (RegOpenKeyExW(hive, from.c_str(), 0, KEY_READ, &source) != ERROR_SUCCESS) return;
    RegCreateKeyExW(hive, to.c_str(), 0, nullptr, 0, KEY_ALL_ACCESS, nullptr, &target, nullptr);
    const bool copied = target && RegCopyTreeW(source, nullptr, target) == ERROR_SUCCESS;
    RegCloseKey(source);
    if (target) RegCloseKey(target);
    ASSERT_TRUE(copied) << "could not copy " << from;
    DeleteKey(hive, from);
    EXPECT_NE(RegOpenKeyExW(hive, from.c_str(), 0, KEY_READ, &source), ERROR_SUCCESS)
        << "could not move " << from;
}

void SetText(const std::wstring& keyPath, const wchar_t* name, const std::wstring& text) {
    const std::wstring path = kClasses + keyPath;
    ASSERT_EQ(RegSetKeyValueW(HKEY_LOCAL_MACHINE, path.c_str(), name, REG_SZ, text.c_str(),
                              static_cast<DWORD>((text.size() + 1) * sizeof(wchar_t))),
              ERROR_SUCCESS);
}

std::wstring OpenCommand(const std::wstring& program) {
    return L"\"" + program + L"\" \"%1\"";
}

}  // namespace

ShellAssociations::ShellAssociations() {
    for (HKEY hive : kHives) {
        for (const wchar_t* name : kNames) {
            MoveKey(hive, kClasses + std::wstring(name), kTestKeys + (L"\\" + std::wstring(name)));
        }
    }
}

ShellAssociations::~ShellAssociations() {
    for (HKEY hive : kHives) {
        for (const wchar_t* name : kNames) {
            MoveKey(hive, kTestKeys + (L"\\" + std::wstring(name)), kClasses + std::wstring(name));
        }
        DeleteKey(hive, kTestKeys);
    }
}

void ShellAssociations::OpenWebAddressesWith(const std::wstring& program) const {
    for (const wchar_t* protocol : {L"http", L"https"}) {
        SetText(protocol, nullptr, L"URL:" + std::wstring(protocol));
        SetText(protocol, L"URL Protocol", L"");
        SetText(std::wstring(protocol) + L"\\shell\\open\\command", nullptr, OpenCommand(program));
    }
}

void ShellAssociations::OpenFilesWith(const wchar_t* extension, const std::wstring& program) const {
    const std::wstring kind = L"AutoPlayTests" + std::wstring(extension);
    SetText(extension, nullptr, kind);
    SetText(kind + L"\\shell\\open\\command", nullptr, OpenCommand(program));
}

void ShellAssociations::OpenEverythingWithViewer() const {
    OpenWebAddressesWith(ViewerProgram());
    OpenFilesWith(L".htm", ViewerProgram());
    OpenFilesWith(L".mpg", ViewerProgram());
}

void ShellAssociations::Forget() const {
    for (const wchar_t* name : kNames) DeleteKey(HKEY_LOCAL_MACHINE, kClasses + std::wstring(name));
}

std::wstring ViewerProgram() {
    return TestProgramFolder() + L"viewer.exe";
}
