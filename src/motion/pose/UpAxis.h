#pragma once

#include "CBodyMap.h"
#include "Vec3.h"

namespace gw {

/// Returns the world axis that is up in a motion, as a positive or negative unit vector. The rest pose and
/// the whole motion are both considered; the result is +Y unless they show otherwise. `frequency` is the time
/// between frames in seconds. The tree's pose is changed.
Vec3 FindUpAxis(const CBodyMap& body, float frequency, int frameCount);

} // namespace gw
