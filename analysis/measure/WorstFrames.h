#pragma once

#include "ConversionDetail.h"
#include "ConversionMeasures.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace gw {

/// What is bad in a frame.
enum class EFrameFault : uint8_t
{
    Direction, ///< the main bones point elsewhere than the source's
    KneePop,   ///< a knee's angle jumps by more than the source's does
    Slide,     ///< a foot that stands has gone farther than the source's
};

/// A slide below this is none to be named, mm.
inline constexpr double kNamedSlide = 5.0;

/// A frame that a user should look at.
struct WorstFrame
{
    EFrameFault fault = EFrameFault::Direction;
    int frame = 0;       ///< of the source, from 0 on
    double amount = 0.0; ///< degrees: the mean over the main bones, or what a pop exceeds the source by; mm
    std::string target;  ///< the bone of the result that is farthest off, or the ankle of the leg
    std::string source;  ///< what drives it
    double most = 0.0;   ///< of a direction: by how many degrees that bone is off
};

/// The worst frame of each fault that there is: largest mean direction error, largest knee pop over the
/// limit, largest added slide from kNamedSlide on. Where these are fewer than `count`, the frames of the next
/// largest direction errors follow, each half a second and more from the others.
std::vector<WorstFrame> FindWorstFrames(const ConversionMeasures& measures, const ConversionDetail& detail,
                                        size_t count);

} // namespace gw
