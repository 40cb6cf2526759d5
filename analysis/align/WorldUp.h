#pragma once

#include "Vec3.h"

#include <optional>

namespace gw {

struct BodyMotion;

/// The world axis, plus or minus, that is up in a motion: +Y unless the body stands along another one nearly
/// all the time. `restUp` is the up axis of a zero pose that is a stance. Against one that is +Y the motion
/// must show a figure with its feet on the ground of the other axis, since it may lie all the time.
Vec3 FindWorldUp(const BodyMotion& motion, const std::optional<Vec3>& restUp);

} // namespace gw
