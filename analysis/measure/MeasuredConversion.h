#pragma once

#include "ConversionDetail.h"
#include "ConversionMeasures.h"

namespace gw {

/// All measures of a conversion.
struct MeasuredConversion
{
    ConversionMeasures sums;
    ConversionDetail detail;
};

} // namespace gw
