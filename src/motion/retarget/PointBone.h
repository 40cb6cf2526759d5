#pragma once

#include "Mat3.h"
#include "YieldKnee.h"

namespace gw {

/// A bone's world rotation, turned the least way so that its joint below, which is at `jointBelow` in the
/// bone's space, lies in a direction of the world.
Mat3 PointedTo(const Vec3& direction, const Mat3& bone, const Vec3& jointBelow);

/// The place of a knee or an elbow of a limb from the origin to `end`, which is within its reach: on the side
/// of the line between them on which `side` is. Not finite where there is none: an end at the origin, a side
/// on the line.
Vec3 MiddleJoint(const LegLengths& limb, const Vec3& end, const Vec3& side);

} // namespace gw
