#pragma once

#include <memory>
#include <string>
#include <vector>

#include "canvas.h"
#include "geometry.h"

namespace discart {

enum class Face {
    ComicBold,
    ComicRegular,
    SansBold,
    Sans,
    Japanese,
    Korean,
    SimplifiedChinese,
    TraditionalChinese,
    Thai,
};

struct TextSpan {
    Face face;
    std::string text;  // UTF-8
};

// Coverage of a line of text. The pen starts at (originX, baseline) inside the mask.
struct TextMask {
    Mask coverage;
    int originX = 0;
    int baseline = 0;
    float advance = 0.0f;
    Box ink;  // rows and columns that hold any coverage
};

struct TextStyle {
    Rgb fillTop{1.0f, 1.0f, 1.0f};
    Rgb fillBottom{1.0f, 1.0f, 1.0f};
    Rgb outline;
    float outlineWidth = 0.0f;
    Rgb shadow;
    float shadowAlpha = 0.0f;
    float shadowBlur = 2.0f;
    Vec2 shadowOffset{1.0f, 2.0f};
    Rgb glow;
    float glowAlpha = 0.0f;
    float glowRadius = 6.0f;
    float sheen = 0.0f;  // white on the upper part of the letters
};

class FontLibrary {
  public:
    FontLibrary();
    ~FontLibrary();
    FontLibrary(const FontLibrary&) = delete;
    FontLibrary& operator=(const FontLibrary&) = delete;

    // Opens every face; on failure error names the missing or unreadable file.
    bool Load(std::string& error);

    TextMask Render(const std::vector<TextSpan>& spans, float pixelSize, float tracking = 0.0f,
                    int padding = 16) const;
    TextMask Render(Face face, const std::string& text, float pixelSize, float tracking = 0.0f,
                    int padding = 16) const;
    float Measure(const std::vector<TextSpan>& spans, float pixelSize, float tracking = 0.0f) const;
    // The largest size up to pixelSize at which the text fits into maxWidth.
    float FitSize(const std::vector<TextSpan>& spans, float pixelSize, float maxWidth,
                  float tracking = 0.0f) const;

  private:
    struct State;
    std::unique_ptr<State> state;
};

// Draws a text mask with its pen origin at (x, baseline).
void DrawText(Canvas& canvas, const TextMask& text, float x, float baseline,
              const TextStyle& style);

// Width of the inked part, and the pen x that centres the ink on centreX.
float InkWidth(const TextMask& text);
float CentredPenX(const TextMask& text, float centreX);

}  // namespace discart
