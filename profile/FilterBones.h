#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CBoneTree;

/// The bones whose name contains a text without regard to case: those that are still to be mapped first, each
/// part in the order of the tree. An empty text is in every name.
std::vector<int> FilterBones(const CBoneTree& tree, std::string_view text);
/// The bones above a bone from the root on, as "Hips / Spine"; empty for a bone below the root of the tree.
std::string BonePath(const CBoneTree& tree, int item);

} // namespace gw
