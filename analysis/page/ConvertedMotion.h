#pragma once

#include "MeasureConversion.h"
#include "MeasuredConversion.h"

#include <string>

namespace gw {

/// A conversion to be shown on a page. Referenced objects must outlive it.
struct ConvertedMotion
{
    std::string source; ///< paths, as given by the user
    std::string result;
    std::string profile; ///< display name or path
    MotionClip sourceClip;
    MotionClip resultClip;
    const MeasuredConversion* measured = nullptr;
    /// the same motion converted by default; null if this one was
    const MeasuredConversion* plain = nullptr;
    std::string model = {}; ///< link to a .glb file with the result, relative to the page; may be empty
    std::string advice;     ///< a sentence about options that give a better result; may be empty
};

} // namespace gw
