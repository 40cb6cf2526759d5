#pragma once

namespace gw {

class CFindings;
struct BVHOutline;

/// Finds joints of one name, and notes rotations that turn in different orders.
void CheckJoints(const BVHOutline& outline, CFindings& findings);

} // namespace gw
