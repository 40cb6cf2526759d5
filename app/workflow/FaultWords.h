#pragma once

#include "WorstFrames.h"

#include <string>

namespace gw {

/// How many of the worst frames a check names.
inline constexpr size_t kWorstFrames = 3;

/// What a fault is called.
struct FaultWords
{
    const char* name; ///< identifier for programs
    const char* text;
    const char* unit; ///< of the amount
};

const FaultWords& WordsOf(EFrameFault fault);
/// Returns "frame 12: trunk error 14.0 deg (Neck)".
std::string WorstFrameText(const WorstFrame& worst);

} // namespace gw
