#pragma once

#include "Mat3.h"
#include "YieldKnee.h"

namespace gw {

/// Returns the world rotation `bone`, rotated by the smallest angle that makes the bone point in `direction`
/// (world space, any length). `jointBelow` is the position of the next joint in the bone's space.
Mat3 PointedTo(const Vec3& direction, const Mat3& bone, const Vec3& jointBelow);

/// Returns the position of the knee or elbow of a limb that goes from the origin to `end`, which must be
/// within its reach. The joint bends toward the side of that line on which `side` is. The result is not
/// finite if it is undefined: if `end` is the origin, or if `side` is on the line.
Vec3 MiddleJoint(const LegLengths& limb, const Vec3& end, const Vec3& side);

} // namespace gw
