#pragma once

#include "CBodyMap.h"

namespace gw {

/// Returns the body that the joint names describe, read with a grammar of words instead of a list of known
/// skeletons. The tree only provides the order of the spine. Unnamed roles stay empty. Twist, roll and end
/// joints, fingers and single toes are never used.
CBodyMap FindBodyByNames(CNode& root);

} // namespace gw
