// Measures, under Wine or Windows, the time from starting a program to its first painted frame:
// the launcher on a disc against an empty window program started the same way.
//   first_paint.exe DISC_FOLDER [RUNS]
// Prints each run and the ratio of the medians.
#include <windows.h>

#include <algorithm>
#include <cstdio>
#include <string>
#include <vector>

namespace {

constexpr DWORD kTimeoutMs = 30000;

struct Target {
    std::wstring program;
    std::wstring arguments;
    std::wstring folder;
    const wchar_t* windowClass;
    POINT probe;          // a client point whose colour proves the frame is painted
    COLORREF painted;
};

struct WindowSearch {
    DWORD processId;
    const wchar_t* windowClass;
    HWND found;
};

BOOL CALLBACK MatchWindow(HWND window, LPARAM context) {
    auto* search = reinterpret_cast<WindowSearch*>(context);
    DWORD owner = 0;
    GetWindowThreadProcessId(window, &owner);
    wchar_t name[64] = {};
    GetClassNameW(window, name, 64);
    if (owner == search->processId && IsWindowVisible(window) &&
        lstrcmpW(name, search->windowClass) == 0) {
        search->found = window;
        return FALSE;
    }
    return TRUE;
}

HWND FindVisibleWindow(DWORD processId, const wchar_t* windowClass) {
    WindowSearch search{processId, windowClass, nullptr};
    EnumWindows(MatchWindow, reinterpret_cast<LPARAM>(&search));
    return search.found;
}

// Milliseconds from CreateProcess to the probe pixel showing its painted colour; -1 on timeout.
double TimeToFirstFrame(const Target& target) {
    LARGE_INTEGER frequency, start, now;
    QueryPerformanceFrequency(&frequency);
    std::wstring commandLine = L"\"" + target.program + L"\" " + target.arguments;
    STARTUPINFOW startup{};
    startup.cb = sizeof(startup);
    PROCESS_INFORMATION info{};
    QueryPerformanceCounter(&start);
    if (!CreateProcessW(target.program.c_str(), commandLine.data(), nullptr, nullptr, FALSE, 0,
                        nullptr, target.folder.c_str(), &startup, &info)) {
        return -1;
    }
    double elapsed = -1;
    for (;;) {
        QueryPerformanceCounter(&now);
        double ms = (now.QuadPart - start.QuadPart) * 1000.0 / frequency.QuadPart;
        if (ms > kTimeoutMs) break;
        if (HWND window = FindVisibleWindow(info.dwProcessId, target.windowClass)) {
            POINT point = target.probe;
            ClientToScreen(window, &point);
            HDC screen = GetDC(nullptr);
            COLORREF color = GetPixel(screen, point.x, point.y);
            ReleaseDC(nullptr, screen);
            if (color == target.painted) {
                elapsed = ms;
                PostMessageW(window, WM_CLOSE, 0, 0);
                break;
            }
        }
        Sleep(1);
    }
    if (WaitForSingleObject(info.hProcess, 10000) != WAIT_OBJECT_0) TerminateProcess(info.hProcess, 1);
    CloseHandle(info.hProcess);
    CloseHandle(info.hThread);
    return elapsed;
}

// The colour of a point of a background file, as the launcher will show it.
COLORREF ColorInBackground(const std::wstring& path, POINT point) {
    HBITMAP picture = static_cast<HBITMAP>(
        LoadImageW(nullptr, path.c_str(), IMAGE_BITMAP, 0, 0, LR_LOADFROMFILE | LR_CREATEDIBSECTION));
    if (!picture) return CLR_INVALID;
    HDC memory = CreateCompatibleDC(nullptr);
    HGDIOBJ previous = SelectObject(memory, picture);
    COLORREF color = GetPixel(memory, point.x, point.y);
    SelectObject(memory, previous);
    DeleteDC(memory);
    DeleteObject(picture);
    return color;
}

double Median(std::vector<double> values) {
    std::sort(values.begin(), values.end());
    return values.empty() ? -1 : values[values.size() / 2];
}

}  // namespace

int wmain(int argc, wchar_t** argv) {
    if (argc < 2) {
        std::fprintf(stderr, "usage: first_paint DISC_FOLDER [RUNS]\n");
        return 2;
    }
    std::wstring disc = argv[1];
    if (disc.back() != L'\\') disc += L'\\';
    int runs = argc > 2 ? _wtoi(argv[2]) : 5;
    wchar_t self[MAX_PATH];
    GetModuleFileNameW(nullptr, self, MAX_PATH);
    std::wstring here(self);
    here.resize(here.rfind(L'\\') + 1);

    POINT probe{600, 20};  // clear of every button and caption
    // US English settled on the command line: the first frame is the main menu's background.
    Target launcher{disc + L"AutoPlay.exe", L"-l0409", disc, L"LauncherAppClass", probe,
                    ColorInBackground(disc + L"Launcher\\AutoPlayBack.bmp", probe)};
    Target empty{here + L"empty_window.exe", L"", disc, L"EmptyWindowClass", probe, RGB(255, 255, 255)};
    if (launcher.painted == CLR_INVALID) {
        std::fprintf(stderr, "no US English background on the disc\n");
        return 1;
    }
    std::vector<double> launcherTimes, emptyTimes;
    for (int run = 0; run < runs; ++run) {
        double e = TimeToFirstFrame(empty);
        double l = TimeToFirstFrame(launcher);
        std::printf("run %d: empty window %.1f ms, launcher %.1f ms\n", run + 1, e, l);
        if (e > 0) emptyTimes.push_back(e);
        if (l > 0) launcherTimes.push_back(l);
    }
    double e = Median(emptyTimes);
    double l = Median(launcherTimes);
    if (e <= 0 || l <= 0) {
        std::printf("a program showed no painted frame within %lu ms\n", kTimeoutMs);
        return 1;
    }
    std::printf("median to first painted frame: empty window %.1f ms, launcher %.1f ms, ratio %.2f"
                " (goal: at most 1.5)\n",
                e, l, l / e);
    return 0;
}
