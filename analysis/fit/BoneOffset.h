#pragma once

#include "Mat3.h"
#include "ProfileFile.h"
#include "Vec3.h"

namespace gw {

/// The rotation that a row's numbers put before a source bone's.
Mat3 OffsetOf(const RowNumbers& numbers);

/// A row's numbers for a rotation: axis codes that leave the least to turn, and whole degrees. Of all numbers
/// near by those that best take `axis`, a direction of the target bone, to where the rotation takes it; what
/// the degrees cannot hold goes into the turn about the bone.
RowNumbers NearestOffset(const Mat3& rotation, const Vec3& axis);

} // namespace gw
