#pragma once

#include "BonePairs.h"
#include "CBodyTrack.h"
#include "Legs.h"

#include <span>
#include <string_view>
#include <vector>

namespace gw {

/// Returns one side, source or result, of pairs of legs.
std::vector<LegJoints> LegsOf(const std::vector<LegPair>& pairs, LegJoints LegPair::*side);

/// Returns the joint of a named target bone on one side; null if it is not mapped.
CNode* Landmark(std::span<const BonePair> pairs, std::string_view target, CNode* BonePair::*side);

/// Returns the joints of one side that a body track watches. `legSide` and `side` name the same side. Without
/// a neck, the head takes its place.
BodyLandmarks LandmarksOf(std::span<const BonePair> pairs, const std::vector<LegPair>& legs,
                          LegJoints LegPair::*legSide, CNode* BonePair::*side);

} // namespace gw
