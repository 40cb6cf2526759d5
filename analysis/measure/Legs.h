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

/// Returns the legs whose foot, LFoot or RFoot, is mapped, in pair order. Knee and thigh are the two joints
/// above the ankle; in the source, the joints that drive the result's, if these are mapped. Both trees must
/// be posed.
std::vector<LegPair> FindLegs(std::span<const BonePair> pairs, const CSourceTable& sources);

} // namespace gw
