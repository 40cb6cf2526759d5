#pragma once

#include "ConversionMeasures.h"

#include <array>
#include <cstddef>

namespace gw {

class CBodyTrack;

/// A source's body in the result's size, and the result's. Both tracks have the same frames; lengths are mm.
struct HandSides
{
    const CBodyTrack& source;
    const CBodyTrack& result;
    double sourceFloor; ///< y, scaled like the source
    double secondsPerFrame;
};

/// All figures of a hand but its names. `side` is that of CBodyTrack::Hand; both bodies have this hand.
HandMeasures MeasureHand(const HandSides& sides, size_t side);

} // namespace gw
