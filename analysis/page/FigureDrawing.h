#pragma once

#include "CFigurePoser.h"

namespace gw {

class CMarkup;

/// The poses of both sides at the same instant.
struct FigurePair
{
    PosedFigure source;
    PosedFigure result;
    Vec3 across; ///< horizontal unit vector toward the body's left
};

/// Moves a figure so that drawings of both sides can be compared: above the origin, on the floor, and scaled
/// to the result.
void PlaceFigure(PosedFigure& figure, double floor, double scale);

/// Appends four drawings: source and result from the front, then both from the figure's right side, all with
/// the same scale and the floor. Appends nothing if the figures have no extent.
void AppendFigures(CMarkup& page, const FigurePair& pair);

} // namespace gw
