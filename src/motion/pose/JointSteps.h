#pragma once

#include "Vec3.h"

namespace gw {

class CNode;

// Steps from joint to joint of a tree in its current pose. Helper joints at the same place as the starting
// joint are skipped.

/// Returns whether two joints are at different places, beyond rounding.
bool ArePlacedApart(const Vec3& a, const Vec3& b);
/// Returns the next joint on the path down to `goal`, if that is below, otherwise of the longest branch; null
/// at an end.
CNode* NextBelow(const CNode& node, CNode* goal);
/// Returns the nearest ancestor at another place, or null.
CNode* JointAbove(const CNode& node);
/// Returns the first joint at another place on the path to `goal`, or null.
CNode* JointBelow(const CNode& node, CNode* goal);
/// Returns the toe joint of a foot: `first`, a joint below the ankle, or if that is still within the ankle,
/// the next one along its branch that is not. Null for null.
CNode* ToeFrom(CNode* first, const CNode& knee, const CNode& ankle);

} // namespace gw
