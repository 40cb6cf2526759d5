#pragma once

#include <string>

namespace gw {

class CNode;

/// Returns a hash of a skeleton: names, tree, and rest pose relative to its root, and the frame rate that a
/// draft has. Sources of one skeleton can share a draft.
std::string SkeletonDigits(CNode& root);

} // namespace gw
