#include "locale/catalogue_win.h"

#include <atomic>
#include <string>

#include "graphics/picture_win.h"
#include "shell/launcher_state.h"

LanguageCatalogue catalogue;

namespace {

struct FontRecipe {
    FontSlot slot;
    const wchar_t* face;
    int height;
    int weight;
    BYTE charset;
};

// Created in this order; the East Asian faces are their own names in their own scripts.
constexpr FontRecipe kFonts[kFontSlots] = {
    {FontSlot::Western, L"Comic Sans MS", -16, FW_NORMAL, ANSI_CHARSET},
    {FontSlot::Cyrillic, L"Comic Sans MS", -12, FW_BOLD, RUSSIAN_CHARSET},
    {FontSlot::CentralEuropean, L"Comic Sans MS", -16, FW_NORMAL, EASTEUROPE_CHARSET},
    {FontSlot::Japanese, L"\uFF2D\uFF33 \uFF30\u30B4\u30B7\u30C3\u30AF", -12, FW_BOLD,
     SHIFTJIS_CHARSET},
    {FontSlot::ChineseGB, L"\u5B8B\u4F53", -12, FW_BOLD, GB2312_CHARSET},
    {FontSlot::ChineseBig5, L"\u65B0\u7D30\u660E\u9AD4", -12, FW_BOLD, CHINESEBIG5_CHARSET},
    {FontSlot::Thai, L"Angsana New [Thai]", -16, FW_BOLD, THAI_CHARSET},
    {FontSlot::Korean, L"GulimChe", -12, FW_BOLD, HANGUL_CHARSET},
};

// Released in this order.
constexpr FontSlot kFontReleaseOrder[kFontSlots] = {
    FontSlot::Western, FontSlot::Cyrillic,    FontSlot::CentralEuropean, FontSlot::Japanese,
    FontSlot::ChineseBig5, FontSlot::ChineseGB, FontSlot::Thai,        FontSlot::Korean,
};

// Filled in this order.
constexpr std::pair<LanguageBase, FontSlot> kLanguageFonts[] = {
    {kUsEnglish, FontSlot::Western},       {kUkEnglish, FontSlot::Western},
    {kFrench, FontSlot::Western},          {kGerman, FontSlot::Western},
    {kSwedish, FontSlot::Western},         {kDutch, FontSlot::Western},
    {kPortuguese, FontSlot::Western},      {kSpanish, FontSlot::Western},
    {kItalian, FontSlot::Western},         {kPolish, FontSlot::CentralEuropean},
    {kJapanese, FontSlot::Japanese},       {kTraditionalChinese, FontSlot::ChineseBig5},
    {kSimplifiedChinese, FontSlot::ChineseGB}, {kThai, FontSlot::Thai},
    {kKorean, FontSlot::Korean},           {kDanish, FontSlot::Western},
    {kFinnish, FontSlot::Western},         {kNorwegian, FontSlot::Western},
};

// Only the panel plates (keys 0-7) are drawn with the palette's colours.
constexpr std::int32_t kPalettedPlates = 8;

DibBitmap* FindIn(const PictureTable& table, std::int32_t key) {
    auto it = table.find(key);
    return it == table.end() ? nullptr : it->second.get();
}

void CreateFonts() {
    for (const FontRecipe& recipe : kFonts) {
        catalogue.fontSlots[static_cast<int>(recipe.slot)] =
            CreateFontW(recipe.height, 0, 0, 0, recipe.weight, FALSE, FALSE, FALSE, recipe.charset,
                        OUT_TT_PRECIS, CLIP_DEFAULT_PRECIS, ANTIALIASED_QUALITY, 0, recipe.face);
    }
    for (const auto& [base, slot] : kLanguageFonts) {
        catalogue.languageFonts[base] = catalogue.fontSlots[static_cast<int>(slot)];
    }
}

// Each paint copies a background byte for byte over the working copy, so every background
// must be a block of the one shape the language-selection picture has: 640 × 480, 24-bit.
bool FitsBackgroundShape(const DibBitmap* picture) {
    std::int32_t width = 0, height = 0;
    const std::uint8_t* pixels = nullptr;
    std::uint32_t stride = 0;
    std::uint16_t depth = 0;
    return DibDimensions(picture, width, height) && width == kBackgroundShape.width &&
           height == kBackgroundShape.height && DibRowInfo(picture, pixels, stride, depth) &&
           depth == kBackgroundShape.bitCount &&
           DibBlockSize(picture) == kDibInfoHeaderSize + std::size_t{stride} * height;
}

}  // namespace

HFONT FontFor(LanguageBase base) {
    auto it = catalogue.languageFonts.find(base);
    return it == catalogue.languageFonts.end() ? nullptr : it->second;
}

DibBitmap* PlateFor(int state, std::int32_t key) {
    return state >= 0 && state < kPlateStates ? FindIn(catalogue.buttonPlates[state], key) : nullptr;
}

DibBitmap* IconPictureFor(int state, std::int32_t key) {
    return state >= 0 && state < kIconStates ? FindIn(catalogue.iconPictures[state], key) : nullptr;
}

DibBitmap* IconMaskFor(int state, std::int32_t key) {
    return state >= 0 && state < kIconStates ? FindIn(catalogue.iconMasks[state], key) : nullptr;
}

DibBitmap* BackgroundFor(std::int32_t key) { return FindIn(catalogue.languageBackgrounds, key); }

namespace {

// The background files are most of what start-up reads, and reading them needs no GDI: a
// thread of their own reads them while the program's own pictures load, and the main thread
// takes its share of the files once it has nothing else to do.
struct BackgroundReadAhead {
    std::wstring rootPath;
    HANDLE thread = nullptr;
    std::array<DibBitmap*, kLanguageCount> pictures{};
    std::array<bool, kLanguageCount> gdiNeeded{};
    // The next file nobody has taken yet: each file is read by exactly one thread.
    std::atomic<std::size_t> next{0};
};
BackgroundReadAhead readAhead;

DWORD WINAPI ReadBackgroundFiles(void*) {
    for (std::size_t i = readAhead.next++; i < kLanguageCount; i = readAhead.next++) {
        const std::wstring path = readAhead.rootPath + Languages()[i].backgroundFile;
        bool gdiNeeded = false;
        readAhead.pictures[i] = ReadStoredPictureFile(path.c_str(), gdiNeeded);
        readAhead.gdiNeeded[i] = gdiNeeded;
    }
    return 0;
}

void FinishReadingBackgrounds();

void StartReadingBackgrounds() {
    FinishReadingBackgrounds();
    readAhead.rootPath = launcher.rootPath;
    readAhead.next = 0;
    readAhead.thread = CreateThread(nullptr, 0, ReadBackgroundFiles, nullptr, 0, nullptr);
}

// What the thread read, once it is done; null when it never ran or GDI must read the file.
DibPtr TakeReadAhead(std::size_t language, bool& ready, bool& gdiNeeded) {
    ready = readAhead.thread != nullptr;
    gdiNeeded = readAhead.gdiNeeded[language];
    return DibPtr(std::exchange(readAhead.pictures[language], nullptr));
}

void FinishReadingBackgrounds() {
    if (!readAhead.thread) return;
    // What is not read yet is not needed any more.
    readAhead.next = kLanguageCount;
    WaitForSingleObject(readAhead.thread, INFINITE);
    CloseHandle(readAhead.thread);
    readAhead.thread = nullptr;
    for (DibBitmap*& picture : readAhead.pictures) DibFree(std::exchange(picture, nullptr));
}

}  // namespace

bool LoadBackgrounds() {
    PictureTable& backgrounds = catalogue.languageBackgrounds;
    backgrounds[0].reset(LoadPictureResource(kLanguageListBackgroundId, kLoadResourcePicture));
    // The pictures read ahead are the files' stored bytes, which are the pictures only where
    // GDI would hand those bytes back unchanged; anywhere else GDI reads the files again.
    const bool storedBytes = PicturesKeepTheirStoredBytes(kLoadFilePicture);
    if (readAhead.thread) {
        ReadBackgroundFiles(nullptr);
        WaitForSingleObject(readAhead.thread, INFINITE);
    }
    for (std::size_t i = 0; i < kLanguageCount; ++i) {
        const LanguageInfo& language = Languages()[i];
        const std::wstring path = std::wstring(launcher.rootPath) + language.backgroundFile;
        bool ready = false;
        bool gdiNeeded = false;
        DibPtr picture = TakeReadAhead(i, ready, gdiNeeded);
        if (!ready || !storedBytes || gdiNeeded) {
            picture.reset(LoadPictureFile(path.c_str(), kLoadFilePicture));
        }
        backgrounds[static_cast<std::int32_t>(language.base)] = std::move(picture);
    }
    FinishReadingBackgrounds();

    // A disc file of another shape counts as missing, and so would a language-selection
    // picture that is not what the program was built with; the size never comes from a file.
    DibBitmap* first = nullptr;
    catalogue.firstBackgroundKey = -1;
    for (auto& [key, entry] : backgrounds) {
        if (entry && !FitsBackgroundShape(entry.get())) entry.reset();
        if (entry && key != 0 && !first) {
            first = entry.get();
            catalogue.firstBackgroundKey = key;
        }
    }

    launcher.workingBackground.reset(CloneDib(first));
    std::int32_t width = 0;
    std::int32_t height = 0;
    if (!launcher.workingBackground || !DibDimensions(first, width, height)) width = height = 0;
    launcher.backgroundWidth = width;
    launcher.backgroundHeight = height;
    return ApplyLauncherPalette(first);
}

namespace {

void MakeLauncherPalette() {
    launcher.palette.Reset(CreateLauncherPalette());
}

void AddPrivateFont() {
    catalogue.fontFileAdded += AddFontResourceW(kPrivateFontFile);
    // Other programs need only hear of the change, and the launcher needs nothing back from
    // them: a notification does not keep start-up waiting on every window of the desktop.
    SendNotifyMessageW(HWND_BROADCAST, WM_FONTCHANGE, 0, 0);
}

void LoadBackgroundPictures() {
    LoadBackgrounds();
}

void ReadBackgroundsAhead() { StartReadingBackgrounds(); }

void LoadPlates() {
    for (std::int32_t key = 0; key < kPlateKeys; ++key) {
        for (int state = 0; state < kPlateStates; ++state) {
            catalogue.buttonPlates[state][key].reset(
                LoadPictureResource(kPlateResources[key][state], kLoadResourcePicture));
        }
    }
}

void LoadPanels() {
    catalogue.opaqueMask.reset(LoadPictureResource(kOpaqueMaskId, kLoadResourcePicture));
    for (int panel : {1, 2, 0}) {
        catalogue.panelPictures[panel].reset(
            LoadPictureResource(kPanelResources[panel].id, kLoadResourcePicture));
    }
}

void LoadIcons() {
    for (std::int32_t key : kIconLoadOrder) {
        const IconResources& resources = kIconResources[key];
        for (int state = 0; state < kIconStates; ++state) {
            if (resources.picture[state] == 0) continue;
            catalogue.iconPictures[state][key].reset(
                LoadPictureResource(resources.picture[state], kLoadResourcePicture));
        }
        for (int state = 0; state < kIconStates; ++state) {
            if (resources.mask[state] == 0) continue;
            catalogue.iconMasks[state][key].reset(
                LoadPictureResource(resources.mask[state], kLoadResourcePicture));
        }
    }
}

// The language list's About button gets pictures of its own, so no picture has two owners.
void CloneListAboutPictures() {
    for (int state = 0; state < kPlateStates; ++state) {
        catalogue.iconPictures[state][kListAboutIconKey].reset(
            CloneDib(IconPictureFor(state, kAboutIconKey)));
    }
    for (int state = 0; state < kPlateStates; ++state) {
        catalogue.iconMasks[state][kListAboutIconKey].reset(
            CloneDib(IconMaskFor(state, kAboutIconKey)));
    }
}

void ApplyPaletteToPanelPlates() {
    for (std::int32_t key = 0; key < kPalettedPlates; ++key) {
        for (int state = 0; state < kPlateStates; ++state) {
            if (DibBitmap* plate = PlateFor(state, key)) ApplyLauncherPalette(plate);
        }
    }
}

// The background files are read on a thread of their own from the first step on, and taken in
// the last one, so their reading overlaps everything else.
constexpr std::array<CatalogueStep, kCatalogueStepCount> kSteps = {{
    {"background files (read ahead)", ReadBackgroundsAhead},
    {"palette", MakeLauncherPalette},
    {"private font", AddPrivateFont},
    {"fonts", CreateFonts},
    {"plates", LoadPlates},
    {"panels and mask", LoadPanels},
    {"icons and masks", LoadIcons},
    {"clones", CloneListAboutPictures},
    {"plate colours", ApplyPaletteToPanelPlates},
    {"backgrounds", LoadBackgroundPictures},
}};

}  // namespace

const std::array<CatalogueStep, kCatalogueStepCount>& CatalogueSteps() {
    return kSteps;
}

void LoadCatalogue() {
    for (const CatalogueStep& step : kSteps) step.run();
}

void ReleaseCatalogue() {
    FinishReadingBackgrounds();
    for (FontSlot slot : kFontReleaseOrder) {
        HFONT& font = catalogue.fontSlots[static_cast<int>(slot)];
        if (font) DeleteObject(font);
        font = nullptr;
    }
    catalogue.languageFonts.clear();
    if (catalogue.fontFileAdded > 0) {
        RemoveFontResourceW(kPrivateFontFile);
        SendNotifyMessageW(HWND_BROADCAST, WM_FONTCHANGE, 0, 0);
        catalogue.fontFileAdded = 0;
    }
    catalogue.languageBackgrounds.clear();
    for (PictureTable& table : catalogue.buttonPlates) table.clear();
    for (PictureTable& table : catalogue.iconPictures) table.clear();
    for (PictureTable& table : catalogue.iconMasks) table.clear();
    for (DibPtr& panel : catalogue.panelPictures) panel.reset();
    catalogue.opaqueMask.reset();
    launcher.workingBackground.reset();
    launcher.backgroundBitmap.Reset();
    launcher.paletteTable.reset();
    launcher.palette.Reset();
}
