#pragma once

#include "Corrections.h"
#include "JointRoles.h"

#include <vector>

namespace gw {

class CTreePoser;

/// Returns the differences of the zero pose from a T-pose; the tree is posed for it. A joint is listed once
/// per correction.
std::vector<Correction> FindRestCorrections(const CTreePoser& tree, const std::vector<JointRole>& roles,
                                            double legLength);

} // namespace gw
