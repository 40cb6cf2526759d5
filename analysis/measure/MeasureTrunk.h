#pragma once

#include <vector>

namespace gw {

class CBodyTrack;

/// Returns the angle in degrees, for each frame, between the trunks' lines from the midpoint of the hip
/// joints to the neck. If these lines differ in the rest poses, for example because one neck is farther back,
/// that difference is rotated with the source's trunk and does not count. Empty if a side has no neck or no
/// leg. Both tracks must have the same number of frames.
std::vector<float> TrunkErrors(const CBodyTrack& source, const CBodyTrack& result);

} // namespace gw
