// The eighteen languages of the launcher and everything that is chosen by language:
// the registry names, Windows language identifiers, locale codes, installer arguments,
// readme files and regional web sites. Platform-neutral: no windows.h.
#ifndef AUTOPLAY_LOCALE_LANGUAGE_TABLE_H
#define AUTOPLAY_LOCALE_LANGUAGE_TABLE_H

#include <array>
#include <cstdint>
#include <string_view>

// A language base names a language and is the base of its string ids (id = base + offset).
using LanguageBase = std::uint32_t;

constexpr LanguageBase kNoLanguage = 0;        // no language settled yet
constexpr LanguageBase kActiveLanguage = 20000;  // "the active language at creation" for buttons
constexpr LanguageBase kUsEnglish = 1000;
constexpr LanguageBase kFrench = 2000;
constexpr LanguageBase kGerman = 3000;
constexpr LanguageBase kSwedish = 4000;
constexpr LanguageBase kDutch = 5000;
constexpr LanguageBase kPortuguese = 6000;
constexpr LanguageBase kSpanish = 7000;
constexpr LanguageBase kItalian = 8000;
constexpr LanguageBase kPolish = 10000;
constexpr LanguageBase kJapanese = 11000;
constexpr LanguageBase kTraditionalChinese = 12000;
constexpr LanguageBase kSimplifiedChinese = 13000;
constexpr LanguageBase kThai = 14000;
constexpr LanguageBase kKorean = 15000;
constexpr LanguageBase kUkEnglish = 16000;
constexpr LanguageBase kNorwegian = 17000;
constexpr LanguageBase kFinnish = 18000;
constexpr LanguageBase kDanish = 19000;

// The fonts the catalogue creates; several languages share one.
enum class FontSlot { Western, Cyrillic, CentralEuropean, Japanese, ChineseGB, ChineseBig5, Thai, Korean };

struct LanguageInfo {
    LanguageBase base;
    FontSlot font;
    const wchar_t* backgroundFile;  // below the disc root
    const wchar_t* localeCode;      // written to the Locale registry value
    std::uint16_t installerLangId;  // passed to setup.exe as -l%04x
    const wchar_t* readmeFile;      // below the disc root
    const wchar_t* webSite;         // opened exactly as stored
};

constexpr std::size_t kLanguageCount = 18;
// In rising order of language base.
const std::array<LanguageInfo, kLanguageCount>& Languages();
// Null for a base that names no language (0, 9000, 20000, ...).
const LanguageInfo* FindLanguage(LanguageBase base);

// Every Windows LANGID maps to a language; those the launcher does not carry map to US English.
LanguageBase LanguageBaseForLangId(std::uint16_t langId);
// "VEMO_LANGUAGE": exact, case-sensitive names; anything else is US English.
LanguageBase LanguageBaseForProductName(std::wstring_view name);
// "VEMO_OTHERLANGUAGE": UK English and the Nordic languages; anything else is UK English.
LanguageBase LanguageBaseForOtherName(std::wstring_view name);

// Product edition from the first byte of "VEMO_SKU", read as a signed number.
std::uint32_t ProductSkuFromFirstByte(std::int8_t firstByte);

// The choices below fall back to US English (locale, readme) or the international site
// for a base without an entry; the installer gets the US English LANGID 0x0409.
const wchar_t* LocaleCodeFor(LanguageBase base);
std::uint16_t InstallerLangIdFor(LanguageBase base);
const wchar_t* ReadmeFileFor(LanguageBase base);
const wchar_t* WebSiteFor(LanguageBase base);

#endif
