// Composes preview pictures from generated files the way the launcher composites them: contact
// sheets of the button faces and plates, and mock-ups of the screens with their captions.
#include <cstdio>
#include <map>
#include <string>
#include <vector>

#include "catalogue.h"
#include "formats.h"
#include "text.h"

namespace {

using namespace discart;

constexpr Rgb kCaption = Hex(0x00008C);

class Art {
  public:
    explicit Art(std::string dir) : directory(std::move(dir)) {}

    const Picture& Get(const std::string& name) {
        auto it = cache.find(name);
        if (it != cache.end()) return it->second;
        std::vector<uint8_t> bytes;
        Picture picture;
        if (!ReadFile(directory + "/" + name, bytes) || !DecodeBmp(bytes, picture)) {
            std::fprintf(stderr, "discart_preview: cannot read %s/%s\n", directory.c_str(),
                         name.c_str());
            failed = true;
            picture = Picture(1, 1, 24);
        }
        return cache.emplace(name, std::move(picture)).first->second;
    }
    const Picture& Bitmap(int id) { return Get("bitmap_" + std::to_string(id) + ".bmp"); }

    bool failed = false;

  private:
    std::string directory;
    std::map<std::string, Picture> cache;
};

const IconResource& Icon(int key) {
    return IconResources()[static_cast<size_t>(key)];
}

void DrawFace(Art& art, Picture& target, int key, int state, int x, int y) {
    const IconResource& icon = Icon(key);
    const Picture& face = art.Bitmap(icon.pictureIds[state]);
    const Picture& mask = art.Bitmap(icon.maskIds[state]);
    MaskedBlend(face, 0, 0, target, x, y, mask, 0, 0, target, x, y, face.width, face.height);
}

// Plain text the way GDI draws a label or caption: one colour, no effects.
void DrawLabel(Picture& target, const FontLibrary& fonts, Face face, const std::string& text,
               float x, float baseline, Rgb color) {
    Canvas canvas = ToCanvas(target);
    TextStyle style;
    style.fillTop = color;
    style.fillBottom = color;
    DrawText(canvas, fonts.Render(face, text, 16.0f), x, baseline, style);
    target = ToPicture(canvas);
}

void DrawCaption(Picture& target, const FontLibrary& fonts, const std::string& text, int right,
                 int bottom) {
    const TextMask mask = fonts.Render(Face::ComicRegular, text, 16.0f);
    DrawLabel(target, fonts, Face::ComicRegular, text, static_cast<float>(right) - mask.advance,
              static_cast<float>(bottom - 5), kCaption);
}

// A plate with its label: text rectangle from (-5, 10) to (width - 5, height + 10), centred,
// moved by two pixels when pressed.
void DrawPlate(Art& art, Picture& target, const FontLibrary& fonts, int id, int x, int y, int state,
               Face face, const std::string& label) {
    const Picture& plate = art.Bitmap(id);
    MaskedBlend(plate, 0, 0, target, x, y, art.Bitmap(kOpaqueMaskId), 0, 0, target, x, y,
                plate.width, plate.height);
    const Rgb colors[] = {Hex(0xCCD3D8), Hex(0x00FFFF), Hex(0xFFFFFF)};
    const TextMask mask = fonts.Render(face, label, 16.0f);
    const float shift = state == 1 ? 2.0f : 0.0f;
    const float centre = static_cast<float>(x) + static_cast<float>(plate.width) * 0.5f - 5.0f;
    DrawLabel(target, fonts, face, label, centre - mask.advance * 0.5f + shift,
              static_cast<float>(y) + 10.0f + 17.0f + shift, colors[state]);
}

Picture Filled(int width, int height, Rgb color) {
    return ToPicture(Canvas(width, height, color));
}

void Paste(Picture& target, const Picture& source, int x, int y) {
    for (int row = 0; row < source.height; ++row) {
        for (int column = 0; column < source.width; ++column) {
            const uint8_t* s = source.Pixel(column, row);
            uint8_t* d = target.Pixel(x + column, y + row);
            d[0] = s[0];
            d[1] = s[1];
            d[2] = s[2];
        }
    }
}

Picture MainMockup(Art& art, const FontLibrary& fonts) {
    Picture screen = art.Get("AutoPlayBack.bmp");
    struct Placed {
        int key;
        int x;
        int y;
    };
    const Placed buttons[] = {{11, 9, 346},  {0, 186, 162}, {7, 330, 268},
                              {6, 272, 225}, {9, 372, 323}, {10, 405, 411}};
    for (const Placed& b : buttons) DrawFace(art, screen, b.key, 0, b.x, b.y);
    DrawCaption(screen, fonts, "Install", 187, 237);
    DrawCaption(screen, fonts, "Visit www.vemo.example", 262, 278);
    DrawCaption(screen, fonts, "More Vemo Games", 329, 332);
    DrawCaption(screen, fonts, "More Information", 370, 391);
    DrawCaption(screen, fonts, "Exit", 398, 443);
    return screen;
}

// The information panel open over the German background, with the Play button installed.
Picture PanelMockup(Art& art, const FontLibrary& fonts) {
    Picture screen = art.Get("AutoPlayBackDe.bmp");
    const Picture& panel = art.Bitmap(227);
    MaskedBlend(panel, 0, 0, screen, 403, 67, art.Bitmap(kOpaqueMaskId), 0, 0, screen, 403, 67,
                panel.width, panel.height);
    DrawFace(art, screen, 11, 0, 9, 346);
    DrawFace(art, screen, 2, 2, 186, 162);
    DrawFace(art, screen, 7, 0, 330, 268);
    DrawFace(art, screen, 6, 0, 272, 225);
    DrawFace(art, screen, 9, 3, 372, 323);
    DrawFace(art, screen, 10, 0, 405, 411);
    DrawCaption(screen, fonts, "Spielen", 187, 237);
    DrawCaption(screen, fonts, "Besuchen Sie www.de.vemo.example", 262, 278);
    DrawCaption(screen, fonts, "Mehr Vemo-Spiele", 329, 332);
    DrawCaption(screen, fonts, "Weitere Informationen", 370, 391);
    DrawCaption(screen, fonts, "Beenden", 398, 443);
    DrawPlate(art, screen, fonts, 358, 416, 28, 0, Face::ComicRegular,
              "Elektronische Registrierung");
    DrawPlate(art, screen, fonts, 348, 416, 81, 2, Face::ComicRegular, "Trivex");
    DrawPlate(art, screen, fonts, 357, 416, 133, 1, Face::ComicRegular, "Liesmich");
    return screen;
}

Picture ListMockup(Art& art, const FontLibrary& fonts) {
    Picture screen = art.Bitmap(kLanguageListId);
    struct Entry {
        Face face;
        const char* label;
    };
    // The twelve-language edition, in creation order (plate key 11 onwards).
    const Entry entries[] = {
        {Face::ComicRegular, "Polski"},
        {Face::ComicRegular,
         "Fran\xC3\xA7"
         "ais"},
        {Face::ComicRegular, "Deutsch"},
        {Face::ComicRegular, "Italiano"},
        {Face::ComicRegular, "Svenska"},
        {Face::ComicRegular, "Nederlands"},
        {Face::ComicRegular, "Espa\xC3\xB1ol"},
        {Face::ComicRegular, "Portugu\xC3\xAAs(BR)"},
        {Face::ComicRegular, "English"},
        {Face::ComicRegular, "Norsk"},
        {Face::ComicRegular, "Suomeksi"},
        {Face::ComicRegular, "Dansk"},
    };
    for (size_t i = 0; i < 12; ++i) {
        const PlateResource& plate = PlateResources()[11 + i];
        const int state = i == 2 ? 2 : 0;
        DrawPlate(art, screen, fonts, state == 1 ? plate.pressedId : plate.normalId, plate.x,
                  plate.y, state, entries[i].face, entries[i].label);
    }
    return screen;
}

// Where each circular face is shown; the unused face 8 is tried at the More Games place.
struct Place {
    int x;
    int y;
};

Place FacePlace(int key) {
    switch (key) {
        case 6:
            return {272, 225};
        case 7:
        case 8:
            return {330, 268};
        case 9:
            return {372, 323};
        case 10:
            return {405, 411};
        case 11:
            return {9, 346};
        default:
            return {186, 162};
    }
}

// The average colour of the background under a face: plain cells keep the sheet small.
Rgb MeanColor(const Picture& background, Place place, const IconResource& icon) {
    double sum[3] = {0.0, 0.0, 0.0};
    for (int y = 0; y < icon.height; ++y) {
        for (int x = 0; x < icon.width; ++x) {
            for (int k = 0; k < 3; ++k) sum[k] += background.Pixel(place.x + x, place.y + y)[k];
        }
    }
    const double n = 255.0 * icon.width * icon.height;
    return {static_cast<float>(sum[0] / n), static_cast<float>(sum[1] / n),
            static_cast<float>(sum[2] / n)};
}

// Every circular face in its four states, each on the colour of the background at its place.
Picture ButtonSheet(Art& art, const FontLibrary& fonts) {
    const int labelWidth = 40;
    const int gap = 12;
    int height = 34;
    for (const IconResource& icon : IconResources()) height += icon.height + gap;
    Picture sheet = Filled(labelWidth + 4 * (162 + gap) + gap, height, Hex(0x2A2F5A));
    const char* states[] = {"normal", "pressed", "hover", "open"};
    for (int s = 0; s < 4; ++s) {
        DrawLabel(sheet, fonts, Face::ComicBold, states[s],
                  static_cast<float>(labelWidth + gap + s * (162 + gap) + 50), 22.0f,
                  Hex(0xF4EEDC));
    }
    const Picture& background = art.Get("AutoPlayBack.bmp");
    int y = 34;
    for (const IconResource& icon : IconResources()) {
        DrawLabel(sheet, fonts, Face::ComicBold, std::to_string(icon.key), 10.0f,
                  static_cast<float>(y + icon.height / 2 + 6), Hex(0xF4EEDC));
        const Place place = FacePlace(icon.key);
        for (int state = 0; state < 4; ++state) {
            if (icon.pictureIds[state] == 0) continue;
            Picture cell = Filled(icon.width, icon.height, MeanColor(background, place, icon));
            DrawFace(art, cell, icon.key, state, 0, 0);
            Paste(sheet, cell, labelWidth + gap + state * (162 + gap) + (162 - icon.width) / 2, y);
        }
        y += icon.height + gap;
    }
    return sheet;
}

// Every plate, normal, pressed and hover, with a label of the kind it carries.
Picture PlateSheet(Art& art, const FontLibrary& fonts) {
    const char* labels[] = {
        "The Vemo 2 PC",
        "The Vemo 2 Duskaro",
        "The Vemo 2 Lorrel",
        "",
        "Electronic Registration",
        "Trivex",
        "Readme",
        "",
        "The Vemo 1024x768",
        "The Vemo 800x600",
        "The Vemo Creator",
        "Polski",
        "Fran\xC3\xA7"
        "ais",
        "Deutsch",
        "Italiano",
        "Svenska",
        "Nederlands",
        "Espa\xC3\xB1ol",
        "Portugu\xC3\xAAs(BR)",
        "English",
        "Norsk",
        "Suomeksi",
        "Dansk",
    };
    const int gap = 6;
    const int columnWidth = 212 + gap;
    Picture sheet = Filled(3 * columnWidth + gap, 23 * (50 + gap) + gap, Hex(0x2A2F5A));
    for (const PlateResource& plate : PlateResources()) {
        const int y = gap + plate.key * (50 + gap);
        const int ids[] = {plate.normalId, plate.pressedId, plate.normalId};
        for (int state = 0; state < 3; ++state) {
            const Picture& picture = art.Bitmap(ids[state]);
            Picture cell = picture;
            DrawPlate(art, cell, fonts, ids[state], 0, 0, state, Face::ComicRegular,
                      labels[plate.key]);
            Paste(sheet, cell, gap + state * columnWidth, y);
        }
    }
    return sheet;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 3) {
        std::fprintf(stderr, "usage: discart_preview <generated-dir> <outdir>\n");
        return 2;
    }
    FontLibrary fonts;
    std::string error;
    if (!fonts.Load(error)) {
        std::fprintf(stderr, "discart_preview: %s\n", error.c_str());
        return 1;
    }
    Art art(argv[1]);
    const std::string out = argv[2];
    const std::pair<std::string, Picture> previews[] = {
        {"mockup-main.bmp", MainMockup(art, fonts)}, {"mockup-panel.bmp", PanelMockup(art, fonts)},
        {"mockup-list.bmp", ListMockup(art, fonts)}, {"buttons.bmp", ButtonSheet(art, fonts)},
        {"plates.bmp", PlateSheet(art, fonts)},
    };
    if (art.failed) return 1;
    for (const auto& preview : previews) {
        if (!WriteFile(out + "/" + preview.first, EncodeBmp(preview.second))) {
            std::fprintf(stderr, "discart_preview: cannot write %s\n", preview.first.c_str());
            return 1;
        }
    }
    return 0;
}
