#pragma once

#include <vector>

namespace gw {

class CBodyTrack;

/// The angle in degrees, frame by frame, between the trunks' lines from the middle of the hip joints to the
/// neck. Skeletons whose lines differ in their rest poses, as a neck that is farther back makes them, keep
/// that difference: it is taken along with the source's trunk and does not count. Empty where a side has no
/// neck or no leg. Both tracks have the same frames.
std::vector<float> TrunkErrors(const CBodyTrack& source, const CBodyTrack& result);

} // namespace gw
