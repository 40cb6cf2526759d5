#pragma once

#include <vector>

namespace gw {

class CFindings;
class CRowTable;
struct BVHOutline;

/// Returns the largest distance of a joint from the root with all rotations 0, in the file's unit: about the
/// height of the hip on a person.
double SkeletonReach(const BVHOutline& outline);

/// Finds offsets that are repeated in the position channels: those of bones, and the height of the hip.
/// Returns what to subtract from each column's values to remove the repetition; empty if there is none.
std::vector<float> CheckOffsets(const BVHOutline& outline, const CRowTable& table, CFindings& findings);

} // namespace gw
