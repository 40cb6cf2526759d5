#pragma once

#include "ConversionMeasures.h"
#include "FindContacts.h"

#include <vector>

namespace gw {

class CLegTrack;

/// One foot of one side, with all its frames.
struct FootSide
{
    const CLegTrack& track;
    const std::vector<Contact>& contacts;
    double leg; ///< length, in the unit of the track
};

/// All figures of a foot but its names. Both tracks have the same frames.
FootMeasures MeasureFoot(const FootSide& source, const FootSide& result);

} // namespace gw
