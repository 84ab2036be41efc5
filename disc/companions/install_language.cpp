#include "install_language.h"

namespace {

// Primary language identifiers (the low ten bits of a LANGID) and sub-languages, as winnt.h
// defines them.
constexpr std::uint16_t kPrimaryMask = 0x03FF;
constexpr std::uint16_t kChinese = 0x04;
constexpr std::uint16_t kDanish = 0x06;
constexpr std::uint16_t kGerman = 0x07;
constexpr std::uint16_t kEnglish = 0x09;
constexpr std::uint16_t kSpanish = 0x0A;
constexpr std::uint16_t kFinnish = 0x0B;
constexpr std::uint16_t kFrench = 0x0C;
constexpr std::uint16_t kItalian = 0x10;
constexpr std::uint16_t kJapanese = 0x11;
constexpr std::uint16_t kKorean = 0x12;
constexpr std::uint16_t kDutch = 0x13;
constexpr std::uint16_t kNorwegian = 0x14;
constexpr std::uint16_t kPolish = 0x15;
constexpr std::uint16_t kPortuguese = 0x16;
constexpr std::uint16_t kSwedish = 0x1D;
constexpr std::uint16_t kThai = 0x1E;

constexpr std::uint16_t kEnglishUnitedKingdom = 0x0809;
// Taiwan, Hong Kong, Macao and the neutral traditional id write traditional characters; the
// mainland and Singapore simplified ones.
constexpr std::uint16_t kChineseTaiwan = 0x0404;
constexpr std::uint16_t kChineseHongKong = 0x0C04;
constexpr std::uint16_t kChineseMacao = 0x1404;
constexpr std::uint16_t kChineseTraditional = 0x7C04;

constexpr InstallLanguage kUsEnglish{L"USEnglish", nullptr, L"English"};

}  // namespace

InstallLanguage InstallLanguageFor(std::uint16_t langId) {
    switch (langId & kPrimaryMask) {
        case kEnglish:
            if (langId == kEnglishUnitedKingdom) {
                return {L"UKEnglish", nullptr, L"English (United Kingdom)"};
            }
            return kUsEnglish;
        case kFrench:
            return {L"French", nullptr, L"French"};
        case kGerman:
            return {L"German", nullptr, L"German"};
        case kItalian:
            return {L"Italian", nullptr, L"Italian"};
        case kSwedish:
            return {L"Swedish", nullptr, L"Swedish"};
        case kDutch:
            return {L"Dutch", nullptr, L"Dutch"};
        case kSpanish:
            return {L"Spanish", nullptr, L"Spanish"};
        case kPortuguese:
            return {L"Portuguese", nullptr, L"Portuguese"};
        case kPolish:
            return {L"Polish", nullptr, L"Polish"};
        case kJapanese:
            return {L"Japanese", nullptr, L"Japanese"};
        case kChinese:
            if (langId == kChineseTaiwan || langId == kChineseHongKong || langId == kChineseMacao ||
                langId == kChineseTraditional) {
                return {L"TraditionalChinese", nullptr, L"Traditional Chinese"};
            }
            return {L"SimplifiedChinese", nullptr, L"Simplified Chinese"};
        case kThai:
            return {L"Thai", nullptr, L"Thai"};
        case kKorean:
            return {L"Korean", nullptr, L"Korean"};
        case kNorwegian:
            return {L"UKEnglish", L"Norwegian", L"Norwegian"};
        case kDanish:
            return {L"UKEnglish", L"Danish", L"Danish"};
        case kFinnish:
            return {L"UKEnglish", L"Finnish", L"Finnish"};
        default:
            return kUsEnglish;
    }
}
