#pragma once

#include "Vec3.h"

#include <optional>

namespace gw {

struct BodyPaths;

/// How fast somebody walks or runs: what the frames show, whatever rate the file declares.
struct Gait
{
    double framesPerStep;
    double stepLength; ///< in lengths of the leg

    /// The frames per second at which this would be a usual gait.
    double UsualRate() const;
};

/// The gait of a motion that is one without doubt: steps as regular as a walk or a run, a foot that stands
/// while the other one passes, a hip that goes on step by step. `leg` is in the unit of the paths.
std::optional<Gait> FindGait(const BodyPaths& paths, const Vec3& up, double leg);

/// Whether a declared rate is so far from the usual one that no style of walking explains it.
bool IsOtherRate(const Gait& gait, double rate);

} // namespace gw
