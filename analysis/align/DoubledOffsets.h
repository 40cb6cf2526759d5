#pragma once

#include <vector>

namespace gw {

class CTreePoser;
struct BodyMotion;

/// Returns, for each joint of a motion, whether its positions repeat its offset, which is then contained
/// twice. Poses the tree.
std::vector<bool> FindDoubled(CTreePoser& tree, const BodyMotion& motion);

} // namespace gw
