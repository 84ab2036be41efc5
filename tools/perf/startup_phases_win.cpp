// Where the launcher's start-up time goes, phase by phase, measured inside a process that
// starts the way the launcher does: the catalogue's steps, the window, the music, the buttons
// and the first paint, each timed on its own. Every run is a fresh process, so caches and
// first-use costs (fonts, GDI, the sound system) count as they do for the launcher.
//   startup_phases.exe DISC_FOLDER [RUNS]
// Prints the median of every phase over the runs.
// clang-format off
#include <windows.h>
#include <mmsystem.h>  // after the types windows.h declares
// clang-format on

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <cwchar>
#include <map>
#include <string>
#include <vector>

#include "locale/catalogue_win.h"
#include "locale/config_win.h"
#include "locale/picture_ids.h"
#include "shell/launcher_state.h"
#include "shell/window_win.h"

namespace {

constexpr DWORD kChildTimeoutMs = 60000;
constexpr wchar_t kChildSwitch[] = L"--child";
constexpr wchar_t kBenchClassName[] = L"StartupPhasesClass";

double Milliseconds(LARGE_INTEGER from, LARGE_INTEGER to) {
    LARGE_INTEGER frequency;
    QueryPerformanceFrequency(&frequency);
    return static_cast<double>(to.QuadPart - from.QuadPart) * 1000.0 /
           static_cast<double>(frequency.QuadPart);
}

class PhaseClock {
  public:
    PhaseClock() { QueryPerformanceCounter(&last_); }
    // Prints the time since the previous phase ended under this phase's name.
    void Lap(const char* phase) {
        LARGE_INTEGER now;
        QueryPerformanceCounter(&now);
        std::printf("%s=%.2f\n", phase, Milliseconds(last_, now));
        last_ = now;
    }

  private:
    LARGE_INTEGER last_;
};

// Time from the process's creation to its entry point: loading, relocation, runtime start-up.
double MillisecondsSinceProcessCreation() {
    FILETIME creation, exit, kernel, user, now;
    if (!GetProcessTimes(GetCurrentProcess(), &creation, &exit, &kernel, &user)) return -1;
    GetSystemTimePreciseAsFileTime(&now);
    ULARGE_INTEGER a{{creation.dwLowDateTime, creation.dwHighDateTime}};
    ULARGE_INTEGER b{{now.dwLowDateTime, now.dwHighDateTime}};
    return static_cast<double>(b.QuadPart - a.QuadPart) / 10000.0;
}

// One start-up in this process, as the launcher runs it, with the phases printed as they end.
int RunChild(const wchar_t* disc) {
    std::printf("process start=%.2f\n", MillisecondsSinceProcessCreation());
    PhaseClock clock;
    HINSTANCE instance = GetModuleHandleW(nullptr);
    std::wstring root = disc;
    if (root.empty() || root.back() != L'\\') root += L'\\';
    wcsncpy(launcher.rootPath, root.c_str(), kRootPathCapacity - 1);
    launcher.instance = instance;
    // US English settled on the command line: the first frame is the main menu's.
    ReadConfiguration(L"-l0409");
    clock.Lap("configuration");

    // The launcher registers its class before loading anything: the first call that needs
    // the display starts it.
    WNDCLASSEXW windowClass{};
    windowClass.cbSize = sizeof(windowClass);
    windowClass.style = CS_VREDRAW | CS_HREDRAW | CS_OWNDC;
    windowClass.lpfnWndProc = MainWindowProc;
    windowClass.hInstance = instance;
    windowClass.hIcon = LoadIconW(instance, MAKEINTRESOURCEW(kProgramIconId));
    windowClass.hCursor = LoadCursorW(nullptr, IDC_ARROW);
    windowClass.lpszClassName = kBenchClassName;
    RegisterClassExW(&windowClass);
    clock.Lap("class (display start)");

    for (const CatalogueStep& step : CatalogueSteps()) {
        step.run();
        clock.Lap(step.name);
    }
    if (launcher.backgroundWidth == 0) {
        std::fprintf(stderr, "no background loaded from %ls\n", root.c_str());
        return 1;
    }
    int width = launcher.backgroundWidth + 2 * GetSystemMetrics(SM_CXDLGFRAME);
    int height = launcher.backgroundHeight + 2 * GetSystemMetrics(SM_CYDLGFRAME);
    launcher.mainWindow = CreateWindowExW(0, kBenchClassName, kWindowTitle, WS_POPUP | WS_DLGFRAME,
                                          0, 0, width, height, nullptr, nullptr, instance, nullptr);
    clock.Lap("window");
    if (!launcher.mainWindow) return 1;
    PlaySoundW(MAKEINTRESOURCEW(kMusicId), nullptr, SND_RESOURCE | SND_ASYNC);
    clock.Lap("music");
    launcher.openPanel = kNoPanel;
    launcher.menu.StartMainMenu(launcher.mainWindow);
    clock.Lap("buttons");
    ShowWindow(launcher.mainWindow, SW_SHOWNORMAL);
    clock.Lap("show window");
    UpdateWindow(launcher.mainWindow);
    GdiFlush();
    clock.Lap("first paint");

    PlaySoundW(nullptr, nullptr, 0);
    launcher.menu.DestroyAllButtons();
    ReleaseCatalogue();
    DestroyWindow(launcher.mainWindow);
    std::fflush(stdout);
    return 0;
}

// Runs one child and collects its "phase=milliseconds" lines, in the order printed.
bool RunOnce(const std::wstring& self, const std::wstring& disc,
             std::vector<std::pair<std::string, double>>& phases) {
    SECURITY_ATTRIBUTES inherit{sizeof(inherit), nullptr, TRUE};
    HANDLE readEnd = nullptr, writeEnd = nullptr;
    if (!CreatePipe(&readEnd, &writeEnd, &inherit, 0)) return false;
    SetHandleInformation(readEnd, HANDLE_FLAG_INHERIT, 0);
    STARTUPINFOW startup{};
    startup.cb = sizeof(startup);
    startup.dwFlags = STARTF_USESTDHANDLES;
    startup.hStdOutput = writeEnd;
    startup.hStdError = GetStdHandle(STD_ERROR_HANDLE);
    startup.hStdInput = GetStdHandle(STD_INPUT_HANDLE);
    // No trailing backslash inside the quotes: it would escape the closing quote.
    std::wstring folder = disc.substr(0, disc.find_last_not_of(L'\\') + 1);
    std::wstring commandLine = L"\"" + self + L"\" " + kChildSwitch + L" \"" + folder + L"\"";
    PROCESS_INFORMATION process{};
    BOOL started = CreateProcessW(self.c_str(), commandLine.data(), nullptr, nullptr, TRUE, 0,
                                  nullptr, disc.c_str(), &startup, &process);
    CloseHandle(writeEnd);
    if (!started) {
        CloseHandle(readEnd);
        return false;
    }
    // The child writes a few hundred bytes and ends, so reading to the end cannot block
    // for longer than the child lives; the wait below bounds that.
    std::string output;
    char buffer[512];
    DWORD got = 0;
    while (ReadFile(readEnd, buffer, sizeof(buffer), &got, nullptr) && got > 0) {
        output.append(buffer, got);
    }
    CloseHandle(readEnd);
    bool ended = WaitForSingleObject(process.hProcess, kChildTimeoutMs) == WAIT_OBJECT_0;
    if (!ended) TerminateProcess(process.hProcess, 1);
    DWORD code = 1;
    GetExitCodeProcess(process.hProcess, &code);
    CloseHandle(process.hProcess);
    CloseHandle(process.hThread);
    if (!ended || code != 0) return false;

    std::size_t at = 0;
    while (at < output.size()) {
        std::size_t end = output.find('\n', at);
        if (end == std::string::npos) end = output.size();
        std::string line = output.substr(at, end - at);
        at = end + 1;
        std::size_t equals = line.find('=');
        if (equals == std::string::npos) continue;
        phases.emplace_back(line.substr(0, equals), std::atof(line.c_str() + equals + 1));
    }
    return !phases.empty();
}

double Median(std::vector<double> values) {
    std::sort(values.begin(), values.end());
    return values.empty() ? 0 : values[values.size() / 2];
}

}  // namespace

int wmain(int argc, wchar_t** argv) {
    if (argc >= 3 && std::wcscmp(argv[1], kChildSwitch) == 0) return RunChild(argv[2]);
    if (argc < 2) {
        std::fprintf(stderr, "usage: startup_phases DISC_FOLDER [RUNS]\n");
        return 2;
    }
    std::wstring disc = argv[1];
    if (disc.back() != L'\\') disc += L'\\';
    int runs = argc > 2 ? std::max(1, _wtoi(argv[2])) : 7;
    wchar_t self[MAX_PATH];
    GetModuleFileNameW(nullptr, self, MAX_PATH);

    std::vector<std::string> order;
    std::map<std::string, std::vector<double>> times;
    int completed = 0;
    for (int run = 0; run < runs; ++run) {
        std::vector<std::pair<std::string, double>> phases;
        if (!RunOnce(self, disc, phases)) {
            std::fprintf(stderr, "run %d did not complete\n", run + 1);
            continue;
        }
        ++completed;
        for (const auto& [name, ms] : phases) {
            if (!times.count(name)) order.push_back(name);
            times[name].push_back(ms);
        }
    }
    if (completed == 0) return 1;
    std::printf("start-up phases, median of %d fresh processes (ms):\n", completed);
    double total = 0;
    for (const std::string& name : order) {
        double median = Median(times[name]);
        total += median;
        std::printf("  %-18s %8.1f\n", name.c_str(), median);
    }
    std::printf("  %-18s %8.1f\n", "sum of medians", total);
    return 0;
}
