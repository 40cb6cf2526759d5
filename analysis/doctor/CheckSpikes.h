#pragma once

namespace gw {

class CFindings;
class CRowTable;
struct BVHOutline;

/// Finds joints that jump out of their motion and back. A jump of one frame is mended in the table: its
/// values become those between the frames before and behind.
void CheckSpikes(const BVHOutline& outline, CRowTable& table, CFindings& findings);

} // namespace gw
