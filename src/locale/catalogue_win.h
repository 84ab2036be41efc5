// The fonts and pictures of every language and every button state, prepared once at start-up
// so that painting and a change of language never load anything.
#ifndef AUTOPLAY_LOCALE_CATALOGUE_WIN_H
#define AUTOPLAY_LOCALE_CATALOGUE_WIN_H

#include <windows.h>

#include <array>
#include <cstdint>
#include <map>

#include "graphics/dib.h"
#include "locale/language_table.h"
#include "locale/picture_ids.h"

constexpr int kFontSlots = 8;

using PictureTable = std::map<std::int32_t, DibPtr>;

struct LanguageCatalogue {
    std::array<HFONT, kFontSlots> fontSlots{};  // indexed by FontSlot
    int fontFileAdded = 0;
    std::map<LanguageBase, HFONT> languageFonts;
    // Key 0: the language-selection background; otherwise a language base.
    PictureTable languageBackgrounds;
    // The background the working copy was made from: painted in place of a missing one.
    std::int32_t firstBackgroundKey = -1;
    std::array<PictureTable, kPlateStates> buttonPlates;
    std::array<PictureTable, kIconStates> iconPictures;
    std::array<PictureTable, kIconStates> iconMasks;
    std::array<DibPtr, 3> panelPictures;
    DibPtr opaqueMask;
};

extern LanguageCatalogue catalogue;

inline constexpr wchar_t kPrivateFontFile[] = L"comicbd.ttf";

// Sets the launcher's background size; 0 × 0 when no background could be loaded, which means
// the launcher is not running from its disc.
void LoadCatalogue();
void ReleaseCatalogue();

// What LoadCatalogue does, step by step and in its order; the start-up benchmark times each.
struct CatalogueStep {
    const char* name;
    void (*run)();
};
constexpr std::size_t kCatalogueStepCount = 10;
const std::array<CatalogueStep, kCatalogueStepCount>& CatalogueSteps();

// Lookups: null when the table has no such entry.
HFONT FontFor(LanguageBase base);
DibBitmap* PlateFor(int state, std::int32_t key);
DibBitmap* IconPictureFor(int state, std::int32_t key);
DibBitmap* IconMaskFor(int state, std::int32_t key);
DibBitmap* BackgroundFor(std::int32_t key);

// Loads the language-selection background and the eighteen language backgrounds of the disc,
// and makes the working copy; returns what applying the palette to the first one gave.
bool LoadBackgrounds();

#endif
