// The configuration readers against the real registry and a real ORVAK.INI. How names,
// LANGIDs and the "-l" option map to languages is tested on the host; here what needs the
// registry or a file: which value wins, types, lengths and the registry view.
#include <gtest/gtest.h>

#include <functional>
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

// How a row stores VEMO_LANGUAGE (or VEMO_SKU) in the product key.
using Store = std::function<void(ScopedMachineKey&, const wchar_t* name)>;
Store Text(std::wstring text) {
    return [text](ScopedMachineKey& key, const wchar_t* name) { key.SetText(name, text); };
}
Store Unterminated(std::wstring text) {
    return
        [text](ScopedMachineKey& key, const wchar_t* name) { key.SetUnterminatedText(name, text); };
}
Store Dword(DWORD value) {
    return [value](ScopedMachineKey& key, const wchar_t* name) { key.SetDword(name, value); };
}
Store Missing() {
    return [](ScopedMachineKey& key, const wchar_t* name) { RegDeleteValueW(key.Get(), name); };
}

TEST_F(Configuration, CommandLineOptionWinsOverEveryRegistryValue) {
    ScopedMachineKey product(kProductKeyPath);
    product.SetText(L"VEMO_LANGUAGE", L"French");
    product.SetText(L"VEMO_OTHERLANGUAGE", L"Danish");
    struct Row {
        const wchar_t* line;
        LanguageBase base;
    };
    for (Row row : {Row{L"-l0407", kGerman}, Row{L"-L0407", kDanish}}) {
        SCOPED_TRACE(row.base);
        ResetLauncherConfiguration();
        Outcome outcome = Read(row.line);
        EXPECT_EQ(outcome.base, row.base);
        EXPECT_TRUE(outcome.known);
        EXPECT_FALSE(launcher.useSystemLanguage);
    }
}

TEST_F(Configuration, OtherLanguageValueWinsAndVemoLanguageIsNotRead) {
    ScopedMachineKey product(kProductKeyPath);
    product.SetText(L"VEMO_LANGUAGE", L"German");
    struct Row {
        const wchar_t* other;
        LanguageBase base;
    };
    for (Row row : {Row{L"Norwegian", kNorwegian}, Row{L"Swedish", kUkEnglish}}) {
        SCOPED_TRACE(row.base);
        ResetLauncherConfiguration();
        product.SetText(L"VEMO_OTHERLANGUAGE", row.other);
        Outcome outcome = Read();
        EXPECT_EQ(outcome.base, row.base);
        EXPECT_TRUE(outcome.known);
    }
    ResetLauncherConfiguration();
    product.SetDword(L"VEMO_OTHERLANGUAGE", 17000);  // not a text: absent
    EXPECT_EQ(Read().base, kGerman);
}

TEST_F(Configuration, DiscEditionTwoOffersTheListUnlessTheProductIsInAnotherLanguage) {
    disc.WriteFile(L"ORVAK.INI", "[SKU]\r\nSKU=2\r\n");
    ScopedMachineKey product(kProductKeyPath);
    struct Row {
        const char* what;
        Store store;
        bool list;  // true: the language list with no language; false: the menu in German
    };
    // English, and anything that reads as US English, sends edition 2 to the list.
    const Row rows[] = {
        {"UKEnglish", Text(L"UKEnglish"), true},
        {"USEnglish", Text(L"USEnglish"), true},
        {"an unknown name", Text(L"Klingon"), true},
        {"no value", Missing(), true},
        {"a number", Dword(3000), true},
        {"German", Text(L"German"), false},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.what);
        ResetLauncherConfiguration();
        row.store(product, L"VEMO_LANGUAGE");
        Outcome outcome = Read();
        EXPECT_EQ(launcher.discSku, 2u);
        EXPECT_EQ(outcome.base, row.list ? kNoLanguage : kGerman);
        EXPECT_EQ(outcome.known, !row.list);
        EXPECT_EQ(launcher.useSystemLanguage, row.list);
    }
}

TEST_F(Configuration, ProductKeySettlesItsLanguageOrUsEnglish) {
    ScopedMachineKey product(kProductKeyPath);
    struct Row {
        const char* what;
        Store store;
        LanguageBase base;
    };
    const Row rows[] = {
        {"Japanese", Text(L"Japanese"), kJapanese},
        {"a name only the other value carries", Text(L"Norwegian"), kUsEnglish},
        {"no value", Missing(), kUsEnglish},
        {"a number", Dword(11000), kUsEnglish},
        // Stored data need not end in NUL; a text that fills the whole buffer with no room
        // for its end, or one longer than the buffer, is no language name.
        {"German without its terminator", Unterminated(L"German"), kGerman},
        {"256 characters without a terminator", Unterminated(std::wstring(256, L'G')), kUsEnglish},
        {"4000 characters", Text(std::wstring(4000, L'x')), kUsEnglish},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.what);
        ResetLauncherConfiguration();
        row.store(product, L"VEMO_LANGUAGE");
        Outcome outcome = Read();
        EXPECT_EQ(outcome.base, row.base);
        EXPECT_TRUE(outcome.known);
    }
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

TEST_F(Configuration, ProductEditionFromTheFirstByteOfVemoSku) {
    ScopedMachineKey product(kProductKeyPath);
    const unsigned char seven = 7;
    struct Row {
        const char* what;
        Store store;
        std::uint32_t sku;
    };
    const Row rows[] = {
        {"DWORD 10", Dword(10), 2},
        {"DWORD 0x105: its low byte", Dword(0x105), 5},
        {"DWORD 0xFF: -1 as a signed byte", Dword(0xFF), 0},
        {"a text holding the digit 3", Text(L"3"), 0},
        {"one binary byte",
         [&](ScopedMachineKey& key, const wchar_t* name) { key.SetBinary(name, &seven, 1); }, 7},
        {"no value", Missing(), 0},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.what);
        launcher.productSku = 77;
        row.store(product, L"VEMO_SKU");
        ReadProductSku();
        EXPECT_EQ(launcher.productSku, row.sku);
    }
    DeleteMachineKey(kProductKeyPath);
    launcher.productSku = 4;
    ReadProductSku();
    EXPECT_EQ(launcher.productSku, 4u) << "changed without the product key";
}

TEST_F(Configuration, LocaleValueNamesTheMenuLanguageWithoutItsTerminator) {
    struct Row {
        LanguageBase base;
        std::wstring code;
    };
    for (const Row& row : {Row{kTraditionalChinese, L"zh_TW"}, Row{kJapanese, L"ja"}}) {
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
