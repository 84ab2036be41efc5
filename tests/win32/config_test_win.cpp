// The configuration readers against the real registry and a real ORVAK.INI.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "locale/config_win.h"
#include "shell/launcher_state.h"
#include "test_support_win.h"

namespace {

class Configuration : public testing::Test {
protected:
    void SetUp() override {
        DeleteMachineKey(kProductKeyPath);
        DeleteMachineKey(kUninstallKeyPath);
        DeleteMachineKey(kLocaleKeyPath);
        ResetLauncherConfiguration();
        wcscpy_s(launcher.rootPath, disc.Path().c_str());
    }
    void TearDown() override {
        DeleteMachineKey(kLocaleKeyPath);
        ResetLauncherConfiguration();
        launcher.rootPath[0] = L'\0';
    }

    void WriteDiscSku(const std::string& ini) { disc.WriteFile(L"ORVAK.INI", ini); }

    struct Outcome {
        LanguageBase base;
        bool known;
    };
    Outcome Read(const wchar_t* commandLine = L"") {
        ReadConfiguration(commandLine);
        return {launcher.languageBase, launcher.languageKnown};
    }

    TempFolder disc;
};

TEST_F(Configuration, CommandLineOptionWinsOverEveryRegistryValue) {
    ScopedMachineKey product(kProductKeyPath);
    product.SetText(L"VEMO_LANGUAGE", L"French");
    product.SetText(L"VEMO_OTHERLANGUAGE", L"Danish");
    Outcome outcome = Read(L"-l0407");
    EXPECT_EQ(outcome.base, kGerman);
    EXPECT_TRUE(outcome.known);
    EXPECT_FALSE(launcher.useSystemLanguage);
}

TEST_F(Configuration, CommandLineVariantsThatAreNotTheOptionAreIgnored) {
    ScopedMachineKey product(kProductKeyPath);
    product.SetText(L"VEMO_LANGUAGE", L"French");
    for (const wchar_t* line : {L"-l407", L"-L0407", L"/l0407", L"-l0407 more"}) {
        SCOPED_TRACE(testing::Message() << "command line of " << wcslen(line) << " characters");
        ResetLauncherConfiguration();
        EXPECT_EQ(Read(line).base, kFrench);
    }
    ResetLauncherConfiguration();
    EXPECT_EQ(Read(L"-l0c04").base, kSimplifiedChinese);
    ResetLauncherConfiguration();
    Outcome notHex = Read(L"-lzzzz");  // LANGID 0: US English, settled
    EXPECT_EQ(notHex.base, kUsEnglish);
    EXPECT_TRUE(notHex.known);
}

TEST_F(Configuration, OtherLanguageValueWinsAndVemoLanguageIsNotRead) {
    ScopedMachineKey product(kProductKeyPath);
    product.SetText(L"VEMO_LANGUAGE", L"German");
    struct Row {
        const wchar_t* other;
        LanguageBase base;
    };
    for (Row row : {Row{L"Norwegian", kNorwegian}, Row{L"Danish", kDanish},
                    Row{L"Finnish", kFinnish}, Row{L"UKEnglish", kUkEnglish},
                    Row{L"Swedish", kUkEnglish}}) {
        SCOPED_TRACE(row.base);
        ResetLauncherConfiguration();
        product.SetText(L"VEMO_OTHERLANGUAGE", row.other);
        Outcome outcome = Read();
        EXPECT_EQ(outcome.base, row.base);
        EXPECT_TRUE(outcome.known);
    }
}

TEST_F(Configuration, OtherLanguageOfAnotherTypeCountsAsAbsent) {
    ScopedMachineKey product(kProductKeyPath);
    product.SetText(L"VEMO_LANGUAGE", L"Italian");
    product.SetDword(L"VEMO_OTHERLANGUAGE", 17000);
    EXPECT_EQ(Read().base, kItalian);
}

TEST_F(Configuration, DiscEditionTwoWithEnglishProductOffersTheLanguageList) {
    WriteDiscSku("[SKU]\r\nSKU=2\r\n");
    ScopedMachineKey product(kProductKeyPath);
    // English, but also anything that reads as US English, sends edition 2 to the list.
    for (const wchar_t* language : {L"UKEnglish", L"USEnglish", L"Klingon"}) {
        SCOPED_TRACE(testing::Message() << "VEMO_LANGUAGE of " << wcslen(language) << " chars");
        ResetLauncherConfiguration();
        product.SetText(L"VEMO_LANGUAGE", language);
        Outcome outcome = Read();
        EXPECT_EQ(launcher.discSku, 2u);
        EXPECT_EQ(outcome.base, kNoLanguage);
        EXPECT_FALSE(outcome.known);
        EXPECT_TRUE(launcher.useSystemLanguage);
    }
    ResetLauncherConfiguration();
    ASSERT_EQ(RegDeleteValueW(product.Get(), L"VEMO_LANGUAGE"), ERROR_SUCCESS);
    EXPECT_FALSE(Read().known);
    ResetLauncherConfiguration();
    product.SetDword(L"VEMO_LANGUAGE", 3000);
    EXPECT_FALSE(Read().known);
}

TEST_F(Configuration, DiscEditionTwoWithAnotherLanguageGoesToTheMainMenu) {
    WriteDiscSku("[SKU]\r\nSKU=2\r\n");
    ScopedMachineKey product(kProductKeyPath);
    product.SetText(L"VEMO_LANGUAGE", L"German");
    Outcome outcome = Read();
    EXPECT_EQ(outcome.base, kGerman);
    EXPECT_TRUE(outcome.known);
    EXPECT_FALSE(launcher.useSystemLanguage);
}

TEST_F(Configuration, ProductKeySettlesItsLanguageOrUsEnglish) {
    ScopedMachineKey product(kProductKeyPath);
    struct Row {
        const wchar_t* name;
        LanguageBase base;
    };
    for (Row row : {Row{L"Japanese", kJapanese}, Row{L"Polish", kPolish},
                    Row{L"Norwegian", kUsEnglish}, Row{L"french", kUsEnglish}}) {
        SCOPED_TRACE(row.base);
        ResetLauncherConfiguration();
        product.SetText(L"VEMO_LANGUAGE", row.name);
        Outcome outcome = Read();
        EXPECT_EQ(outcome.base, row.base);
        EXPECT_TRUE(outcome.known);
    }
    ResetLauncherConfiguration();
    ASSERT_EQ(RegDeleteValueW(product.Get(), L"VEMO_LANGUAGE"), ERROR_SUCCESS);
    Outcome missing = Read();
    EXPECT_EQ(missing.base, kUsEnglish);
    EXPECT_TRUE(missing.known);
}

TEST_F(Configuration, NoProductKeyLeavesTheLanguageUnsettled) {
    Outcome outcome = Read();
    EXPECT_EQ(outcome.base, kNoLanguage);
    EXPECT_FALSE(outcome.known);
    EXPECT_FALSE(UninstallEntryExists());
    ScopedMachineKey uninstall(kUninstallKeyPath);
    EXPECT_TRUE(UninstallEntryExists());
}

// A 32-bit installer writes to the 32-bit view; a value only in the 64-bit view is none of the
// product's, whichever build of the launcher reads it.
TEST_F(Configuration, ProductKeysAreReadFromTheThirtyTwoBitView) {
    {
        ScopedMachineKey product(kProductKeyPath, KEY_WOW64_32KEY);
        product.SetText(L"VEMO_LANGUAGE", L"Korean");
        ScopedMachineKey uninstall(kUninstallKeyPath, KEY_WOW64_32KEY);
        EXPECT_EQ(Read().base, kKorean);
        EXPECT_TRUE(UninstallEntryExists());
    }
    ResetLauncherConfiguration();
    ScopedMachineKey product(kProductKeyPath, KEY_WOW64_64KEY);
    product.SetText(L"VEMO_LANGUAGE", L"Korean");
    product.SetDword(L"VEMO_SKU", 4);
    ScopedMachineKey uninstall(kUninstallKeyPath, KEY_WOW64_64KEY);
    Outcome outcome = Read();
    EXPECT_EQ(outcome.base, kNoLanguage);
    EXPECT_FALSE(outcome.known);
    EXPECT_EQ(launcher.productSku, 0u);
    EXPECT_FALSE(UninstallEntryExists());
}

TEST_F(Configuration, StoredTextWithoutTerminatorIsReadSafely) {
    ScopedMachineKey product(kProductKeyPath);
    product.SetUnterminatedText(L"VEMO_LANGUAGE", L"German");
    EXPECT_EQ(Read().base, kGerman);
    // A text that fills the whole buffer with no room for its end is not a language name.
    ResetLauncherConfiguration();
    product.SetUnterminatedText(L"VEMO_LANGUAGE", std::wstring(256, L'G'));
    Outcome outcome = Read();
    EXPECT_EQ(outcome.base, kUsEnglish);
    EXPECT_TRUE(outcome.known);
    ResetLauncherConfiguration();
    product.SetText(L"VEMO_LANGUAGE", std::wstring(4000, L'x'));
    EXPECT_EQ(Read().base, kUsEnglish);
}

TEST_F(Configuration, ProductEditionFromTheFirstByteOfVemoSku) {
    ScopedMachineKey product(kProductKeyPath);
    struct Row {
        DWORD value;
        std::uint32_t sku;
    };
    for (Row row : {Row{1, 1}, Row{9, 9}, Row{10, 2}, Row{11, 0}, Row{0, 0}, Row{0x105, 5},
                    Row{0xFF, 0}}) {
        SCOPED_TRACE(row.value);
        launcher.productSku = 77;
        product.SetDword(L"VEMO_SKU", row.value);
        ReadProductSku();
        EXPECT_EQ(launcher.productSku, row.sku);
    }
    product.SetText(L"VEMO_SKU", L"3");  // a text holding the digit: its first byte is '3'
    ReadProductSku();
    EXPECT_EQ(launcher.productSku, 0u);
    const unsigned char seven = 7;
    product.SetBinary(L"VEMO_SKU", &seven, 1);
    ReadProductSku();
    EXPECT_EQ(launcher.productSku, 7u);
    ASSERT_EQ(RegDeleteValueW(product.Get(), L"VEMO_SKU"), ERROR_SUCCESS);
    launcher.productSku = 77;
    ReadProductSku();
    EXPECT_EQ(launcher.productSku, 0u);
}

TEST_F(Configuration, ProductEditionUnchangedWithoutTheProductKey) {
    launcher.productSku = 4;
    ReadProductSku();
    EXPECT_EQ(launcher.productSku, 4u);
}

TEST_F(Configuration, DiscEditionFromOrvakIni) {
    struct Row {
        const char* ini;
        std::uint32_t sku;
    };
    for (Row row : {Row{"[SKU]\r\nSKU=5\r\n", 5}, Row{"[SKU]\r\nSKU=3\r\nOTHER=1\r\n", 3},
                    Row{"[Other]\r\nSKU=4\r\n", 0}, Row{"[SKU]\r\nEdition=4\r\n", 0},
                    Row{"", 0}}) {
        SCOPED_TRACE(row.ini);
        WriteDiscSku(row.ini);
        launcher.discSku = 99;
        ReadDiscSku();
        EXPECT_EQ(launcher.discSku, row.sku);
    }
    DeleteFileW((disc.Path() + L"ORVAK.INI").c_str());
    launcher.discSku = 99;
    ReadDiscSku();
    EXPECT_EQ(launcher.discSku, 0u);
}

TEST_F(Configuration, DiscRootTooLongForTheIniPathReadsNoEdition) {
    std::wstring root = L"C:\\" + std::wstring(250, L'A') + L"\\";
    wcscpy_s(launcher.rootPath, root.c_str());
    launcher.discSku = 99;
    ReadDiscSku();
    EXPECT_EQ(launcher.discSku, 0u);
}

TEST_F(Configuration, LocaleValueNamesTheMenuLanguageWithoutItsTerminator) {
    struct Row {
        LanguageBase base;
        std::wstring code;
    };
    for (const Row& row : {Row{kNoLanguage, L"en_US"}, Row{kJapanese, L"ja"},
                           Row{kUkEnglish, L"en_UK"}, Row{kTraditionalChinese, L"zh_TW"},
                           Row{9000, L"en_US"}}) {
        SCOPED_TRACE(row.base);
        launcher.languageBase = row.base;
        WriteLocale();
        HKEY key = nullptr;
        ASSERT_EQ(
            RegOpenKeyExW(HKEY_LOCAL_MACHINE, kLocaleKeyPath, 0, KEY_READ | KEY_WOW64_32KEY, &key),
            ERROR_SUCCESS);
        wchar_t data[32] = {};
        DWORD size = sizeof(data);
        DWORD type = 0;
        ASSERT_EQ(RegQueryValueExW(key, L"", nullptr, &type, reinterpret_cast<BYTE*>(data), &size),
                  ERROR_SUCCESS);
        RegCloseKey(key);
        EXPECT_EQ(type, static_cast<DWORD>(REG_SZ));
        DWORD written = static_cast<DWORD>(row.code.size() * sizeof(wchar_t));
        // Wine stores a terminator after text data that is followed by one in memory,
        // whatever length it is given; Windows stores exactly the length given.
        if (RunningOnWine() && size == written + sizeof(wchar_t) && data[row.code.size()] == 0) {
            size = written;
        }
        EXPECT_EQ(size, written);
        EXPECT_EQ(std::wstring(data, size / sizeof(wchar_t)), row.code);
    }
    HKEY other = nullptr;
    EXPECT_NE(
        RegOpenKeyExW(HKEY_LOCAL_MACHINE, kLocaleKeyPath, 0, KEY_READ | KEY_WOW64_64KEY, &other),
        ERROR_SUCCESS)
        << "written to the 64-bit view";
    if (other) RegCloseKey(other);
}

}  // namespace
