#pragma once

#include "CBodyMap.h"

namespace gw {

class CJointTree;

/// The body that the shape of a skeleton tells, whatever its joints are called: two pairs of mirrored limbs,
/// the spine between them, the head beyond. Left is up x forward, which feet or knees show. An empty map
/// where no body is in it. The tree is posed meanwhile and left as it was.
CBodyMap FindBodyByShape(CNode& root);
/// The same for a tree that was looked at already. `sidesAreSure` tells whether the poses show left and
/// right; else the left leg is taken to stand at +x.
CBodyMap FindBodyByShape(const CJointTree& tree, bool& sidesAreSure);

} // namespace gw
