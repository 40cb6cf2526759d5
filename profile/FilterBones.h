#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CBoneTree;

/// Returns the bones whose name contains a text, ignoring case: one with exactly this name, then
/// unmapped bones, then mapped ones, each in tree order. An empty text matches every name.
std::vector<int> FilterBones(const CBoneTree& tree, std::string_view text);
/// Returns the bones above a bone, starting at the root, as "Hips / Spine"; empty for a bone at the top of
/// the tree.
std::string BonePath(const CBoneTree& tree, int item);

} // namespace gw
