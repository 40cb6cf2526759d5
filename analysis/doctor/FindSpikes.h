#pragma once

#include "Quat.h"
#include "Vec3.h"

#include <cstddef>
#include <span>
#include <vector>

namespace gw {

/// Frames in which a joint has jumped out of its motion; it is back in the frame after them.
struct Spike
{
    size_t first; ///< first frame
    size_t count; ///< number of frames, 1 or 2
};

/// The minimum rotation of a spike: twice what a fast limb rotates per frame at usual rates.
inline constexpr double kLeastSpikeDegrees = 30.0;

/// Returns spikes in a joint's rotations: at least kLeastSpikeDegrees out and back, and far beyond the
/// surrounding motion.
std::vector<Spike> FindSpikes(std::span<const Quat> rotations);
/// Returns spikes in a joint's positions of at least `least`, in their unit.
std::vector<Spike> FindSpikes(std::span<const Vec3> positions, double least);

} // namespace gw
