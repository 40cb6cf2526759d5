#pragma once

#include "CBodyMap.h"

namespace gw {

class CJointTree;

/// Returns the body in a skeleton, found by shape alone: two pairs of mirrored limbs, the spine between them,
/// the head above. Left is up x forward, as shown by feet or knees. Empty if there is no body. The tree is
/// posed during the call and restored.
CBodyMap FindBodyByShape(CNode& root);
/// Same for an existing joint tree. `sidesAreSure` is set if the poses show left and right; otherwise the leg
/// at +x is assumed to be the left one.
CBodyMap FindBodyByShape(const CJointTree& tree, bool& sidesAreSure);

} // namespace gw
