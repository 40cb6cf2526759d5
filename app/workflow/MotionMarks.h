#pragma once

#include "FindContacts.h"
#include "WorstFrames.h"

#include <string>
#include <vector>

namespace gw {

/// Where one foot is planted.
struct FootMarks
{
    std::string target; ///< ankle of the result
    std::vector<Contact> source;
    std::vector<Contact> result;
};

/// What is worth looking at in a converted motion. Frames are those of the source, starting at 0.
struct MotionMarks
{
    int frameCount = 0; ///< 0 if nothing has been measured
    std::vector<FootMarks> feet;
    std::vector<WorstFrame> worst; ///< the ones that a check of the result names, worst first
};

} // namespace gw
