#pragma once

#include "BonePairs.h"
#include "CLegTrack.h"

#include <span>
#include <vector>

namespace gw {

/// The same leg in both skeletons.
struct LegPair
{
    BonePair ankles;
    LegJoints source;
    LegJoints result;
};

/// The legs whose foot, LFoot or RFoot, is mapped, in the order of the pairs. Knee and thigh are the two
/// joints above the ankle; in the source they are those that drive the result's, where these are mapped. Both
/// trees are posed.
std::vector<LegPair> FindLegs(std::span<const BonePair> pairs, const CSourceTable& sources);

} // namespace gw
