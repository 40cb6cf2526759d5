#pragma once

#include "CBodyMap.h"
#include "Vec3.h"

namespace gw {

/// The world axis, plus or minus, along which a motion's body stands: told by its rest pose and by the whole
/// motion together. +Y where nothing says otherwise. `frequency` is seconds from frame to frame. Poses the
/// tree on the way.
Vec3 FindUpAxis(const CBodyMap& body, float frequency, int frameCount);

} // namespace gw
