// Which bitmap resource of the program holds which picture, with the size and depth each one
// must have. The launcher loads its catalogue from these tables; the disc check reads the
// same tables to tell whether a built program carries every picture.
#ifndef AUTOPLAY_LOCALE_PICTURE_IDS_H
#define AUTOPLAY_LOCALE_PICTURE_IDS_H

#include <array>
#include <cstdint>

constexpr int kPlateStates = 3;  // normal, pressed, focused: plates have no latched face
constexpr int kIconStates = 4;   // normal, pressed, focused, latched
constexpr std::int32_t kPlateKeys = 23;
constexpr std::int32_t kIconKeys = 13;     // key 12 holds copies of key 11's pictures
constexpr std::int32_t kLoadedIconKeys = 12;
constexpr std::int32_t kAboutIconKey = 11;
constexpr std::int32_t kListAboutIconKey = 12;

constexpr std::uint16_t kLanguageListBackgroundId = 377;
constexpr std::uint16_t kOpaqueMaskId = 248;
constexpr std::uint16_t kPaletteId = 247;
constexpr std::uint16_t kAboutPictureId = 241;
constexpr std::uint16_t kClickSoundId = 113;
constexpr std::uint16_t kMusicId = 308;
constexpr std::uint16_t kProgramIconId = 101;

struct PictureShape {
    std::int32_t width;
    std::int32_t height;
    std::uint16_t bitCount;
};

constexpr PictureShape kBackgroundShape{640, 480, 24};
constexpr PictureShape kOpaqueMaskShape{350, 350, 8};
constexpr PictureShape kAboutPictureShape{400, 488, 24};

// Plate resources by key, for the normal, pressed and focused states (the focused face is
// the normal picture loaded a second time).
extern const std::uint16_t kPlateResources[kPlateKeys][kPlateStates];
PictureShape PlateShape(std::int32_t key);

struct IconResources {
    PictureShape shape;                  // of the picture; its mask is 8-bit of the same size
    std::uint16_t picture[kIconStates];  // 0: the button has no face in that state
    std::uint16_t mask[kIconStates];
};
// Circular button resources by key 0-11.
extern const IconResources kIconResources[kLoadedIconKeys];
// Keys in the order the catalogue loads them.
extern const std::int32_t kIconLoadOrder[kLoadedIconKeys];

// Fold-out panel backdrops by open panel (0 play, 1 information, 2 games).
struct PanelResource {
    std::uint16_t id;
    PictureShape shape;
};
extern const std::array<PanelResource, 3> kPanelResources;

#endif
