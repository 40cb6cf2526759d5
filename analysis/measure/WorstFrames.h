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
    Direction,  ///< the main bones point elsewhere than the source's
    Trunk,      ///< the line from hips to neck leans otherwise than the source's
    KneePop,    ///< a knee's angle jumps by more than the source's does
    AnkleSlide, ///< an ankle that is planted has gone farther than the source's
    ToeSlide,   ///< the same of a toe
    HeldSole,   ///< a sole is off the floor while the source's foot stands
    HandGap,    ///< a hand is farther from what the source's touches, or nearer to it
    HandDepth,  ///< a hand is below the floor
};

/// A frame that a user should look at.
struct WorstFrame
{
    EFrameFault fault = EFrameFault::Direction;
    int frame = 0; ///< of the source, from 0 on
    double amount =
        0.0; ///< degrees: the mean over the main bones, the trunk's, or what a pop exceeds the source by; mm
    std::string
        target; ///< the bone of the result: the one farthest off, the neck, the leg's ankle or the hand
    std::string source; ///< what drives it
    double most = 0.0;  ///< of a direction: by how many degrees that bone is off
    std::string part;   ///< of a hand's gap: what is touched
};

/// The worst frame of each fault, the worst fault first: by how often it exceeds what the eye lets pass.
/// Faults that stay below that are not named. Where these are fewer than `count`, the frames of the next
/// largest direction errors follow, each half a second and more from the others.
std::vector<WorstFrame> FindWorstFrames(const ConversionMeasures& measures, const ConversionDetail& detail,
                                        size_t count);

} // namespace gw
