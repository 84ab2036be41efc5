#include "locale/catalogue_win.h"

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

// Plate resources by key, for the normal, pressed and focused states.
constexpr WORD kPlateResources[23][kPlateStates] = {
    {408, 409, 408}, {350, 352, 350}, {340, 338, 340}, {336, 353, 336}, {358, 361, 358},
    {348, 346, 348}, {354, 357, 354}, {344, 355, 344}, {316, 314, 316}, {406, 404, 406},
    {312, 317, 312}, {286, 287, 286}, {290, 291, 290}, {294, 295, 294}, {298, 299, 298},
    {302, 303, 302}, {306, 307, 306}, {502, 503, 502}, {506, 507, 506}, {510, 511, 510},
    {512, 513, 512}, {514, 515, 514}, {516, 517, 516},
};

struct IconResources {
    WORD picture[kIconStates];  // 0: the button has no such state
    WORD mask[kIconStates];
};

// Circular button resources by key 0-11 (key 12 holds copies of key 11).
constexpr IconResources kIconResources[12] = {
    {{223, 246, 245, 0}, {269, 265, 266, 0}},
    {{237, 238, 239, 362}, {273, 274, 270, 372}},
    {{327, 324, 397, 368}, {319, 325, 396, 369}},
    {{395, 240, 236, 367}, {272, 275, 271, 375}},
    {{320, 326, 390, 370}, {321, 318, 389, 371}},
    {{322, 391, 393, 374}, {323, 392, 394, 373}},
    {{333, 330, 332, 0}, {329, 331, 328, 0}},
    {{218, 219, 220, 366}, {255, 256, 257, 363}},
    {{384, 385, 387, 0}, {388, 386, 383, 0}},
    {{224, 225, 226, 364}, {261, 262, 259, 365}},
    {{221, 217, 228, 0}, {254, 263, 260, 0}},
    {{380, 379, 378, 0}, {267, 268, 267, 0}},
};
constexpr std::int32_t kIconLoadOrder[] = {0, 1, 2, 3, 4, 5, 6, 7, 8, 10, 9, 11};
constexpr std::int32_t kAboutIcon = 11;
constexpr std::int32_t kListAboutIcon = 12;

constexpr WORD kOpaqueMaskResource = 248;
constexpr WORD kPanelResources[3] = {376, 227, 222};
constexpr WORD kLanguageListBackground = 377;
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

// Two pictures are interchangeable as backgrounds when a byte-for-byte copy of one over the
// other is a whole picture again.
bool SameShape(const DibBitmap* a, const DibBitmap* b) {
    std::int32_t wa = 0, ha = 0, wb = 0, hb = 0;
    const std::uint8_t* pixels = nullptr;
    std::uint32_t stride = 0;
    std::uint16_t depthA = 0, depthB = 0;
    return DibDimensions(a, wa, ha) && DibDimensions(b, wb, hb) && wa == wb && ha == hb &&
           DibRowInfo(a, pixels, stride, depthA) && DibRowInfo(b, pixels, stride, depthB) &&
           depthA == depthB && DibBlockSize(a) == DibBlockSize(b);
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

bool LoadBackgrounds() {
    PictureTable& backgrounds = catalogue.languageBackgrounds;
    backgrounds[0].reset(LoadPictureResource(kLanguageListBackground, kLoadResourcePicture));
    for (const LanguageInfo& language : Languages()) {
        std::wstring path = std::wstring(launcher.rootPath) + language.backgroundFile;
        backgrounds[static_cast<std::int32_t>(language.base)].reset(
            LoadPictureFile(path.c_str(), kLoadFilePicture));
    }

    // The first language background sets the size of the window and of the working copy;
    // one that does not match it could not be copied over the working copy, so it counts
    // as missing.
    DibBitmap* first = nullptr;
    catalogue.firstBackgroundKey = -1;
    for (const LanguageInfo& language : Languages()) {
        DibPtr& entry = backgrounds[static_cast<std::int32_t>(language.base)];
        if (!entry) continue;
        if (!first) {
            first = entry.get();
            catalogue.firstBackgroundKey = static_cast<std::int32_t>(language.base);
        } else if (!SameShape(entry.get(), first)) {
            entry.reset();
        }
    }
    if (first && backgrounds[0] && !SameShape(backgrounds[0].get(), first)) backgrounds[0].reset();

    launcher.workingBackground.reset(CloneDib(first));
    std::int32_t width = 0;
    std::int32_t height = 0;
    if (!launcher.workingBackground || !DibDimensions(first, width, height)) width = height = 0;
    launcher.backgroundWidth = width;
    launcher.backgroundHeight = height;
    return ApplyLauncherPalette(first);
}

void LoadCatalogue() {
    launcher.palette.Reset(CreateLauncherPalette());
    catalogue.fontFileAdded += AddFontResourceW(kPrivateFontFile);
    // Broadcasts can stall on a hung window; the font is usable by the launcher either way.
    SendMessageTimeoutW(HWND_BROADCAST, WM_FONTCHANGE, 0, 0, SMTO_ABORTIFHUNG, 1000, nullptr);
    CreateFonts();
    LoadBackgrounds();

    for (std::int32_t key = 0; key < static_cast<std::int32_t>(std::size(kPlateResources)); ++key) {
        for (int state = 0; state < kPlateStates; ++state) {
            catalogue.buttonPlates[state][key].reset(
                LoadPictureResource(kPlateResources[key][state], kLoadResourcePicture));
        }
    }
    catalogue.opaqueMask.reset(LoadPictureResource(kOpaqueMaskResource, kLoadResourcePicture));
    for (int panel : {1, 2, 0}) {
        catalogue.panelPictures[panel].reset(
            LoadPictureResource(kPanelResources[panel], kLoadResourcePicture));
    }
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
    // The language list's About button gets pictures of its own, so no picture has two owners.
    for (int state = 0; state < kPlateStates; ++state) {
        catalogue.iconPictures[state][kListAboutIcon].reset(
            CloneDib(IconPictureFor(state, kAboutIcon)));
    }
    for (int state = 0; state < kPlateStates; ++state) {
        catalogue.iconMasks[state][kListAboutIcon].reset(CloneDib(IconMaskFor(state, kAboutIcon)));
    }
    for (std::int32_t key = 0; key < kPalettedPlates; ++key) {
        for (int state = 0; state < kPlateStates; ++state) {
            if (DibBitmap* plate = PlateFor(state, key)) ApplyLauncherPalette(plate);
        }
    }
}

void ReleaseCatalogue() {
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
