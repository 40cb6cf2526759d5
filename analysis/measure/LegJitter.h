#pragma once

#include "Vec3.h"

#include <optional>
#include <vector>

namespace gw {

class CBodyTrack;

/// How much a direction shakes at 30 Hz: the mean of |d(t - s) - 2 d(t) + d(t + s)|, d being the unit
/// direction from one joint to another and s a thirtieth of a second, over the instants t = s, 2 s, ...
/// Between two frames, directions are interpolated. s is a frame where frames are longer than that.
double JitterOf(const std::vector<Vec3>& from, const std::vector<Vec3>& to, double secondsPerFrame);

/// The result's jitter by the source's for each thigh and calf that moves in the source.
std::vector<float> LegJitterRatios(const CBodyTrack& source, const CBodyTrack& result,
                                   double secondsPerFrame);

} // namespace gw
