#include "about.h"

#include "emblem.h"
#include "panels.h"
#include "scene.h"

namespace discart {

namespace {

struct Credit {
    const char* role;
    const char* names;
};

// The team is invented for this disc.
const Credit kCredits[] = {
    {"Design & Direction", "Mira Osterholt"},
    {"Programming", "Jonah Trevane, Pim Valdris"},
    {"Art & Animation", "Selka Ardis, Noor Halvesen"},
    {"Music & Sound", "Ilka Brennamor"},
    {"Localisation", "Dario Fenwick & team"},
    {"Quality Assurance", "Tove Lindqvard"},
};

TextStyle Outlined(Rgb top, Rgb bottom, float outline) {
    TextStyle style;
    style.fillTop = top;
    style.fillBottom = bottom;
    style.outline = Hex(0x161C52);
    style.outlineWidth = outline;
    style.shadow = Hex(0x0A0C30);
    style.shadowAlpha = 0.45f;
    style.shadowBlur = 2.0f;
    style.shadowOffset = {1.0f, 2.0f};
    return style;
}

}  // namespace

Canvas PaintAboutPicture(const FontLibrary& fonts) {
    Canvas canvas(400, 488, Rgb{});
    SkyLight light;
    light.sun = {200.0f, 150.0f};
    light.horizon = 300.0f;
    PaintSky(canvas, light);
    PaintStars(canvas, {0, 0, 400, 150}, 70, 41);
    PaintCirrus(canvas, light, {0, 110, 400, 230}, 7);
    PaintCloudSea(canvas, light, 0, 6, 59);

    PaintMedallion(canvas, {200.0f, 88.0f}, 70.0f);
    PaintBanner(canvas, fonts, {200.0f, 150.0f}, 92.0f, 16.0f, 25.0f);

    const TextMask title = fonts.Render(
        Face::ComicBold, "The Vemo Vodizuri Virezazida",
        fonts.FitSize({{Face::ComicBold, "The Vemo Vodizuri Virezazida"}}, 27.0f, 360.0f, 0.4f),
        0.4f, 16);
    DrawText(canvas, title, CentredPenX(title, 200.0f), 208.0f,
             Outlined(Hex(0xFFF6A8), Hex(0xF8A030), 2.6f));
    const TextMask product = fonts.Render(Face::ComicBold, "AutoPlay", 23.0f, 0.8f, 16);
    DrawText(canvas, product, CentredPenX(product, 200.0f), 236.0f,
             Outlined(Hex(0xFFFFFF), Hex(0xCCE4FF), 2.2f));
    TextStyle quiet;
    quiet.fillTop = Hex(0x242E74);
    quiet.fillBottom = Hex(0x1A2260);
    quiet.glow = Hex(0xFFFFFF);
    quiet.glowAlpha = 0.6f;
    quiet.glowRadius = 4.0f;
    const TextMask version = fonts.Render(Face::ComicBold, "Version 1.0", 14.0f, 0.3f, 10);
    DrawText(canvas, version, CentredPenX(version, 200.0f), 258.0f, quiet);

    const Box frame = {22, 272, 378, 474};
    PaintGlassFrame(canvas, frame, 14.0f, 0.92f);
    TextStyle heading = Outlined(Hex(0xFFF0B0), Hex(0xF0B850), 0.0f);
    heading.shadowAlpha = 0.6f;
    heading.shadowOffset = {1.0f, 1.0f};
    heading.shadowBlur = 1.0f;
    const TextMask credits = fonts.Render(Face::ComicBold, "Credits", 17.0f, 0.6f, 10);
    DrawText(canvas, credits, CentredPenX(credits, 200.0f), 300.0f, heading);

    TextStyle role = heading;
    TextStyle name = heading;
    name.fillTop = Hex(0xF4F8FF);
    name.fillBottom = Hex(0xCCD8EA);
    float baseline = 326.0f;
    for (const Credit& credit : kCredits) {
        const TextMask roleText = fonts.Render(Face::ComicBold, credit.role, 13.0f, 0.2f, 8);
        const TextMask nameText = fonts.Render(Face::ComicBold, credit.names, 13.5f, 0.2f, 8);
        DrawText(canvas, roleText, 186.0f - static_cast<float>(roleText.ink.x1 - roleText.originX),
                 baseline, role);
        DrawText(canvas, nameText, 198.0f, baseline, name);
        baseline += 20.0f;
    }
    const TextMask copyright =
        fonts.Render(Face::ComicBold, "\xC2\xA9 2026 Orvak. All rights reserved.", 13.0f, 0.2f, 8);
    DrawText(canvas, copyright, CentredPenX(copyright, 200.0f), 462.0f, name);
    return canvas;
}

}  // namespace discart
