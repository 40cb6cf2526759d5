#pragma once

#include "ConversionMeasures.h"

namespace gw {

/// Returns the scale of the source in drawings: the ratio of the leg lengths, or 1 if a side has no legs.
inline double SourceScale(const ConversionMeasures& sums)
{
    return sums.sourceLeg > 0.0 && sums.resultLeg > 0.0 ? sums.resultLeg / sums.sourceLeg : 1.0;
}

} // namespace gw
