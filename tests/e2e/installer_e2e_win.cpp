// The launcher off its disc and twice, and the disc's setup.exe: what it installs, asks and undoes.
#include <gtest/gtest.h>

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "launcher_driver_win.h"
#include "locale/config_win.h"
#include "platform/registry_win.h"
#include "test_support_win.h"

namespace {

constexpr DWORD kUserCancelled = 1602;  // ERROR_INSTALL_USEREXIT
constexpr DWORD kInstallFailed = 1603;  // ERROR_INSTALL_FAILURE

std::wstring GameFolder() {
    return InstalledFolder(L"The Vemo");
}

// setup.exe writes where a 32-bit installer writes, the product's registry view.
bool KeyExists(const wchar_t* path) {
    return static_cast<bool>(OpenKeyForReading(HKEY_LOCAL_MACHINE, path));
}

std::optional<DWORD> ProductDword(const wchar_t* name) {
    RegistryKey key = OpenKeyForReading(HKEY_LOCAL_MACHINE, kProductKeyPath);
    DWORD value = 0, size = sizeof(value), type = REG_NONE;
    if (!key || !QueryData(key.Get(), name, reinterpret_cast<BYTE*>(&value), size, &type) ||
        type != REG_DWORD) {
        return std::nullopt;
    }
    return value;
}

const wchar_t kSetupCaption[] = L"The Vemo Vodizuri Virezazida Setup";

class Installer : public LauncherTest {
  protected:
    std::wstring SetupProgram() const { return disc.Path(L"Setup\\setup.exe"); }

    void ExpectNothingInstalled() {
        EXPECT_FALSE(KeyExists(kProductKeyPath));
        EXPECT_FALSE(KeyExists(kUninstallKeyPath));
        EXPECT_EQ(GetFileAttributesW(InstalledFolder(L"").c_str()), INVALID_FILE_ATTRIBUTES)
            << "a folder was left in Program Files";
    }
};

// Each install runs over the one before, as a user installs again in another language.
TEST_F(Installer, SilentInstallLeavesWhatTheLauncherReadsAndUninstallTakesItAway) {
    struct Row {
        const wchar_t* arguments;
        DWORD edition;  // 0: the disc has no ORVAK.INI
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
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << "setup.exe " << row.arguments);
        row.edition ? disc.SetEdition(static_cast<int>(row.edition)) : disc.MoveAside(L"ORVAK.INI");
        SetEnvironmentVariableW(L"VEMO_SETUP_SILENT", row.silentByEnvironment ? L"1" : nullptr);
        ASSERT_EQ(RunSetup(row.arguments), std::optional<DWORD>(0));

        auto text = [](const wchar_t* key, const wchar_t* name) {
            return MachineText(key, name).value_or(L"(missing)");
        };
        EXPECT_EQ(text(kProductKeyPath, L"Version"), L"1.0");
        EXPECT_EQ(ProductDword(L"EP8Installed"), std::optional<DWORD>(1));
        EXPECT_EQ(text(kProductKeyPath, L"VEMO_DATA"), GameFolder());
        EXPECT_EQ(text(kProductKeyPath, L"VEMO_LANGUAGE"), row.language);
        EXPECT_EQ(text(kProductKeyPath, L"VEMO_OTHERLANGUAGE"),
                  row.otherLanguage ? row.otherLanguage : L"(missing)");
        EXPECT_EQ(ProductDword(L"VEMO_SKU"), std::optional<DWORD>(row.edition));
        EXPECT_EQ(text(kUninstallKeyPath, L"DisplayName"), L"The Vemo Vodizuri Virezazida");
        EXPECT_EQ(text(kUninstallKeyPath, L"UninstallString"), L"\"" + SetupProgram() + L"\" -u");
    }
    SetEnvironmentVariableW(L"VEMO_SETUP_SILENT", L"1");
    ASSERT_EQ(RunSetup(L"-u"), std::optional<DWORD>(0));
    ExpectNothingInstalled();
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
    disc.MoveAside(L"Setup\\Program\\TheVemoCreator.exe");
    EXPECT_EQ(RunSetup(L"-l0407 -s"), std::optional<DWORD>(kInstallFailed));
    ExpectNothingInstalled();
}

const wchar_t kNotOnDiscText[] =
    L"Autoplay will only run from The Vemo installation CD.  Exiting now.";
const wchar_t kInsertDiscText[] =
    L"To continue with this operation, please insert Disc 1 into the CD-ROM drive and click OK.";

// Where none of its backgrounds are, the launcher knows it is not on its disc. The installer it
// may start logs late, after the launcher has gone: rows that start nothing come first.
TEST_F(Installer, OffTheDiscItSaysSoThenAsksForDiscOneOrInstallsUnlessInstalled) {
    const struct {
        const char* what;
        const wchar_t* missing;  // moved off the disc for the row
        bool productInstalled;
    } rows[] = {
        {"without data2.cab", L"Setup\\data2.cab", false},
        {"with the product installed", nullptr, true},
        {"with the setup files", nullptr, false},
    };
    disc.MoveAside(L"Launcher");
    for (const auto& row : rows) {
        SCOPED_TRACE(row.what);
        if (row.missing) disc.MoveAside(row.missing);
        ASSERT_TRUE(launcher.Start(disc.Launcher(), L"", disc.Root()));
        std::optional<MessageBoxSeen> notice = WaitForMessageBox(launcher.Id());
        ASSERT_TRUE(notice);
        EXPECT_EQ(notice->caption, L"");
        EXPECT_EQ(notice->text, kNotOnDiscText);
        EXPECT_EQ(notice->buttons, std::vector<int>{IDOK});
        ExpectSecondLauncherEndsAtOnce();
        EXPECT_TRUE(IsWindowVisible(notice->window)) << "the first launcher stopped waiting";
        std::unique_ptr<ScopedMachineKey> uninstall;
        if (row.productInstalled) uninstall = std::make_unique<ScopedMachineKey>(kUninstallKeyPath);
        ASSERT_TRUE(PressButton(*notice, IDOK));
        if (row.missing) {
            // OK with the disc still missing asks again; Cancel gives up.
            for (int answer : {IDOK, IDCANCEL}) {
                AnswerMessageBox(launcher.Id(), L"Insert Disc 1", kInsertDiscText, {IDOK, IDCANCEL},
                                 answer);
            }
        } else if (!row.productInstalled) {
            // The installer asks before it installs; the user declines.
            log.ExpectNext(L"setup.exe", L"-l0009", disc.Path(L"Setup"));
            auto question = WaitForMessageBox(0, kSetupCaption);
            ASSERT_TRUE(question) << "the installer did not ask";
            EXPECT_NE(question->text.find(L"English"), std::wstring::npos);
            ASSERT_TRUE(PressButton(*question, IDCANCEL));
        }
        EXPECT_EQ(launcher.WaitForExit(kWindowWaitMs), std::optional<DWORD>(0));
        if (row.missing) disc.PutBack(row.missing);
        if (row.missing || row.productInstalled) {
            EXPECT_FALSE(WaitUntil([&] { return !log.Lines().empty(); }, 3000)) << "started";
        }
    }
}

TEST_F(Installer, SecondLauncherBringsTheFirstBackRestoredAndInFront) {
    ASSERT_TRUE(Start(L"-l040c"));
    ShowWindow(window, SW_MINIMIZE);
    ASSERT_TRUE(WaitUntil([&] { return IsIconic(window) != FALSE; }, 5000));
    ExpectSecondLauncherEndsAtOnce();
    EXPECT_TRUE(
        WaitUntil([&] { return !IsIconic(window) && GetForegroundWindow() == window; }, 5000))
        << "the first launcher stayed minimised or behind";
}

}  // namespace
