#pragma once

#include "Vec3.h"

#include <optional>
#include <vector>

namespace gw {

class CBodyTrack;

/// Returns how much a direction shakes at 30 Hz: the mean of |d(t - s) - 2 d(t) + d(t + s)| over the instants
/// t = s, 2 s, ..., where d is the unit direction from one joint to another and s is 1/30 s, or one frame if
/// frames are longer. Directions between two frames are interpolated.
double JitterOf(const std::vector<Vec3>& from, const std::vector<Vec3>& to, double secondsPerFrame);

/// Returns the ratio of the result's jitter to the source's for each thigh and calf that moves in the source.
std::vector<float> LegJitterRatios(const CBodyTrack& source, const CBodyTrack& result,
                                   double secondsPerFrame);

} // namespace gw
