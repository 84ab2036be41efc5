// What the launcher learns before its window exists: the disc's edition from ORVAK.INI,
// the installed product's edition and language from the registry, the "-l" option; and
// the one value it writes, the locale code of the language its main menu is built in.
#ifndef AUTOPLAY_LOCALE_CONFIG_WIN_H
#define AUTOPLAY_LOCALE_CONFIG_WIN_H

#include <windows.h>

#include <cstdint>

inline constexpr wchar_t kProductKeyPath[] = L"Software\\Orvak\\The Vemo";
inline constexpr wchar_t kUninstallKeyPath[] =
    L"SOFTWARE\\Microsoft\\Windows\\CurrentVersion\\Uninstall\\"
    L"{6D0C3A41-27E9-4B5F-9C18-3F7A2E90B4D6}";
inline constexpr wchar_t kLocaleKeyPath[] = L"Software\\Orvak\\The Vemo Vodizuri\\Locale";
inline constexpr wchar_t kDiscIniName[] = L"ORVAK.INI";

// Each reader sets the launcher's fields as documented beside it and leaves them alone when
// the key or file it reads is missing.
void ReadDiscSku();          // discSku from [SKU] SKU= of ORVAK.INI in the disc root
void ReadProductSku();       // productSku from VEMO_SKU
void ReadOtherLanguage();    // VEMO_OTHERLANGUAGE settles UK English or a Nordic language
void ReadProductLanguage();  // VEMO_LANGUAGE settles the product's language
bool TestEnglishProduct();   // disc edition 2 with an English product: offer the list
void ApplyLanguageOption(const wchar_t* commandLine);
void LanguageFromLangId(LANGID langId);
bool UninstallEntryExists();
// Removes the installed product's uninstall entry, so its installer runs as a fresh install.
void DeleteUninstallEntry();
void WriteLocale();

// The start-up order of the readers above, including the command-line option.
void ReadConfiguration(const wchar_t* commandLine);

#endif
