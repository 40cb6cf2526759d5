#pragma once

#include "AlignReport.h"
#include "JointRoles.h"

#include <vector>

namespace gw {

class CTreePoser;

/// What of the zero pose is not as a T-pose: the tree is posed so. A joint is named once for each need.
std::vector<AlignFinding> FindRestNeeds(const CTreePoser& tree, const std::vector<JointRole>& roles,
                                        double legLength);

} // namespace gw
