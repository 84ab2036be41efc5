#include "locale/config_win.h"

#include "locale/language_option.h"
#include "locale/language_table.h"
#include "platform/registry_win.h"
#include "shell/launcher_state.h"

namespace {

constexpr std::size_t kValueCapacity = 256;

// The language stored under `name` of the product key, mapped by `toBase`; false when the
// key or a text value of that name is missing.
template <typename Mapping>
bool ReadLanguageValue(const wchar_t* name, Mapping toBase, LanguageBase& base, bool& keyOpened) {
    RegistryKey key = OpenKeyForReading(HKEY_LOCAL_MACHINE, kProductKeyPath);
    keyOpened = static_cast<bool>(key);
    if (!key) return false;
    wchar_t text[kValueCapacity];
    if (!QueryText(key.Get(), name, text, kValueCapacity)) return false;
    base = toBase(text);
    return true;
}

}  // namespace

void ReadDiscSku() {
    auto iniPath = PathInFolder(launcher.rootPath, kDiscIniName, kRootPathCapacity);
    // A disc root too long to name the file beside it cannot hold it either.
    if (!iniPath) {
        launcher.discSku = 0;
        return;
    }
    launcher.discSku = GetPrivateProfileIntW(L"SKU", L"SKU", 0, iniPath->c_str());
}

void ReadProductSku() {
    RegistryKey key = OpenKeyForReading(HKEY_LOCAL_MACHINE, kProductKeyPath);
    if (!key) return;
    BYTE data[kValueCapacity] = {};
    DWORD size = sizeof(data);
    std::int8_t firstByte = 0;
    if (QueryData(key.Get(), L"VEMO_SKU", data, size) && size > 0) {
        firstByte = static_cast<std::int8_t>(data[0]);
    }
    launcher.productSku = ProductSkuFromFirstByte(firstByte);
}

void ReadOtherLanguage() {
    LanguageBase base = kNoLanguage;
    bool keyOpened = false;
    if (!ReadLanguageValue(L"VEMO_OTHERLANGUAGE", LanguageBaseForOtherName, base, keyOpened)) {
        return;
    }
    launcher.languageBase = base;
    launcher.languageKnown = true;
    launcher.useSystemLanguage = false;
}

void ReadProductLanguage() {
    LanguageBase base = kUsEnglish;
    bool keyOpened = false;
    if (!ReadLanguageValue(L"VEMO_LANGUAGE", LanguageBaseForProductName, base, keyOpened)) {
        if (!keyOpened) return;
        base = kUsEnglish;  // missing, or not a text
    }
    launcher.languageBase = base;
    launcher.languageKnown = true;
}

bool TestEnglishProduct() {
    if (launcher.discSku != 2) return false;
    ReadProductLanguage();
    bool english = launcher.languageBase == kUsEnglish || launcher.languageBase == kUkEnglish;
    launcher.languageBase = kNoLanguage;
    launcher.languageKnown = false;
    return english;
}

void ApplyLanguageOption(const wchar_t* commandLine) {
    std::optional<std::uint16_t> langId = ParseLanguageOption(commandLine);
    if (!langId) return;
    LanguageFromLangId(*langId);
    launcher.languageKnown = true;
    launcher.useSystemLanguage = false;
}

void LanguageFromLangId(LANGID langId) { launcher.languageBase = LanguageBaseForLangId(langId); }

bool UninstallEntryExists() {
    return static_cast<bool>(OpenKeyForReading(HKEY_LOCAL_MACHINE, kUninstallKeyPath));
}

void DeleteUninstallEntry() { DeleteKeyTree(HKEY_LOCAL_MACHINE, kUninstallKeyPath); }

void WriteLocale() {
    const wchar_t* code = LocaleCodeFor(launcher.languageBase);
    RegistryKey key = CreateKeyForWriting(HKEY_LOCAL_MACHINE, kLocaleKeyPath);
    if (!key) return;
    // The stored length leaves out the terminator, as readers of this value expect.
    DWORD bytes = static_cast<DWORD>(wcslen(code) * sizeof(wchar_t));
    RegSetValueExW(key.Get(), launcher.emptyText, 0, REG_SZ, reinterpret_cast<const BYTE*>(code),
                   bytes);
}

void ReadConfiguration(const wchar_t* commandLine) {
    ReadDiscSku();
    ReadProductSku();
    ReadOtherLanguage();
    if (!launcher.languageKnown) {
        launcher.useSystemLanguage = TestEnglishProduct();
        if (!launcher.useSystemLanguage) ReadProductLanguage();
    }
    ApplyLanguageOption(commandLine);
}
