#pragma once

#include <string>
#include <vector>

namespace discart {

// Where each plate picture is placed, and so what it is cut from.
enum class PlateGround { GamesPanel, InformationPanel, PlayPanel, LanguageList };

struct PlateResource {
    int key;
    int normalId;  // also the focused face
    int pressedId;
    PlateGround ground;
    int x;
    int y;
};

struct IconResource {
    int key;
    int width;
    int height;
    int pictureIds[4];  // by face state; 0 where the state has no face
    int maskIds[4];
};

constexpr int kLanguageListId = 377;
constexpr int kOpaqueMaskId = 248;
constexpr int kAboutPictureId = 241;
constexpr int kAboutMaskId = 264;
constexpr int kPaletteId = 247;
constexpr int kClickId = 113;
constexpr int kMusicId = 308;
constexpr int kIconId = 101;

const std::vector<PlateResource>& PlateResources();
const std::vector<IconResource>& IconResources();

// Writes every picture, the palette, both sounds, the icon and pictures.rc into directory.
bool GenerateResources(const std::string& directory, std::string& error);
// Writes the eighteen language backgrounds into directory.
bool GenerateBackgrounds(const std::string& directory, std::string& error);

}  // namespace discart
