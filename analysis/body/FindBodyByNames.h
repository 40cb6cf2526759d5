#pragma once

#include "CBodyMap.h"

namespace gw {

/// The body that the names of a skeleton's joints tell, read by a grammar of words and not by a list of
/// skeletons; the tree only says in what order the spine goes. Roles that no name tells stay empty. Twist,
/// roll and end joints, fingers and single toes are never taken.
CBodyMap FindBodyByNames(CNode& root);

} // namespace gw
