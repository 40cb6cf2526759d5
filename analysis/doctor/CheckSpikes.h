#pragma once

namespace gw {

class CFindings;
class CRowTable;
struct BVHOutline;

/// Finds joints that jump out of their motion and back. A jump of one frame is repaired in the table by
/// interpolating between the frames before and after.
void CheckSpikes(const BVHOutline& outline, CRowTable& table, CFindings& findings);

} // namespace gw
