#pragma once

#include "JointWords.h"

#include <span>
#include <vector>

namespace gw {

class CNode;

/// Interprets the names of all joints of a skeleton, without namespaces and without a prefix that they share.
std::vector<JointName> ReadJointNames(std::span<CNode* const> nodes);

} // namespace gw
