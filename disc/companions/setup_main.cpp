// The sample disc's installer: "setup.exe -l0407" installs The Vemo Vodizuri Virezazida in
// German, "-u" removes it, "-s" (or VEMO_SETUP_SILENT=1, for programs started through the
// launcher) asks nothing and shows no result. The exit code tells the outcome.
#include <windows.h>

#include <string>

#include "companion_log.h"
#include "installer_win.h"
#include "setup_options.h"

namespace {

constexpr wchar_t kCaption[] = L"The Vemo Vodizuri Virezazida Setup";
constexpr wchar_t kUsage[] =
    L"Usage: setup [-l<language id in hexadecimal>] [-s] [-u]\n\n"
    L"-l0407 installs in German, -s installs without asking, -u removes the game.";

bool SilentByEnvironment() {
    wchar_t value[8] = {};
    DWORD length = GetEnvironmentVariableW(L"VEMO_SETUP_SILENT", value, 8);
    return length == 1 && value[0] == L'1';
}

int Ask(const std::wstring& question) {
    return MessageBoxW(nullptr, question.c_str(), kCaption,
                       MB_OKCANCEL | MB_ICONQUESTION | MB_SETFOREGROUND);
}

void Tell(const std::wstring& text, UINT icon) {
    MessageBoxW(nullptr, text.c_str(), kCaption, MB_OK | icon | MB_SETFOREGROUND);
}

int RunInstall(const SetupOptions& options, bool silent) {
    std::optional<InstallPlan> plan =
        PlanInstallation(options.langId.value_or(GetUserDefaultUILanguage()));
    if (!plan) {
        if (!silent) Tell(L"Setup cannot find the Program Files folder.", MB_ICONERROR);
        return ERROR_INSTALL_FAILURE;
    }
    if (!silent && Ask(L"Install " + std::wstring(kProductTitle) + L" in " +
                       plan->language.displayName + L"?") != IDOK) {
        return ERROR_INSTALL_USEREXIT;
    }
    std::wstring error;
    if (!Install(*plan, error)) {
        if (!silent) Tell(error, MB_ICONERROR);
        return ERROR_INSTALL_FAILURE;
    }
    if (!silent) {
        Tell(std::wstring(kProductTitle) + L" is installed in " + plan->gameFolder + L".",
             MB_ICONINFORMATION);
    }
    return ERROR_SUCCESS;
}

int RunUninstall(bool silent) {
    if (!IsInstalled()) {
        if (!silent) Tell(std::wstring(kProductTitle) + L" is not installed.", MB_ICONINFORMATION);
        return ERROR_SUCCESS;
    }
    if (!silent &&
        Ask(L"Remove " + std::wstring(kProductTitle) + L" from this computer?") != IDOK) {
        return ERROR_INSTALL_USEREXIT;
    }
    std::wstring error;
    if (!Uninstall(error)) {
        if (!silent) Tell(error, MB_ICONERROR);
        return ERROR_INSTALL_FAILURE;
    }
    if (!silent) Tell(std::wstring(kProductTitle) + L" has been removed.", MB_ICONINFORMATION);
    return ERROR_SUCCESS;
}

}  // namespace

int WINAPI wWinMain(HINSTANCE, HINSTANCE, PWSTR commandLine, int) {
    AppendCompanionLog(L"setup.exe", commandLine);
    SetupOptions options = ParseSetupOptions(commandLine ? commandLine : L"");
    bool silent = options.silent || SilentByEnvironment();
    if (!options.understood) {
        if (!silent) Tell(kUsage, MB_ICONERROR);
        return ERROR_INVALID_PARAMETER;
    }
    return options.uninstall ? RunUninstall(silent) : RunInstall(options, silent);
}
