#pragma once

#include "Corrections.h"
#include "JointRoles.h"

#include <vector>

namespace gw {

class CTreePoser;

/// Returns the differences between the zero pose and a T-pose, in degrees per joint. The tree must be in its
/// zero pose. A joint is listed once per kind of correction.
std::vector<Correction> FindRestCorrections(const CTreePoser& tree, const std::vector<JointRole>& roles,
                                            double legLength);

} // namespace gw
