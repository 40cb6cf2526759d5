#pragma once

#include <vector>

namespace gw {

class CFindings;
class CRowTable;
struct BVHOutline;

/// The largest distance of a joint from the root with all rotations 0, in the file's unit: on a person about
/// the height of the hip.
double SkeletonReach(const BVHOutline& outline);

/// Finds offsets that stand in the position channels over again: those of bones, and the height of the hip.
/// Answers what is to be taken off each column's values so that they stand once; empty for nothing.
std::vector<float> CheckOffsets(const BVHOutline& outline, const CRowTable& table, CFindings& findings);

} // namespace gw
