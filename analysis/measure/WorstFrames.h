#pragma once

#include "ConversionDetail.h"
#include "ConversionMeasures.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace gw {

/// What is wrong in a frame.
enum class EFrameFault : uint8_t
{
    Direction,  ///< the main bones point in other directions than the source's
    Trunk,      ///< the line from hips to neck leans differently from the source's
    KneePop,    ///< a knee's angle jumps by more than the source's
    AnkleSlide, ///< a planted ankle has moved farther than the source's
    ToeSlide,   ///< same for a toe
    HeldSole,   ///< a sole is off the floor while the source's foot stands
    HandGap,    ///< a hand is farther from what the source's hand touches, or nearer to it
    HandDepth,  ///< a hand is below the floor
};

/// A frame that the user should check.
struct WorstFrame
{
    EFrameFault fault = EFrameFault::Direction;
    int frame = 0; ///< of the source, starting at 0
    double amount =
        0.0; ///< degrees (mean over the main bones, trunk, or excess of a pop over the source) or mm
    std::string target; ///< bone of the result: the one farthest off, the neck, the leg's ankle or the hand
    std::string source; ///< bone that drives it
    double most = 0.0;  ///< for a direction: that bone's error in degrees
    std::string part;   ///< for a hand gap: what is touched
};

/// Returns the worst frame of each fault, ordered by how far it exceeds the visible limit, worst first.
/// Faults below that limit are left out. If there are fewer than `count`, the frames with the next largest
/// direction errors follow, each at least half a second from all others.
std::vector<WorstFrame> FindWorstFrames(const ConversionMeasures& measures, const ConversionDetail& detail,
                                        size_t count);

} // namespace gw
