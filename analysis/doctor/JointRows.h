#pragma once

#include "Quat.h"
#include "Vec3.h"

#include <array>
#include <cstddef>
#include <vector>

namespace gw {

class CRowTable;
struct OutlineJoint;

/// Stores the columns of a joint's X, Y and Z position. Returns false if the joint lacks one of them.
bool PositionColumns(const OutlineJoint& joint, std::array<size_t, 3>& columns);
/// Returns the values of those columns in a row.
Vec3 PositionIn(const CRowTable& table, size_t row, const std::array<size_t, 3>& columns);
/// Returns the columns of a joint's rotations.
std::vector<size_t> RotationColumns(const OutlineJoint& joint);
/// Returns the joint's rotation in each row.
std::vector<Quat> RotationsOf(const OutlineJoint& joint, const CRowTable& table);

} // namespace gw
