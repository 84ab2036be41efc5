// The configuration readers against the real registry and ORVAK.INI (name mapping: host tests).
#include <gtest/gtest.h>

#include <functional>
#include <string>

#include "locale/config_win.h"
#include "shell/launcher_state.h"
#include "test_support_win.h"

namespace {

class Configuration : public DiscTest {
  protected:
    struct Outcome {
        LanguageBase base;
        bool known;
    };
    Outcome Read(const wchar_t* commandLine = L"") {
        ReadConfiguration(commandLine);
        return {launcher.languageBase, launcher.languageKnown};
    }
};

// How a row stores VEMO_LANGUAGE (or VEMO_SKU) in the product key.
using Store = std::function<void(ScopedMachineKey&, const wchar_t* name)>;
Store Text(std::wstring text) {
    return [text](ScopedMachineKey& key, const wchar_t* name) { key.SetText(name, text); };
}
// Wine quietly adds the terminator when the character after the data is NUL: here it is not.
Store Unterminated(std::wstring text) {
    return [text](ScopedMachineKey& key, const wchar_t* name) {
        key.Set(name, REG_SZ, (text + L"#").c_str(),
                static_cast<DWORD>(text.size() * sizeof(wchar_t)));
    };
}
Store Dword(DWORD value) {
    return [value](ScopedMachineKey& key, const wchar_t* name) { key.SetDword(name, value); };
}
Store Missing() {
    return [](ScopedMachineKey& key, const wchar_t* name) { RegDeleteValueW(key.Get(), name); };
}

// The "-l" option wins; else VEMO_OTHERLANGUAGE when it is a text, and VEMO_LANGUAGE is not
// read; else VEMO_LANGUAGE; else US English.
TEST_F(Configuration, TheOptionThenTheOtherLanguageThenTheProductLanguageSettleIt) {
    ScopedMachineKey product(kProductKeyPath);
    struct Row {
        const char* what;
        const wchar_t* line;
        Store language, other;
        LanguageBase base;
    };
    const Row rows[] = {
        {"the option", L"-l0407", Text(L"French"), Text(L"Danish"), kGerman},
        {"no option with a capital L", L"-L0407", Text(L"French"), Text(L"Danish"), kDanish},
        {"a Nordic other language", L"", Text(L"German"), Text(L"Norwegian"), kNorwegian},
        {"any other other language", L"", Text(L"German"), Text(L"Swedish"), kUkEnglish},
        {"an other language that is no text", L"", Text(L"German"), Dword(17000), kGerman},
        {"Japanese", L"", Text(L"Japanese"), Missing(), kJapanese},
        {"a name only the other value carries", L"", Text(L"Norwegian"), Missing(), kUsEnglish},
        {"no value", L"", Missing(), Missing(), kUsEnglish},
        {"a number", L"", Dword(11000), Missing(), kUsEnglish},
        // Stored data need not end in NUL; a text that fills the whole buffer with no room
        // for its end, or one longer than the buffer, is no language name.
        {"German without its terminator", L"", Unterminated(L"German"), Missing(), kGerman},
        {"256 characters without a terminator", L"", Unterminated(std::wstring(256, L'G')),
         Missing(), kUsEnglish},
        {"4000 characters", L"", Text(std::wstring(4000, L'x')), Missing(), kUsEnglish},
    };
    for (const Row& row : rows) {
        SCOPED_TRACE(row.what);
        ResetLauncherConfiguration();
        row.language(product, L"VEMO_LANGUAGE");
        row.other(product, L"VEMO_OTHERLANGUAGE");
        Outcome outcome = Read(row.line);
        EXPECT_EQ(outcome.base, row.base);
        EXPECT_TRUE(outcome.known);
        EXPECT_FALSE(launcher.useSystemLanguage);
    }
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
        {"UKEnglish", Text(L"UKEnglish"), true},     {"USEnglish", Text(L"USEnglish"), true},
        {"an unknown name", Text(L"Klingon"), true}, {"no value", Missing(), true},
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

// A 32-bit installer writes to the 32-bit view, whichever build of the launcher reads it.
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
        // Which byte means which edition is the host tests'; here which byte is read.
        {"DWORD 0x105: its low byte", Dword(0x105), 5},
        {"a text holding the digit 3", Text(L"3"), 0},
        {"one binary byte",
         [&](ScopedMachineKey& key, const wchar_t* name) { key.Set(name, REG_BINARY, &seven, 1); },
         7},
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
    // Each language's code, read back, is the end-to-end language choices'.
    const std::wstring code = L"zh_TW";
    launcher.languageBase = kTraditionalChinese;
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
    const DWORD written = static_cast<DWORD>(code.size() * sizeof(wchar_t));
    // Wine stores a terminator after text data that is followed by one in memory, whatever
    // length it is given; Windows stores exactly the length given.
    if (RunningOnWine() && size == written + sizeof(wchar_t) && data[code.size()] == 0) {
        size = written;
    }
    EXPECT_EQ(size, written);
    EXPECT_EQ(std::wstring(data, size / sizeof(wchar_t)), code);
    HKEY other = nullptr;
    EXPECT_NE(
        RegOpenKeyExW(HKEY_LOCAL_MACHINE, kLocaleKeyPath, 0, KEY_READ | KEY_WOW64_64KEY, &other),
        ERROR_SUCCESS)
        << "written to the 64-bit view";
    if (other) RegCloseKey(other);
}

}  // namespace
