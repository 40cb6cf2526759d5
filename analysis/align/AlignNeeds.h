#pragma once

#include "AlignReport.h"
#include "JointRoles.h"

#include <vector>

namespace gw {

class CTreePoser;

/// Returns the differences of the zero pose from a T-pose; the tree is posed for it. A joint is listed once
/// per need.
std::vector<AlignFinding> FindRestNeeds(const CTreePoser& tree, const std::vector<JointRole>& roles,
                                        double legLength);

} // namespace gw
