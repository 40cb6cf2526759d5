#pragma once

#include "Vec3.h"

#include <optional>

namespace gw {

struct BodyPaths;

/// How fast somebody walks or runs, in frames, independent of the declared rate.
struct Gait
{
    double framesPerStep;
    double stepLength; ///< in leg lengths

    /// Returns the frames per second at which this would be a normal gait.
    double UsualRate() const;
};

/// Returns the gait of a motion if it clearly is one: steps as regular as walking or running, one foot
/// standing while the other passes, a hip that moves on step by step. `leg` is in the unit of the paths.
std::optional<Gait> FindGait(const BodyPaths& paths, const Vec3& up, double leg);

/// Returns whether a declared rate is so far from the usual one that no style of walking explains it.
bool IsOtherRate(const Gait& gait, double rate);

} // namespace gw
