#pragma once

#include "ConversionDetail.h"
#include "ConversionMeasures.h"
#include "MeasureConversion.h"

#include <string>

namespace gw {

/// All that was measured of a conversion.
struct MeasuredConversion
{
    ConversionMeasures sums;
    ConversionDetail detail;
};

/// A conversion as a page tells of it. What is pointed to must live while the page takes it.
struct ConvertedMotion
{
    std::string source; ///< paths, as the user knows them
    std::string result;
    std::string profile; ///< display name, or a path
    MotionClip sourceClip;
    MotionClip resultClip;
    const MeasuredConversion* measured = nullptr;
    const MeasuredConversion* plain = nullptr; ///< the same motion by the plain rules; null where it is that
};

} // namespace gw
