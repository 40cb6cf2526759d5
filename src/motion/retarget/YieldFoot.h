#pragma once

#include "Mat3.h"
#include "StandSteps.h"

#include <span>
#include <vector>

namespace gw {

/// Returns a rotation of the target's foot by a few degrees for each frame, with which ankle and toe slide
/// less while they stand; the identity where they do not slide farther than the source's. `lifts` are the
/// heights, one per frame, by which ankle and toe of the source are farther apart than in a foot that stands
/// flat, in the target's scale. The vectors from ankle to toe must be as long as the foot.
std::vector<Mat3> YieldFoot(const FootPaths& foot, const FootStands& stands, std::span<const float> lifts,
                            double secondsPerFrame);

} // namespace gw
