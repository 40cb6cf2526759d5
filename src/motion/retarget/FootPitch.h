#pragma once

#include "Mat3.h"
#include "Vec3.h"

namespace gw {

/// Where a toe is relative to its ankle, in the vertical plane through both.
struct ToePlace
{
    double ahead;  ///< horizontal distance
    double height; ///< negative if the toe is below the ankle
};

/// Returns where a toe is, from the vector from ankle to toe.
ToePlace ToePlaceOf(const Vec3& ankleToToe);

/// Returns a rotation by a few degrees that brings the toe of a foot closer to `wanted` by pitching the foot.
/// `toe` is the vector from its ankle to its toe. Returns the identity if `wanted` is not finite.
Mat3 PitchFoot(const Vec3& toe, const ToePlace& wanted);

/// Returns a rotation that lowers the toe of a foot by `drop`, relative to its ankle; the identity if it is
/// not finite.
Mat3 LoweredToe(const Vec3& toe, double drop);

} // namespace gw
