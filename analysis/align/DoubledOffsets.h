#pragma once

#include <vector>

namespace gw {

class CTreePoser;
struct BodyMotion;

/// For each joint of a motion whether its positions repeat its offset, which then stands twice in them. Poses
/// the tree.
std::vector<bool> FindDoubled(CTreePoser& tree, const BodyMotion& motion);

} // namespace gw
