#include "e2e_support_win.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>

#include "test_support_win.h"

namespace {

std::wstring ClassNameOf(HWND window) {
    wchar_t name[128] = {};
    GetClassNameW(window, name, 128);
    return name;
}

std::wstring TextOf(HWND window) {
    int length = GetWindowTextLengthW(window);
    std::wstring text(static_cast<std::size_t>(length) + 1, L'\0');
    GetWindowTextW(window, text.data(), length + 1);
    text.resize(static_cast<std::size_t>(length));
    return text;
}

struct WindowSearch {
    DWORD processId;
    const wchar_t* className;
    std::vector<HWND> found;
};

BOOL CALLBACK CollectWindow(HWND window, LPARAM context) {
    auto* search = reinterpret_cast<WindowSearch*>(context);
    DWORD owner = 0;
    GetWindowThreadProcessId(window, &owner);
    if (owner == search->processId && IsWindowVisible(window) &&
        (search->className == nullptr || ClassNameOf(window) == search->className)) {
        search->found.push_back(window);
    }
    return TRUE;
}

BOOL CALLBACK CollectButton(HWND child, LPARAM context) {
    auto* box = reinterpret_cast<MessageBoxSeen*>(context);
    if (SameTextIgnoringCase(ClassNameOf(child), L"Button")) {
        box->buttons.push_back(GetDlgCtrlID(child));
    } else if (SameTextIgnoringCase(ClassNameOf(child), L"Static") && GetDlgCtrlID(child) == 0xFFFF) {
        box->text = TextOf(child);
    }
    return TRUE;
}

}  // namespace

bool SameTextIgnoringCase(const std::wstring& a, const std::wstring& b) {
    return CompareStringOrdinal(a.c_str(), static_cast<int>(a.size()), b.c_str(),
                                static_cast<int>(b.size()), TRUE) == CSTR_EQUAL;
}

TestProcess::~TestProcess() {
    if (process_) {
        if (WaitForSingleObject(process_, 0) == WAIT_TIMEOUT) {
            TerminateProcess(process_, 99);
            WaitForSingleObject(process_, 5000);
        }
        CloseHandle(process_);
    }
}

bool TestProcess::Start(const std::wstring& program, const std::wstring& arguments,
                        const std::wstring& folder) {
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

std::vector<HWND> TopLevelWindows(DWORD processId, const wchar_t* className) {
    WindowSearch search{processId, className, {}};
    EnumWindows(CollectWindow, reinterpret_cast<LPARAM>(&search));
    return search.found;
}

HWND WaitForWindow(DWORD processId, const wchar_t* className, DWORD timeoutMs) {
    DWORD start = GetTickCount();
    do {
        std::vector<HWND> windows = TopLevelWindows(processId, className);
        if (!windows.empty()) return windows.front();
        Sleep(50);
    } while (GetTickCount() - start < timeoutMs);
    return nullptr;
}

namespace {

MessageBoxSeen ReadMessageBox(HWND window) {
    MessageBoxSeen box;
    box.window = window;
    box.caption = TextOf(window);
    EnumChildWindows(window, CollectButton, reinterpret_cast<LPARAM>(&box));
    std::sort(box.buttons.begin(), box.buttons.end());
    return box;
}

}  // namespace

std::optional<MessageBoxSeen> WaitForMessageBoxTitled(const std::wstring& caption,
                                                      DWORD timeoutMs) {
    DWORD start = GetTickCount();
    do {
        HWND window = FindWindowW(L"#32770", caption.c_str());
        if (window && IsWindowVisible(window)) return ReadMessageBox(window);
        Sleep(50);
    } while (GetTickCount() - start < timeoutMs);
    return std::nullopt;
}

std::optional<MessageBoxSeen> WaitForMessageBox(DWORD processId, DWORD timeoutMs) {
    HWND window = WaitForWindow(processId, L"#32770", timeoutMs);
    if (!window) return std::nullopt;
    return ReadMessageBox(window);
}


bool PressButton(const MessageBoxSeen& box, int buttonId) {
    HWND button = GetDlgItem(box.window, buttonId);
    if (!button) return false;
    PostMessageW(button, BM_CLICK, 0, 0);
    DWORD start = GetTickCount();
    while (IsWindow(box.window) && IsWindowVisible(box.window)) {
        if (GetTickCount() - start > kWindowWaitMs) return false;
        Sleep(20);
    }
    return true;
}

DiscFolder::DiscFolder() { AddBuiltProgram(L"AutoPlay.exe", L"AutoPlay.exe"); }

void DiscFolder::AddFile(const std::wstring& relativePath, const std::string& bytes) const {
    folder_.WriteFile(relativePath, bytes);
}

void DiscFolder::AddBuiltProgram(const std::wstring& builtName,
                                 const std::wstring& relativePath) const {
    std::wstring target = folder_.MakeFoldersFor(relativePath);
    ASSERT_TRUE(CopyFileW((TestProgramFolder() + builtName).c_str(), target.c_str(), FALSE))
        << "missing built program";
}

void DiscFolder::AddDiscOneFiles() const {
    AddFile(L"Setup\\Tolven8.iff", "disc one");
    AddFile(L"Setup\\data2.cab", "cabinet");
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

std::vector<std::vector<std::wstring>> CompanionLog::Lines() const {
    std::vector<std::vector<std::wstring>> lines;
    HANDLE file = CreateFileW(path_.c_str(), GENERIC_READ, FILE_SHARE_READ | FILE_SHARE_WRITE,
                              nullptr, OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file == INVALID_HANDLE_VALUE) return lines;
    std::string bytes;
    char chunk[4096];
    DWORD read = 0;
    while (ReadFile(file, chunk, sizeof(chunk), &read, nullptr) && read > 0) bytes.append(chunk, read);
    CloseHandle(file);
    int size = MultiByteToWideChar(CP_UTF8, 0, bytes.data(), static_cast<int>(bytes.size()), nullptr, 0);
    std::wstring text(static_cast<std::size_t>(size), L'\0');
    MultiByteToWideChar(CP_UTF8, 0, bytes.data(), static_cast<int>(bytes.size()), text.data(), size);
    std::size_t start = 0;
    for (std::size_t end = text.find(L"\r\n"); end != std::wstring::npos;
         start = end + 2, end = text.find(L"\r\n", start)) {
        std::wstring line = text.substr(start, end - start);
        std::vector<std::wstring> fields;
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

std::vector<std::vector<std::wstring>> CompanionLog::WaitForLines(std::size_t count,
                                                                  DWORD timeoutMs) const {
    DWORD start = GetTickCount();
    for (;;) {
        auto lines = Lines();
        if (lines.size() >= count || GetTickCount() - start > timeoutMs) return lines;
        Sleep(50);
    }
}
