#pragma once

#include "CFigurePoser.h"

namespace gw {

class CMarkup;

/// The same moment on both sides.
struct FigurePair
{
    PosedFigure source;
    PosedFigure result;
    Vec3 across; ///< horizontal unit vector toward the body's left
};

/// Moves a figure so that drawings of both sides are comparable: above the origin, on the floor, scaled to
/// the result.
void PlaceFigure(PosedFigure& figure, double floor, double scale);

/// Appends four drawings: source and result from the front, then both from the figure's right side, all with
/// one scale and the floor. Nothing if the figures have no extent.
void AppendFigures(CMarkup& page, const FigurePair& pair);

} // namespace gw
