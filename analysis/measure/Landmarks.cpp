#include "Landmarks.h"

#include "CNode.h"
#include "HostBones.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace gw {

std::vector<LegJoints> LegsOf(const std::vector<LegPair>& pairs, LegJoints LegPair::*side)
{
    std::vector<LegJoints> legs;
    std::ranges::transform(pairs, std::back_inserter(legs), side);
    return legs;
}

CNode* Landmark(std::span<const BonePair> pairs, std::string_view target, CNode* BonePair::*side)
{
    const auto pair =
        std::ranges::find_if(pairs, [=](const BonePair& of) { return of.target->NameView() == target; });
    return pair == pairs.end() ? nullptr : (*pair).*side;
}

BodyLandmarks LandmarksOf(std::span<const BonePair> pairs, const std::vector<LegPair>& legs,
                          LegJoints LegPair::*legSide, CNode* BonePair::*side)
{
    BodyLandmarks joints;
    joints.legs = LegsOf(legs, legSide);
    joints.neck = Landmark(pairs, kNeckBone, side);
    joints.head = Landmark(pairs, kHeadBone, side);
    if (!joints.neck)
        joints.neck = std::exchange(joints.head, nullptr);
    for (size_t i = 0; i < joints.hands.size(); ++i)
        joints.hands[i] = Landmark(pairs, kHostSides[i].hand, side);
    return joints;
}

} // namespace gw
