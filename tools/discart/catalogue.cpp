#include "catalogue.h"

#include <map>
#include <sstream>

#include "about.h"
#include "buttons.h"
#include "emblem.h"
#include "formats.h"
#include "palette.h"
#include "panels.h"
#include "scene.h"
#include "sound.h"

namespace discart {

namespace {

struct PanelResource {
    int id;
    PlateGround ground;
    PanelMotif motif;
    int x;
    int y;
    int width;
    int height;
};

const PanelResource kPanels[] = {
    {376, PlateGround::PlayPanel, PanelMotif::Play, 271, 55, 240, 149},
    {227, PlateGround::InformationPanel, PanelMotif::Information, 403, 67, 237, 256},
    {222, PlateGround::GamesPanel, PanelMotif::Games, 403, 54, 237, 252},
};

OrbDesign DesignFor(int key) {
    const Rgb play = Hex(0x17A37E);
    switch (key) {
        case 0:
            return {85, 96, {40.0f, 50.0f}, 35.0f, Hex(0x2C6FD8), InstallSymbol};
        case 1:
            return {85, 96, {40.0f, 50.0f}, 35.0f, play, PlaySymbol};
        case 2:
            return {85, 96, {40.0f, 50.0f}, 35.0f, play, PlaySymbolRaised, Sash::German};
        case 3:
            return {85, 96, {40.0f, 50.0f}, 35.0f, play, PlaySymbolRaised, Sash::Japanese};
        case 4:
            return {85, 96, {40.0f, 50.0f}, 35.0f, play, PlaySymbolRaised, Sash::French};
        case 5:
            return {85, 96, {40.0f, 50.0f}, 35.0f, play, PlaySymbolRaised, Sash::Spanish};
        // The web button's hit circle runs past its picture's left edge; the orb stays inside.
        case 6:
            return {66, 67, {31.0f, 32.0f}, 27.0f, Hex(0x1F8FD0), GlobeSymbol};
        case 7:
            return {73, 79, {33.0f, 42.0f}, 29.0f, Hex(0x7A4FC8), GamepadSymbol};
        case 8:
            return {73, 79, {33.0f, 42.0f}, 29.0f, Hex(0xE08A1E), StarSymbol};
        case 9:
            return {73, 87, {37.0f, 48.0f}, 27.0f, Hex(0x138C9A), BookSymbol};
        default:
            return {54, 54, {26.0f, 25.0f}, 22.0f, Hex(0xD0405A), PowerSymbol};
    }
}

// The opaque part of a face picture, for the palette.
void CollectOpaque(const Picture& picture, const Picture& mask, Picture& into) {
    for (int y = 0; y < picture.height; ++y) {
        for (int x = 0; x < picture.width; ++x) {
            if (mask.Pixel(x, y)[0] < 128) continue;
            const uint8_t* p = picture.Pixel(x, y);
            into.bytes.insert(into.bytes.end(), p, p + 3);
            ++into.width;
        }
    }
}

std::string Join(const std::string& directory, const std::string& name) {
    return directory.empty() || directory.back() == '/' ? directory + name : directory + "/" + name;
}

bool Write(const std::string& directory, const std::string& name, const std::vector<uint8_t>& bytes,
           std::string& error) {
    if (WriteFile(Join(directory, name), bytes)) return true;
    error = "cannot write " + Join(directory, name);
    return false;
}

}  // namespace

const std::vector<PlateResource>& PlateResources() {
    static const std::vector<PlateResource> kPlates = {
        {0, 408, 409, PlateGround::GamesPanel, 416, 29},
        {1, 350, 352, PlateGround::GamesPanel, 416, 81},
        {2, 340, 338, PlateGround::GamesPanel, 416, 133},
        {3, 336, 353, PlateGround::GamesPanel, 416, 185},
        {4, 358, 361, PlateGround::InformationPanel, 416, 28},
        {5, 348, 346, PlateGround::InformationPanel, 416, 81},
        {6, 354, 357, PlateGround::InformationPanel, 416, 133},
        {7, 344, 355, PlateGround::InformationPanel, 416, 185},
        {8, 316, 314, PlateGround::PlayPanel, 295, 71},
        {9, 406, 404, PlateGround::PlayPanel, 295, 19},
        {10, 312, 317, PlateGround::PlayPanel, 295, 123},
        {11, 286, 287, PlateGround::LanguageList, 84, 151},
        {12, 290, 291, PlateGround::LanguageList, 84, 202},
        {13, 294, 295, PlateGround::LanguageList, 84, 253},
        {14, 298, 299, PlateGround::LanguageList, 84, 304},
        {15, 302, 303, PlateGround::LanguageList, 300, 151},
        {16, 306, 307, PlateGround::LanguageList, 300, 202},
        {17, 502, 503, PlateGround::LanguageList, 300, 253},
        {18, 506, 507, PlateGround::LanguageList, 300, 304},
        {19, 510, 511, PlateGround::LanguageList, 300, 355},
        {20, 512, 513, PlateGround::LanguageList, 84, 355},
        {21, 514, 515, PlateGround::LanguageList, 84, 100},
        {22, 516, 517, PlateGround::LanguageList, 300, 100},
    };
    return kPlates;
}

const std::vector<IconResource>& IconResources() {
    static const std::vector<IconResource> kIcons = {
        {0, 85, 96, {223, 246, 245, 0}, {269, 265, 266, 0}},
        {1, 85, 96, {237, 238, 239, 362}, {273, 274, 270, 372}},
        {2, 85, 96, {327, 324, 397, 368}, {319, 325, 396, 369}},
        {3, 85, 96, {395, 240, 236, 367}, {272, 275, 271, 375}},
        {4, 85, 96, {320, 326, 390, 370}, {321, 318, 389, 371}},
        {5, 85, 96, {322, 391, 393, 374}, {323, 392, 394, 373}},
        {6, 66, 67, {333, 330, 332, 0}, {329, 331, 328, 0}},
        {7, 73, 79, {218, 219, 220, 366}, {255, 256, 257, 363}},
        {8, 73, 79, {384, 385, 387, 0}, {388, 386, 383, 0}},
        {9, 73, 87, {224, 225, 226, 364}, {261, 262, 259, 365}},
        {10, 54, 54, {221, 217, 228, 0}, {254, 263, 260, 0}},
        {11, 162, 117, {380, 379, 378, 0}, {267, 268, 267, 0}},
    };
    return kIcons;
}

bool GenerateResources(const std::string& directory, std::string& error) {
    FontLibrary fonts;
    if (!fonts.Load(error)) return false;
    std::map<int, Picture> bitmaps;

    const Picture base = ToPicture(PaintMainScene(fonts), true);
    const Picture list = ToPicture(PaintLanguageListScene(fonts), true);
    bitmaps[kLanguageListId] = list;
    const Picture opaque = PaintOpaqueMask();
    bitmaps[kOpaqueMaskId] = opaque;

    // Each panel plate carries the background with its panel composited over it exactly as the
    // launcher will composite it.
    std::map<PlateGround, Picture> grounds;
    grounds[PlateGround::LanguageList] = list;
    for (const PanelResource& panel : kPanels) {
        const Picture picture =
            PaintPanel(Cut(base, panel.x, panel.y, panel.width, panel.height), panel.motif);
        bitmaps[panel.id] = picture;
        Picture composite = base;
        MaskedBlend(picture, 0, 0, composite, panel.x, panel.y, opaque, 0, 0, composite, panel.x,
                    panel.y, panel.width, panel.height);
        grounds[panel.ground] = composite;
    }
    for (const PlateResource& plate : PlateResources()) {
        const bool fromList = plate.ground == PlateGround::LanguageList;
        const Picture under =
            Cut(grounds[plate.ground], plate.x, plate.y, fromList ? 212 : 209, fromList ? 50 : 49);
        bitmaps[plate.normalId] = PaintPlate(under, false);
        bitmaps[plate.pressedId] = PaintPlate(under, true);
    }

    Picture faceColors(0, 1, 24);
    for (const IconResource& icon : IconResources()) {
        for (int state = 0; state < 4; ++state) {
            if (icon.pictureIds[state] == 0) continue;
            const Canvas face = icon.key == 11
                                    ? PaintAboutButton(fonts, static_cast<FaceState>(state))
                                    : PaintOrb(DesignFor(icon.key), static_cast<FaceState>(state));
            bitmaps[icon.pictureIds[state]] = ToPicture(face);
            // The hover face is drawn inside the normal face's outline and shares its mask.
            if (!bitmaps.count(icon.maskIds[state])) {
                bitmaps[icon.maskIds[state]] = ToGrey(AlphaOf(face));
            }
            CollectOpaque(bitmaps[icon.pictureIds[state]], bitmaps[icon.maskIds[state]],
                          faceColors);
        }
    }
    bitmaps[kAboutMaskId] = ToGrey(AboutSilhouette(fonts));
    const Picture about = ToPicture(PaintAboutPicture(fonts), true);
    bitmaps[kAboutPictureId] = about;

    std::vector<const Picture*> sources = {&base, &list, &about, &faceColors};
    for (const PanelResource& panel : kPanels) sources.push_back(&bitmaps[panel.id]);
    const std::array<Rgb8, 256> palette = BuildPalette(sources);

    std::ostringstream script;
    script << "// Pictures, palette, sounds and icon of the launcher, made by tools/discart.\n";
    for (const auto& entry : bitmaps) {
        const std::string name = "bitmap_" + std::to_string(entry.first) + ".bmp";
        if (!Write(directory, name, EncodeBmp(entry.second), error)) return false;
        script << entry.first << " BITMAP \"" << name << "\"\n";
    }
    if (!Write(directory, "palette_247.pal", EncodePalette(palette), error)) return false;
    script << kPaletteId << " IDR_PALETTE \"palette_247.pal\"\n";
    if (!Write(directory, "wave_113.wav", EncodeWave(SynthesiseClick(), kSampleRate), error) ||
        !Write(directory, "wave_308.wav", EncodeWave(SynthesiseStartupMusic(), kSampleRate),
               error)) {
        return false;
    }
    script << kClickId << " WAVE \"wave_113.wav\"\n";
    script << kMusicId << " WAVE \"wave_308.wav\"\n";
    if (!Write(directory, "icon_101.ico", EncodeIcon({PaintIcon(16), PaintIcon(32), PaintIcon(48)}),
               error)) {
        return false;
    }
    script << kIconId << " ICON \"icon_101.ico\"\n";
    const std::string text = script.str();
    return Write(directory, "pictures.rc", std::vector<uint8_t>(text.begin(), text.end()), error);
}

bool GenerateBackgrounds(const std::string& directory, std::string& error) {
    FontLibrary fonts;
    if (!fonts.Load(error)) return false;
    const Canvas base = PaintMainScene(fonts);
    for (const BackgroundLanguage& language : BackgroundLanguages()) {
        const Picture picture = ToPicture(PaintLanguageBackground(base, fonts, language), true);
        if (!Write(directory, language.fileName, EncodeBmp(picture), error)) return false;
    }
    return true;
}

}  // namespace discart
