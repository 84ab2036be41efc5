// The sample disc's setup.exe as the launcher and a user start it: what it installs, what it
// writes for the launcher to read, what it asks, and that "-u" takes it all away again.
#include <gtest/gtest.h>

#include <optional>
#include <string>

#include "launcher_driver_win.h"
#include "locale/config_win.h"
#include "platform/handles_win.h"
#include "shell/launcher_state.h"
#include "test_support_win.h"

namespace {

constexpr DWORD kUserCancelled = 1602;  // ERROR_INSTALL_USEREXIT
constexpr DWORD kInstallFailed = 1603;  // ERROR_INSTALL_FAILURE

std::wstring ProgramFilesFolder() {
    wchar_t folder[MAX_PATH] = {};
    GetEnvironmentVariableW(L"ProgramFiles", folder, MAX_PATH);
    return folder;
}

std::wstring MakerFolder() {
    return ProgramFilesFolder() + L"\\Orvak";
}
std::wstring GameFolder() {
    return MakerFolder() + L"\\The Vemo";
}

bool Exists(const std::wstring& path) {
    return GetFileAttributesW(path.c_str()) != INVALID_FILE_ATTRIBUTES;
}

// setup.exe writes where a 32-bit installer writes: the 32-bit registry view.
RegistryKey OpenInstallerKey(const wchar_t* path) {
    HKEY key = nullptr;
    if (RegOpenKeyExW(HKEY_LOCAL_MACHINE, path, 0, KEY_READ | KEY_WOW64_32KEY, &key) !=
        ERROR_SUCCESS) {
        return RegistryKey();
    }
    return RegistryKey(key);
}

bool KeyExists(const wchar_t* path) {
    return static_cast<bool>(OpenInstallerKey(path));
}

std::optional<DWORD> DwordValue(const wchar_t* keyPath, const wchar_t* name) {
    RegistryKey key = OpenInstallerKey(keyPath);
    DWORD value = 0;
    DWORD bytes = sizeof(value);
    if (!key || RegGetValueW(key.Get(), nullptr, name, RRF_RT_REG_DWORD, nullptr, &value, &bytes) !=
                    ERROR_SUCCESS) {
        return std::nullopt;
    }
    return value;
}

std::optional<LONGLONG> FileSize(const std::wstring& path) {
    WIN32_FILE_ATTRIBUTE_DATA data;
    if (!GetFileAttributesExW(path.c_str(), GetFileExInfoStandard, &data)) return std::nullopt;
    return static_cast<LONGLONG>(data.nFileSizeHigh) << 32 | data.nFileSizeLow;
}

const wchar_t kSetupCaption[] = L"The Vemo Vodizuri Virezazida Setup";

class Installer : public LauncherTest {
  protected:
    void SetUp() override {
        SetEnvironmentVariableW(L"VEMO_SETUP_SILENT", nullptr);
        RemoveTree(MakerFolder());
        LauncherTest::SetUp();
    }
    void TearDown() override {
        LauncherTest::TearDown();
        SetEnvironmentVariableW(L"VEMO_SETUP_SILENT", nullptr);
        RemoveTree(MakerFolder());
    }

    std::wstring SetupProgram() const { return disc.Path(L"Setup\\setup.exe"); }

    void ExpectNothingInstalled() {
        EXPECT_FALSE(KeyExists(kProductKeyPath));
        EXPECT_FALSE(KeyExists(kUninstallKeyPath));
        EXPECT_FALSE(Exists(MakerFolder())) << "a folder was left in Program Files";
    }
};

// Each install runs over the one before, as a user installs again in another language.
TEST_F(Installer, SilentInstallLeavesWhatTheLauncherReadsAndUninstallTakesItAway) {
    struct Row {
        const wchar_t* arguments;
        int edition;  // 0: the disc has no ORVAK.INI
        const wchar_t* language;
        const wchar_t* otherLanguage;
        bool silentByEnvironment;  // as when the launcher starts it
    };
    const Row rows[] = {
        {L"-l0007 -s", 1, L"German", nullptr, false},
        {L"-s -l0014", 3, L"UKEnglish", L"Norwegian", false},
        // Installing again forgets the Nordic language, or the launcher would still choose it.
        {L"-l0011", 0, L"Japanese", nullptr, true},
        {L"-l0009 /s", 2, L"USEnglish", nullptr, false},
    };
    MenuController& menu = ::launcher.menu;
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << "setup.exe " << row.arguments);
        if (row.edition == 0) {
            disc.Remove(L"ORVAK.INI");
        } else {
            disc.SetEdition(row.edition);
        }
        SetEnvironmentVariableW(L"VEMO_SETUP_SILENT", row.silentByEnvironment ? L"1" : nullptr);
        ASSERT_EQ(RunSetup(row.arguments), std::optional<DWORD>(0));

        EXPECT_EQ(MachineText(kProductKeyPath, L"Version"), std::optional<std::wstring>(L"1.0"));
        EXPECT_EQ(DwordValue(kProductKeyPath, L"EP8Installed"), std::optional<DWORD>(1));
        EXPECT_EQ(MachineText(kProductKeyPath, L"VEMO_DATA"),
                  std::optional<std::wstring>(GameFolder()));
        EXPECT_EQ(MachineText(kProductKeyPath, L"VEMO_LANGUAGE"),
                  std::optional<std::wstring>(row.language));
        EXPECT_EQ(
            MachineText(kProductKeyPath, L"VEMO_OTHERLANGUAGE"),
            row.otherLanguage ? std::optional<std::wstring>(row.otherLanguage) : std::nullopt);
        EXPECT_EQ(DwordValue(kProductKeyPath, L"VEMO_SKU"),
                  std::optional<DWORD>(static_cast<DWORD>(row.edition)));
        EXPECT_EQ(MachineText(kUninstallKeyPath, L"DisplayName"),
                  std::optional<std::wstring>(L"The Vemo Vodizuri Virezazida"));
        EXPECT_EQ(MachineText(kUninstallKeyPath, L"UninstallString"),
                  std::optional<std::wstring>(L"\"" + SetupProgram() + L"\" -u"));

        // The disc's own programs, where the launcher's Play commands look for them.
        EXPECT_EQ(FileSize(GameFolder() + L"\\Vemo.exe"),
                  FileSize(disc.Path(L"Setup\\Program\\Vemo.exe")));
        EXPECT_EQ(FileSize(GameFolder() + L"\\..\\The Vemo Creator\\TheVemoCreator.exe"),
                  FileSize(disc.Path(L"Setup\\Program\\TheVemoCreator.exe")));

        // The launcher's own installation check finds the game it would offer to play.
        menu.installed = false;
        menu.CheckInstallation();
        EXPECT_TRUE(menu.installed);
        EXPECT_EQ(menu.installPath, GameFolder());
    }
    SetEnvironmentVariableW(L"VEMO_SETUP_SILENT", L"1");
    ASSERT_EQ(RunSetup(L"-u"), std::optional<DWORD>(0));
    ExpectNothingInstalled();
    menu.CheckInstallation();
    EXPECT_FALSE(menu.installed);

    auto lines = log.Lines();
    ASSERT_EQ(lines.size(), 5u) << "each run logs one line";
    EXPECT_EQ(lines[1],
              (std::vector<std::wstring>{L"setup.exe", L"-s -l0014", disc.Path(L"Setup")}));
}

TEST_F(Installer, AskingFirstNamesTheLanguageInstallsOnOkAndTellsWhereAndNothingOnCancel) {
    struct Row {
        const wchar_t* option;
        const wchar_t* language;
        int answer;
        DWORD exitCode;
    };
    for (const Row& row : {Row{L"-l040c", L"French", IDCANCEL, kUserCancelled},
                           Row{L"-l0412", L"Korean", IDOK, 0}}) {
        SCOPED_TRACE(row.language);
        TestProcess setup;
        ASSERT_TRUE(setup.Start(SetupProgram(), row.option, disc.Path(L"Setup")));
        AnswerMessageBox(
            setup.Id(), kSetupCaption,
            L"Install The Vemo Vodizuri Virezazida in " + std::wstring(row.language) + L"?",
            {IDOK, IDCANCEL}, row.answer);
        if (row.answer == IDOK) {
            AnswerMessageBox(setup.Id(), kSetupCaption,
                             L"The Vemo Vodizuri Virezazida is installed in " + GameFolder() + L".",
                             {IDOK}, IDOK);
        }
        EXPECT_EQ(setup.WaitForExit(kWindowWaitMs), std::optional<DWORD>(row.exitCode));
        if (row.answer == IDCANCEL) ExpectNothingInstalled();
    }
    EXPECT_EQ(MachineText(kProductKeyPath, L"VEMO_LANGUAGE"),
              std::optional<std::wstring>(L"Korean"));
}

TEST_F(Installer, ADiscWithoutTheCreatorToolOrAnUnreadableCommandLineInstallsNothing) {
    EXPECT_EQ(RunSetup(L"-s -l04g7"), std::optional<DWORD>(ERROR_INVALID_PARAMETER));
    ExpectNothingInstalled();
    disc.Remove(L"Setup\\Program\\TheVemoCreator.exe");
    EXPECT_EQ(RunSetup(L"-l0407 -s"), std::optional<DWORD>(kInstallFailed));
    ExpectNothingInstalled();
}

}  // namespace
