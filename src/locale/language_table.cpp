#include "locale/language_table.h"

#include <algorithm>

#include "locale/regional_sites.h"

namespace {

#define SITE(host) L"" host

constexpr std::array<LanguageInfo, kLanguageCount> kLanguages = {{
    {kUsEnglish, FontSlot::Western, L"Launcher\\AutoPlayBack.bmp", L"en_US", 0x0009,
     L"support\\readme.txt", SITE(VEMO_SITE_INTERNATIONAL)},
    {kFrench, FontSlot::Western, L"Launcher\\AutoPlayBackFr.bmp", L"fr_FR", 0x040c,
     L"support\\Lisezmoi.txt", SITE(VEMO_SITE_FRANCE)},
    {kGerman, FontSlot::Western, L"Launcher\\AutoPlayBackDe.bmp", L"de", 0x0007,
     L"support\\Liesmich.txt", SITE(VEMO_SITE_GERMANY)},
    {kSwedish, FontSlot::Western, L"Launcher\\AutoPlayBackSw.bmp", L"sv", 0x001d,
     L"support\\Lasmig.TXT", SITE(VEMO_SITE_SWEDEN)},
    {kDutch, FontSlot::Western, L"Launcher\\AutoPlayBackDu.bmp", L"nl", 0x0013,
     L"support\\Leesmij.txt", SITE(VEMO_SITE_NETHERLANDS)},
    {kPortuguese, FontSlot::Western, L"Launcher\\AutoPlayBackPr.bmp", L"pt_BR", 0x0416,
     L"support\\Leia-me.txt", SITE(VEMO_SITE_BRAZIL)},
    {kSpanish, FontSlot::Western, L"Launcher\\AutoPlayBackSp.bmp", L"es", 0x000a,
     L"support\\Leeme.txt", SITE(VEMO_SITE_SPAIN)},
    {kItalian, FontSlot::Western, L"Launcher\\AutoPlayBackIt.bmp", L"it", 0x0010,
     L"support\\Leggimi.txt", SITE(VEMO_SITE_ITALY)},
    {kPolish, FontSlot::CentralEuropean, L"Launcher\\AutoPlayBackPo.bmp", L"pl", 0x0015,
     L"support\\ReadmeP.txt", SITE(VEMO_SITE_INTERNATIONAL)},
    {kJapanese, FontSlot::Japanese, L"Launcher\\AutoPlayBackJp.bmp", L"ja", 0x0011,
     L"support\\readmeJ.txt", SITE(VEMO_SITE_JAPAN)},
    {kTraditionalChinese, FontSlot::ChineseBig5, L"Launcher\\AutoPlayBackTC.bmp", L"zh_TW", 0x0404,
     L"support\\readmeTC.txt", SITE(VEMO_SITE_TAIWAN)},
    {kSimplifiedChinese, FontSlot::ChineseGB, L"Launcher\\AutoPlayBackSC.bmp", L"zh_CN", 0x0804,
     L"support\\readmeSC.txt", SITE(VEMO_SITE_INTERNATIONAL)},
    {kThai, FontSlot::Thai, L"Launcher\\AutoPlayBackTh.bmp", L"th", 0x001e,
     L"support\\readmeTh.txt", SITE(VEMO_SITE_INTERNATIONAL)},
    {kKorean, FontSlot::Korean, L"Launcher\\AutoPlayBackKo.bmp", L"ko", 0x0012,
     L"support\\readmeKo.txt", SITE(VEMO_SITE_KOREA_ADDRESS)},
    {kUkEnglish, FontSlot::Western, L"Launcher\\AutoPlayBackUk.bmp", L"en_UK", 0x0009,
     L"support\\readmeUK.txt", SITE(VEMO_SITE_UNITED_KINGDOM)},
    {kNorwegian, FontSlot::Western, L"Launcher\\AutoPlayBackNO.bmp", L"no", 0x0014,
     L"support\\readmeNO.txt", SITE(VEMO_SITE_NORWAY)},
    {kFinnish, FontSlot::Western, L"Launcher\\AutoPlayBackFI.bmp", L"fi", 0x000b,
     L"support\\readmeFI.txt", SITE(VEMO_SITE_INTERNATIONAL)},
    {kDanish, FontSlot::Western, L"Launcher\\AutoPlayBackDN.bmp", L"da", 0x0006,
     L"support\\readmeDN.txt", SITE(VEMO_SITE_DENMARK)},
}};

#undef SITE

struct NamedLanguage {
    std::wstring_view name;
    LanguageBase base;
};

// Order matters only for readability: names are unique and compared exactly.
constexpr NamedLanguage kProductNames[] = {
    {L"USEnglish", kUsEnglish},
    {L"UKEnglish", kUkEnglish},
    {L"French", kFrench},
    {L"German", kGerman},
    {L"Italian", kItalian},
    {L"Swedish", kSwedish},
    {L"Dutch", kDutch},
    {L"Spanish", kSpanish},
    {L"Portuguese", kPortuguese},
    {L"Polish", kPolish},
    {L"Japanese", kJapanese},
    {L"TraditionalChinese", kTraditionalChinese},
    {L"SimplifiedChinese", kSimplifiedChinese},
    {L"Thai", kThai},
    {L"Korean", kKorean},
};

constexpr NamedLanguage kOtherNames[] = {
    {L"UKEnglish", kUkEnglish},
    {L"Norwegian", kNorwegian},
    {L"Danish", kDanish},
    {L"Finnish", kFinnish},
};

template <std::size_t N>
LanguageBase FindByName(const NamedLanguage (&names)[N], std::wstring_view name,
                        LanguageBase fallback) {
    for (const NamedLanguage& entry : names) {
        if (entry.name == name) return entry.base;
    }
    return fallback;
}

}  // namespace

const std::array<LanguageInfo, kLanguageCount>& Languages() { return kLanguages; }

const LanguageInfo* FindLanguage(LanguageBase base) {
    auto it = std::find_if(kLanguages.begin(), kLanguages.end(),
                           [base](const LanguageInfo& info) { return info.base == base; });
    return it == kLanguages.end() ? nullptr : &*it;
}

LanguageBase LanguageBaseForLangId(std::uint16_t langId) {
    switch (langId) {
        case 0x040C: case 0x080C: case 0x0C0C: case 0x100C: case 0x140C:
            return kFrench;
        case 0x0007: case 0x0407: case 0x0807: case 0x0C07: case 0x1007: case 0x1407:
            return kGerman;
        case 0x001D: case 0x041D: case 0x081D:
            return kSwedish;
        case 0x0013: case 0x0413: case 0x0813:
            return kDutch;
        case 0x0416:
            return kPortuguese;
        case 0x0010: case 0x0410: case 0x0810:
            return kItalian;
        case 0x0015: case 0x0415:
            return kPolish;
        case 0x0411:
            return kJapanese;
        case 0x0404:
            return kTraditionalChinese;
        case 0x0804: case 0x0C04: case 0x1004:
            return kSimplifiedChinese;
        case 0x041E:
            return kThai;
        case 0x0412:
            return kKorean;
        case 0x0809:
            return kUkEnglish;
        case 0x0014: case 0x0414: case 0x0814:
            return kNorwegian;
        case 0x000B: case 0x040B:
            return kFinnish;
        case 0x0006: case 0x0406:
            return kDanish;
        default:
            break;
    }
    // Spanish: the neutral id and every regional id from 040A to 500A.
    if (langId == 0x000A || ((langId & 0x03FF) == 0x000A && langId >= 0x040A && langId <= 0x500A)) {
        return kSpanish;
    }
    return kUsEnglish;
}

LanguageBase LanguageBaseForProductName(std::wstring_view name) {
    return FindByName(kProductNames, name, kUsEnglish);
}

LanguageBase LanguageBaseForOtherName(std::wstring_view name) {
    return FindByName(kOtherNames, name, kUkEnglish);
}

std::uint32_t ProductSkuFromFirstByte(std::int8_t firstByte) {
    if (firstByte >= 1 && firstByte <= 9) return static_cast<std::uint32_t>(firstByte);
    if (firstByte == 10) return 2;
    return 0;
}

const wchar_t* LocaleCodeFor(LanguageBase base) {
    const LanguageInfo* info = FindLanguage(base);
    return info ? info->localeCode : L"en_US";
}

std::uint16_t InstallerLangIdFor(LanguageBase base) {
    const LanguageInfo* info = FindLanguage(base);
    return info ? info->installerLangId : 0x0409;
}

const wchar_t* ReadmeFileFor(LanguageBase base) {
    const LanguageInfo* info = FindLanguage(base);
    return info ? info->readmeFile : L"support\\readme.txt";
}

const wchar_t* WebSiteFor(LanguageBase base) {
    const LanguageInfo* info = FindLanguage(base);
    return info ? info->webSite : L"" VEMO_SITE_INTERNATIONAL;
}
