// The sample disc's setup.exe as the launcher and a user start it: what it installs, what it
// writes for the launcher to read, what it asks, and that "-u" takes it all away again.
#include <gtest/gtest.h>

#include <optional>
#include <string>

#include "e2e_support_win.h"
#include "locale/config_win.h"
#include "platform/handles_win.h"
#include "sample_disc_win.h"
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

std::optional<std::wstring> TextValue(const wchar_t* keyPath, const wchar_t* name) {
    RegistryKey key = OpenInstallerKey(keyPath);
    wchar_t text[512] = {};
    DWORD bytes = sizeof(text);
    if (!key || RegGetValueW(key.Get(), nullptr, name, RRF_RT_REG_SZ, nullptr, text, &bytes) !=
                    ERROR_SUCCESS) {
        return std::nullopt;
    }
    return std::wstring(text);
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

std::optional<std::wstring> Absent() {
    return std::nullopt;
}

std::optional<LONGLONG> FileSize(const std::wstring& path) {
    WIN32_FILE_ATTRIBUTE_DATA data;
    if (!GetFileAttributesExW(path.c_str(), GetFileExInfoStandard, &data)) return std::nullopt;
    return static_cast<LONGLONG>(data.nFileSizeHigh) << 32 | data.nFileSizeLow;
}

class Installer : public testing::Test {
  protected:
    void SetUp() override {
        SetEnvironmentVariableW(L"VEMO_SETUP_SILENT", nullptr);
        RemoveInstallation();
    }
    void TearDown() override {
        SetEnvironmentVariableW(L"VEMO_SETUP_SILENT", nullptr);
        RemoveInstallation();
    }
    static void RemoveInstallation() {
        DeleteMachineKey(kProductKeyPath);
        DeleteMachineKey(kUninstallKeyPath);
        RemoveTree(MakerFolder());
    }

    std::wstring SetupProgram() const { return disc.Path(L"Setup\\setup.exe"); }

    // Runs setup.exe from the disc's Setup folder, as the launcher does; its exit code.
    std::optional<DWORD> RunSetup(const std::wstring& arguments) {
        TestProcess setup;
        if (!setup.Start(SetupProgram(), arguments, disc.Path(L"Setup"))) return std::nullopt;
        return setup.WaitForExit(kWindowWaitMs);
    }

    void ExpectNothingInstalled() {
        EXPECT_FALSE(KeyExists(kProductKeyPath));
        EXPECT_FALSE(KeyExists(kUninstallKeyPath));
        EXPECT_FALSE(Exists(MakerFolder())) << "a folder was left in Program Files";
    }

    SampleDisc disc;
    CompanionLog log;
};

TEST_F(Installer, SilentInstallLeavesWhatTheLauncherReadsAndUninstallTakesItAway) {
    struct Row {
        const wchar_t* arguments;
        int edition;  // 0: the disc has no ORVAK.INI
        const wchar_t* language;
        const wchar_t* otherLanguage;
    };
    const Row rows[] = {
        {L"-l0007 -s", 1, L"German", nullptr},
        {L"-s -l0014", 3, L"UKEnglish", L"Norwegian"},
        {L"-l0011 -s", 0, L"Japanese", nullptr},
        {L"-l0009 /s", 2, L"USEnglish", nullptr},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << "setup.exe " << row.arguments);
        if (row.edition == 0) {
            if (disc.Has(L"ORVAK.INI")) disc.Remove(L"ORVAK.INI");
        } else {
            disc.SetEdition(row.edition);
        }
        ASSERT_EQ(RunSetup(row.arguments), std::optional<DWORD>(0));

        EXPECT_EQ(TextValue(kProductKeyPath, L"Version"), std::optional<std::wstring>(L"1.0"));
        EXPECT_EQ(DwordValue(kProductKeyPath, L"EP8Installed"), std::optional<DWORD>(1));
        EXPECT_EQ(TextValue(kProductKeyPath, L"VEMO_DATA"),
                  std::optional<std::wstring>(GameFolder()));
        EXPECT_EQ(TextValue(kProductKeyPath, L"VEMO_LANGUAGE"),
                  std::optional<std::wstring>(row.language));
        EXPECT_EQ(TextValue(kProductKeyPath, L"VEMO_OTHERLANGUAGE"),
                  row.otherLanguage ? std::optional<std::wstring>(row.otherLanguage) : Absent());
        EXPECT_EQ(DwordValue(kProductKeyPath, L"VEMO_SKU"),
                  std::optional<DWORD>(static_cast<DWORD>(row.edition)));
        EXPECT_EQ(TextValue(kUninstallKeyPath, L"DisplayName"),
                  std::optional<std::wstring>(L"The Vemo Vodizuri Virezazida"));
        EXPECT_EQ(TextValue(kUninstallKeyPath, L"UninstallString"),
                  std::optional<std::wstring>(L"\"" + SetupProgram() + L"\" -u"));

        // The disc's own programs, where the launcher's Play commands look for them.
        EXPECT_EQ(FileSize(GameFolder() + L"\\Vemo.exe"),
                  FileSize(disc.Path(L"Setup\\Program\\Vemo.exe")));
        EXPECT_EQ(FileSize(GameFolder() + L"\\..\\The Vemo Creator\\TheVemoCreator.exe"),
                  FileSize(disc.Path(L"Setup\\Program\\TheVemoCreator.exe")));

        // The launcher's own installation check finds the game it would offer to play.
        launcher.menu.installed = false;
        launcher.menu.CheckInstallation();
        EXPECT_TRUE(launcher.menu.installed);
        EXPECT_EQ(launcher.menu.installPath, GameFolder());

        ASSERT_EQ(RunSetup(L"-u -s"), std::optional<DWORD>(0));
        ExpectNothingInstalled();
        launcher.menu.CheckInstallation();
        EXPECT_FALSE(launcher.menu.installed);
    }

    auto lines = log.Lines();
    ASSERT_EQ(lines.size(), 8u) << "each run logs one line";
    EXPECT_EQ(lines[2],
              (std::vector<std::wstring>{L"setup.exe", L"-s -l0014", disc.Path(L"Setup")}));
}

TEST_F(Installer, InstallingAgainInAnotherLanguageForgetsTheNordicLanguage) {
    ASSERT_EQ(RunSetup(L"-l0006 -s"), std::optional<DWORD>(0));
    EXPECT_EQ(TextValue(kProductKeyPath, L"VEMO_OTHERLANGUAGE"),
              std::optional<std::wstring>(L"Danish"));
    ASSERT_EQ(RunSetup(L"-l040c -s"), std::optional<DWORD>(0));
    EXPECT_EQ(TextValue(kProductKeyPath, L"VEMO_LANGUAGE"), std::optional<std::wstring>(L"French"));
    EXPECT_EQ(TextValue(kProductKeyPath, L"VEMO_OTHERLANGUAGE"), Absent())
        << "the launcher would still choose Danish";
}

TEST_F(Installer, TheEnvironmentMakesItSilentWhenTheLauncherStartsIt) {
    SetEnvironmentVariableW(L"VEMO_SETUP_SILENT", L"1");
    ASSERT_EQ(RunSetup(L"-l0410"), std::optional<DWORD>(0));
    EXPECT_EQ(TextValue(kProductKeyPath, L"VEMO_LANGUAGE"),
              std::optional<std::wstring>(L"Italian"));
    ASSERT_EQ(RunSetup(L"-u"), std::optional<DWORD>(0));
    ExpectNothingInstalled();
}

TEST_F(Installer, AskingFirstNamesTheLanguageAndCancelInstallsNothing) {
    TestProcess setup;
    ASSERT_TRUE(setup.Start(SetupProgram(), L"-l040c", disc.Path(L"Setup")));
    std::optional<MessageBoxSeen> question = WaitForMessageBox(setup.Id());
    ASSERT_TRUE(question) << "setup did not ask";
    EXPECT_EQ(question->caption, L"The Vemo Vodizuri Virezazida Setup");
    EXPECT_EQ(question->text, L"Install The Vemo Vodizuri Virezazida in French?");
    EXPECT_EQ(question->buttons, (std::vector<int>{IDOK, IDCANCEL}));
    ASSERT_TRUE(PressButton(*question, IDCANCEL));
    EXPECT_EQ(setup.WaitForExit(kWindowWaitMs), std::optional<DWORD>(kUserCancelled));
    ExpectNothingInstalled();
}

TEST_F(Installer, AskingFirstInstallsOnOkAndTellsWhere) {
    TestProcess setup;
    ASSERT_TRUE(setup.Start(SetupProgram(), L"-l0412", disc.Path(L"Setup")));
    std::optional<MessageBoxSeen> question = WaitForMessageBox(setup.Id());
    ASSERT_TRUE(question);
    EXPECT_EQ(question->text, L"Install The Vemo Vodizuri Virezazida in Korean?");
    ASSERT_TRUE(PressButton(*question, IDOK));
    std::optional<MessageBoxSeen> result = WaitForMessageBox(setup.Id());
    ASSERT_TRUE(result) << "setup did not say how it went";
    EXPECT_EQ(result->text, L"The Vemo Vodizuri Virezazida is installed in " + GameFolder() + L".");
    ASSERT_TRUE(PressButton(*result, IDOK));
    EXPECT_EQ(setup.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
    EXPECT_EQ(TextValue(kProductKeyPath, L"VEMO_LANGUAGE"), std::optional<std::wstring>(L"Korean"));
}

TEST_F(Installer, ADiscWithoutTheCreatorToolFailsAndLeavesNothingBehind) {
    disc.Remove(L"Setup\\Program\\TheVemoCreator.exe");
    EXPECT_EQ(RunSetup(L"-l0407 -s"), std::optional<DWORD>(kInstallFailed));
    ExpectNothingInstalled();
}

TEST_F(Installer, AnUnreadableCommandLineInstallsNothing) {
    EXPECT_EQ(RunSetup(L"-s -l04g7"), std::optional<DWORD>(ERROR_INVALID_PARAMETER));
    ExpectNothingInstalled();
}

}  // namespace
