#pragma once

#include "Vec3.h"

namespace gw {

class CNode;

// From joint to joint of a tree in its present pose. Helper joints that stand at the place of the joint where
// the step begins are passed over.

/// Whether two joints are at different places: no rounding errors of one.
bool ArePlacedApart(const Vec3& a, const Vec3& b);
/// The next joint on the way down to `goal`, if that is below, else of the branch that goes on farthest; null
/// at an end.
CNode* NextBelow(const CNode& node, CNode* goal);
/// The nearest ancestor at another place, or null.
CNode* JointAbove(const CNode& node);
/// The first joint on that way at another place, or null.
CNode* JointBelow(const CNode& node, CNode* goal);
/// The joint that a foot leads to: `first`, a joint below the ankle, or where that still lies in the ankle
/// the next one along the branch that does not. Null for null.
CNode* ToeFrom(CNode* first, const CNode& knee, const CNode& ankle);

} // namespace gw
