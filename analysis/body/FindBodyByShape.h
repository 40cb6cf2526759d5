#pragma once

#include "CBodyMap.h"

namespace gw {

class CJointTree;

/// Returns the body in a skeleton, found by shape alone: two pairs of mirrored limbs, the spine between them,
/// the head above. Left is up x forward, where feet or knees show what is forward. Returns an empty map if no
/// body is found. Poses the tree during the call and restores it.
CBodyMap FindBodyByShape(CNode& root);
/// Same for an existing joint tree. `sidesAreSure` is set if the poses show left and right; otherwise the leg
/// at +x is assumed to be the left one.
CBodyMap FindBodyByShape(const CJointTree& tree, bool& sidesAreSure);

} // namespace gw
