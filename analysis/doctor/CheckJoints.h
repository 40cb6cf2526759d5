#pragma once

namespace gw {

class CFindings;
struct BVHOutline;

/// Finds duplicate joint names, and reports mixed rotation orders.
void CheckJoints(const BVHOutline& outline, CFindings& findings);

} // namespace gw
