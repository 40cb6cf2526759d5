#pragma once

#include "Quat.h"
#include "Vec3.h"

#include <cstddef>
#include <span>
#include <vector>

namespace gw {

/// Frames in which a joint has jumped out of its motion; the frame behind them is back in it.
struct Spike
{
    size_t first; ///< frame
    size_t count; ///< 1 or 2
};

/// The least turn of a spike: twice what a fast limb turns in a frame of a usual rate.
inline constexpr double kLeastSpikeDegrees = 30.0;

/// Spikes of a joint's rotations: at least kLeastSpikeDegrees out and back, and far beyond the motion around.
std::vector<Spike> FindSpikes(std::span<const Quat> rotations);
/// Spikes of a joint's positions that go at least `least` out, in their unit.
std::vector<Spike> FindSpikes(std::span<const Vec3> positions, double least);

} // namespace gw
