#include "text.h"

#include <ft2build.h>
#include FT_FREETYPE_H

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <map>

namespace discart {

namespace {

struct FaceFile {
    Face face;
    const char* path;
    const char* family;  // required family inside a collection, or null
    const char* package;
};

// Debian package paths; the CJK collection holds one face per region.
const FaceFile kFaceFiles[] = {
    {Face::ComicBold, "/usr/share/fonts/opentype/comic-neue/ComicNeue-Bold.otf", nullptr,
     "fonts-comic-neue"},
    {Face::ComicRegular, "/usr/share/fonts/opentype/comic-neue/ComicNeue-Regular.otf", nullptr,
     "fonts-comic-neue"},
    {Face::SansBold, "/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf", nullptr,
     "fonts-dejavu-core"},
    {Face::Sans, "/usr/share/fonts/truetype/dejavu/DejaVuSans.ttf", nullptr, "fonts-dejavu-core"},
    {Face::Japanese, "/usr/share/fonts/opentype/noto/NotoSansCJK-Bold.ttc", "Noto Sans CJK JP",
     "fonts-noto-cjk"},
    {Face::Korean, "/usr/share/fonts/opentype/noto/NotoSansCJK-Bold.ttc", "Noto Sans CJK KR",
     "fonts-noto-cjk"},
    {Face::SimplifiedChinese, "/usr/share/fonts/opentype/noto/NotoSansCJK-Bold.ttc",
     "Noto Sans CJK SC", "fonts-noto-cjk"},
    {Face::TraditionalChinese, "/usr/share/fonts/opentype/noto/NotoSansCJK-Bold.ttc",
     "Noto Sans CJK TC", "fonts-noto-cjk"},
    {Face::Thai, "/usr/share/fonts/truetype/tlwg/Loma-Bold.ttf", nullptr, "fonts-tlwg-loma"},
};

std::vector<char32_t> DecodeUtf8(const std::string& text) {
    std::vector<char32_t> out;
    for (size_t i = 0; i < text.size();) {
        const unsigned char c = static_cast<unsigned char>(text[i]);
        int length = 1;
        char32_t cp = c;
        if (c >= 0xF0) {
            length = 4;
            cp = c & 0x07;
        } else if (c >= 0xE0) {
            length = 3;
            cp = c & 0x0F;
        } else if (c >= 0xC0) {
            length = 2;
            cp = c & 0x1F;
        }
        for (int k = 1; k < length && i + k < text.size(); ++k) {
            cp = (cp << 6) | (static_cast<unsigned char>(text[i + k]) & 0x3F);
        }
        out.push_back(cp);
        i += length;
    }
    return out;
}

bool IsThaiAboveVowel(char32_t c) {
    return c == 0x0E31 || (c >= 0x0E34 && c <= 0x0E37) || c == 0x0E47 || c == 0x0E4D;
}

bool IsThaiToneMark(char32_t c) {
    return c >= 0x0E48 && c <= 0x0E4C;
}

struct PlacedGlyph {
    int left = 0;
    int top = 0;
    int width = 0;
    int rows = 0;
    std::vector<unsigned char> pixels;
};

}  // namespace

struct FontLibrary::State {
    FT_Library library = nullptr;
    std::map<Face, FT_Face> faces;

    FT_Face Get(Face face) const {
        auto it = faces.find(face);
        return it == faces.end() ? nullptr : it->second;
    }
};

FontLibrary::FontLibrary() : state(std::make_unique<State>()) {
    FT_Init_FreeType(&state->library);
}

FontLibrary::~FontLibrary() {
    for (auto& entry : state->faces) FT_Done_Face(entry.second);
    if (state->library) FT_Done_FreeType(state->library);
}

bool FontLibrary::Load(std::string& error) {
    if (!state->library) {
        error = "FreeType could not be initialised";
        return false;
    }
    for (const FaceFile& file : kFaceFiles) {
        std::FILE* probe = std::fopen(file.path, "rb");
        if (!probe) {
            error = std::string("missing font file ") + file.path + " (Debian package " +
                    file.package + ")";
            return false;
        }
        std::fclose(probe);
        FT_Face face = nullptr;
        if (!file.family) {
            if (FT_New_Face(state->library, file.path, 0, &face) != 0) {
                error = std::string("unreadable font file ") + file.path;
                return false;
            }
        } else {
            // Face indexes inside the collection differ between releases; the family name does not.
            FT_Face first = nullptr;
            if (FT_New_Face(state->library, file.path, 0, &first) != 0) {
                error = std::string("unreadable font file ") + file.path;
                return false;
            }
            const FT_Long count = first->num_faces;
            FT_Done_Face(first);
            for (FT_Long index = 0; index < count && !face; ++index) {
                FT_Face candidate = nullptr;
                if (FT_New_Face(state->library, file.path, index, &candidate) != 0) continue;
                if (candidate->family_name && std::string(candidate->family_name) == file.family) {
                    face = candidate;
                } else {
                    FT_Done_Face(candidate);
                }
            }
            if (!face) {
                error =
                    std::string("font file ") + file.path + " has no face \"" + file.family + "\"";
                return false;
            }
        }
        state->faces[file.face] = face;
    }
    return true;
}

TextMask FontLibrary::Render(const std::vector<TextSpan>& spans, float pixelSize, float tracking,
                             int padding) const {
    std::vector<PlacedGlyph> glyphs;
    float pen = 0.0f;
    int minLeft = 0;
    int maxRight = 0;
    int maxTop = 0;
    int maxBottom = 0;
    bool any = false;
    const FT_F26Dot6 charSize = static_cast<FT_F26Dot6>(std::lround(pixelSize * 64.0f));
    for (const TextSpan& span : spans) {
        const std::vector<char32_t> codes = DecodeUtf8(span.text);
        FT_Face primary = state->Get(span.face);
        FT_UInt previousIndex = 0;
        FT_Face previousFace = nullptr;
        for (size_t i = 0; i < codes.size(); ++i) {
            const char32_t code = codes[i];
            FT_Face face = primary;
            FT_UInt index = face ? FT_Get_Char_Index(face, code) : 0;
            if (index == 0) {
                for (Face fallback : {Face::SansBold, Face::Sans}) {
                    face = state->Get(fallback);
                    index = face ? FT_Get_Char_Index(face, code) : 0;
                    if (index != 0) break;
                }
            }
            if (index == 0 || !face) continue;
            if (span.face == Face::Thai && IsThaiToneMark(code) &&
                (i == 0 || !IsThaiAboveVowel(codes[i - 1]))) {
                // Without an upper vowel the tone mark sits lower; the font carries that form.
                char name[32];
                std::snprintf(name, sizeof name, "uni%04X.low", static_cast<unsigned>(code));
                const FT_UInt low = FT_Get_Name_Index(face, name);
                if (low != 0) index = low;
            }
            FT_Set_Char_Size(face, 0, charSize, 72, 72);
            if (previousFace == face && previousIndex != 0 && FT_HAS_KERNING(face)) {
                FT_Vector kern;
                if (FT_Get_Kerning(face, previousIndex, index, FT_KERNING_UNFITTED, &kern) == 0) {
                    pen += static_cast<float>(kern.x) / 64.0f;
                }
            }
            const float whole = std::floor(pen);
            FT_Vector delta{static_cast<FT_Pos>(std::lround((pen - whole) * 64.0f)), 0};
            FT_Set_Transform(face, nullptr, &delta);
            if (FT_Load_Glyph(face, index, FT_LOAD_NO_HINTING | FT_LOAD_NO_BITMAP) != 0 ||
                FT_Render_Glyph(face->glyph, FT_RENDER_MODE_NORMAL) != 0) {
                FT_Set_Transform(face, nullptr, nullptr);
                continue;
            }
            FT_Set_Transform(face, nullptr, nullptr);
            const FT_GlyphSlot slot = face->glyph;
            PlacedGlyph glyph;
            glyph.left = static_cast<int>(whole) + slot->bitmap_left;
            glyph.top = slot->bitmap_top;
            glyph.width = static_cast<int>(slot->bitmap.width);
            glyph.rows = static_cast<int>(slot->bitmap.rows);
            glyph.pixels.resize(static_cast<size_t>(glyph.width) * glyph.rows);
            for (int row = 0; row < glyph.rows; ++row) {
                const unsigned char* source = slot->bitmap.buffer + row * slot->bitmap.pitch;
                std::copy(source, source + glyph.width,
                          glyph.pixels.begin() + static_cast<long>(row) * glyph.width);
            }
            if (glyph.width > 0 && glyph.rows > 0) {
                if (!any) {
                    minLeft = glyph.left;
                    maxRight = glyph.left + glyph.width;
                    maxTop = glyph.top;
                    maxBottom = glyph.rows - glyph.top;
                    any = true;
                } else {
                    minLeft = std::min(minLeft, glyph.left);
                    maxRight = std::max(maxRight, glyph.left + glyph.width);
                    maxTop = std::max(maxTop, glyph.top);
                    maxBottom = std::max(maxBottom, glyph.rows - glyph.top);
                }
                glyphs.push_back(std::move(glyph));
            }
            pen += static_cast<float>(slot->advance.x) / 64.0f + tracking;
            previousIndex = index;
            previousFace = face;
        }
    }
    TextMask result;
    const int inkLeft = minLeft;
    minLeft = std::min(minLeft, 0);
    const int width = maxRight - minLeft + 2 * padding;
    const int height = maxTop + maxBottom + 2 * padding;
    result.coverage = Mask(std::max(1, width), std::max(1, height));
    result.originX = padding - minLeft;
    result.baseline = padding + maxTop;
    result.advance = pen - tracking;
    result.ink = {result.originX + inkLeft, padding, result.originX + maxRight,
                  padding + maxTop + maxBottom};
    for (const PlacedGlyph& glyph : glyphs) {
        const int ox = result.originX + glyph.left;
        const int oy = result.baseline - glyph.top;
        for (int row = 0; row < glyph.rows; ++row) {
            for (int column = 0; column < glyph.width; ++column) {
                const float v = static_cast<float>(
                                    glyph.pixels[static_cast<size_t>(row) * glyph.width + column]) /
                                255.0f;
                float& dst = result.coverage.At(ox + column, oy + row);
                dst = 1.0f - (1.0f - dst) * (1.0f - v);
            }
        }
    }
    return result;
}

TextMask FontLibrary::Render(Face face, const std::string& text, float pixelSize, float tracking,
                             int padding) const {
    return Render(std::vector<TextSpan>{{face, text}}, pixelSize, tracking, padding);
}

float FontLibrary::Measure(const std::vector<TextSpan>& spans, float pixelSize,
                           float tracking) const {
    return InkWidth(Render(spans, pixelSize, tracking, 0));
}

float FontLibrary::FitSize(const std::vector<TextSpan>& spans, float pixelSize, float maxWidth,
                           float tracking) const {
    float size = pixelSize;
    for (int attempt = 0; attempt < 8; ++attempt) {
        const float width = Measure(spans, size, tracking);
        if (width <= maxWidth) break;
        size *= std::max(0.5f, maxWidth / width * 0.995f);
    }
    return size;
}

float InkWidth(const TextMask& text) {
    return static_cast<float>(text.ink.x1 - text.ink.x0);
}

float CentredPenX(const TextMask& text, float centreX) {
    const float inkCentre =
        static_cast<float>(text.ink.x0 + text.ink.x1) * 0.5f - static_cast<float>(text.originX);
    return centreX - inkCentre;
}

void DrawText(Canvas& canvas, const TextMask& text, float x, float baseline,
              const TextStyle& style) {
    const int ox = static_cast<int>(std::lround(x)) - text.originX;
    const int oy = static_cast<int>(std::lround(baseline)) - text.baseline;
    const Mask& cover = text.coverage;
    Mask outline = style.outlineWidth > 0.0f ? Dilate(cover, style.outlineWidth) : cover;
    if (style.glowAlpha > 0.0f) {
        Mask glow = Dilate(cover, style.outlineWidth + style.glowRadius * 0.4f);
        Blur(glow, style.glowRadius);
        PaintMask(canvas, glow, ox, oy, style.glow, style.glowAlpha);
    }
    if (style.shadowAlpha > 0.0f) {
        Mask shadow = outline;
        Blur(shadow, style.shadowBlur);
        PaintMask(canvas, shadow, ox + static_cast<int>(std::lround(style.shadowOffset.x)),
                  oy + static_cast<int>(std::lround(style.shadowOffset.y)), style.shadow,
                  style.shadowAlpha);
    }
    if (style.outlineWidth > 0.0f) PaintMask(canvas, outline, ox, oy, style.outline);
    const float top = static_cast<float>(oy + text.ink.y0);
    const float bottom = static_cast<float>(oy + text.ink.y1);
    PaintMask(canvas, cover, ox, oy,
              VerticalGradient(top, style.fillTop, bottom, style.fillBottom));
    if (style.sheen > 0.0f) {
        const float middle = top + (bottom - top) * 0.45f;
        PaintMask(canvas, cover, ox, oy, [=](float, float y) {
            return Tint{Rgb{1.0f, 1.0f, 1.0f},
                        style.sheen * Clamp01((middle - y) / std::max(1.0f, middle - top))};
        });
    }
}

}  // namespace discart
