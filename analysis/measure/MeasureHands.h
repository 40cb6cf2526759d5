#pragma once

#include "ConversionMeasures.h"

#include <array>
#include <cstddef>

namespace gw {

class CBodyTrack;

/// The source's body in the result's size, and the result's body. Both tracks have the same number of frames;
/// lengths are in mm.
struct HandSides
{
    const CBodyTrack& source;
    const CBodyTrack& result;
    double sourceFloor; ///< y, scaled like the source
    double secondsPerFrame;
};

/// Returns all figures of a hand except its names. `side` is an index as for CBodyTrack::Hand; both bodies
/// must have this hand.
HandMeasures MeasureHand(const HandSides& sides, size_t side);

} // namespace gw
