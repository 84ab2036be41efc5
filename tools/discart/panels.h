#pragma once

#include "canvas.h"
#include "formats.h"

namespace discart {

enum class PanelMotif { Play, Information, Games };

// The mask the launcher composites panels and plates through: 251 and 252 in a fine checker.
Picture PaintOpaqueMask();

// A framed pane of dark glass with a gold rim, its shadow falling on what is already there.
void PaintGlassFrame(Canvas& canvas, Box frame, float radius, float opacity);

// A fold-out panel: the piece of the background under its place with the panel drawn over it,
// so that its edges melt into the background around it.
Picture PaintPanel(const Picture& under, PanelMotif motif);

// A plate button over the picture that lies under its place; its label is drawn by the program.
Picture PaintPlate(const Picture& under, bool pressed);

}  // namespace discart
