#pragma once

#include "CFigurePoser.h"

namespace gw {

class CMarkup;

/// The same moment of both sides.
struct FigurePair
{
    PosedFigure source;
    PosedFigure result;
    Vec3 across; ///< unit, over the ground: towards the body's left
};

/// Brings a figure to where pictures of both sides can stand beside each other: over the origin, above the
/// floor, in the size of the result.
void PlaceFigure(PosedFigure& figure, double floor, double scale);

/// Appends four drawings: source and result from the front, source and result from the figure's right side;
/// all in one scale, with the floor. Nothing is appended where the figures have no extent.
void AppendFigures(CMarkup& page, const FigurePair& pair);

} // namespace gw
