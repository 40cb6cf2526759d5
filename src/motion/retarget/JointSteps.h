#pragma once

namespace gw {

class CNode;

// From joint to joint of a tree in its present pose. Helper joints that stand at the place of the joint where
// the step begins are passed over.

/// The nearest ancestor at another place, or null.
CNode* JointAbove(const CNode& node);
/// The nearest joint below at another place, on the way to `goal` where that is below, else along the
/// branch that goes on farthest; null where there is none.
CNode* JointBelow(const CNode& node, CNode* goal);
/// The joint that a foot leads to: `first`, a joint below the ankle, or where that still lies in the ankle
/// the next one along the branch that does not. Null for null.
CNode* ToeFrom(CNode* first, const CNode& knee, const CNode& ankle);

} // namespace gw
