#pragma once

#include <functional>

#include "canvas.h"
#include "geometry.h"

namespace discart {

// Distance and colour functions in symbol units: the symbol's disc has radius 1 around (0, 0).
using UnitSdf = std::function<float(Vec2 p)>;
using UnitShader = std::function<Tint(Vec2 p)>;

// Draws symbol shapes given in units onto a canvas.
class SymbolPen {
  public:
    SymbolPen(Canvas& canvas, Vec2 centre, float scale);

    void Fill(const UnitSdf& sdf, const UnitShader& shader, float alpha = 1.0f);
    void Fill(const UnitSdf& sdf, Rgb color, float alpha = 1.0f);

  private:
    Canvas& canvas;
    Vec2 centre;
    float scale;
};

using Symbol = void (*)(SymbolPen& pen);

// The face colour of every symbol: warm white, a little deeper at the bottom.
UnitShader SymbolFace();

void InstallSymbol(SymbolPen& pen);
void PlaySymbol(SymbolPen& pen);
void PlaySymbolRaised(SymbolPen& pen);
void GlobeSymbol(SymbolPen& pen);
void GamepadSymbol(SymbolPen& pen);
void StarSymbol(SymbolPen& pen);
void BookSymbol(SymbolPen& pen);
void PowerSymbol(SymbolPen& pen);

}  // namespace discart
