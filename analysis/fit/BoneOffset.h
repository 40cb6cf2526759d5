#pragma once

#include "Mat3.h"
#include "ProfileFile.h"
#include "Vec3.h"

namespace gw {

/// Returns the rotation that a row applies before the source bone's.
Mat3 OffsetOf(const RowNumbers& numbers);

/// Returns a row's numbers for a rotation: the axis codes that leave the smallest angles, and whole degrees.
/// Among nearby numbers, those that best reproduce the rotation of `axis`, a direction of the target bone;
/// the rounding error goes into the twist about it.
RowNumbers NearestOffset(const Mat3& rotation, const Vec3& axis);

} // namespace gw
