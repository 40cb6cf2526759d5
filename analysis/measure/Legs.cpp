#include "Legs.h"

#include "BoneEnds.h"
#include "CNode.h"
#include "HostBones.h"
#include "JointSteps.h"

namespace gw {

namespace {

LegJoints ResultLeg(CNode& ankle, CNode* toe)
{
    CNode* const knee = JointAbove(ankle);
    return {knee ? JointAbove(*knee) : nullptr, knee, &ankle, toe};
}

LegJoints SourceLeg(CNode& ankle, CNode* toe, const LegJoints& result, const CSourceTable& sources)
{
    CNode* const mappedKnee = sources.SourceOf(result.knee);
    CNode* const knee = mappedKnee ? mappedKnee : JointAbove(ankle);
    CNode* const mappedThigh = sources.SourceOf(result.thigh);
    toe = knee ? ToeFrom(toe, *knee, ankle) : toe;
    if (mappedThigh || !knee)
        return {mappedThigh, knee, &ankle, toe};
    return {JointAbove(*knee), knee, &ankle, toe};
}

bool IsWhole(const LegJoints& leg)
{
    return leg.thigh && leg.knee;
}

} // namespace

std::vector<LegPair> FindLegs(std::span<const BonePair> pairs, const CSourceTable& sources)
{
    std::vector<LegPair> legs;
    for (const BonePair& pair : pairs)
    {
        const std::string_view name = pair.target->NameView();
        if (name != kLeftBones.foot && name != kRightBones.foot)
            continue;
        const BoneEnds toes = FindBoneEnds(pair, sources);
        const LegJoints result = ResultLeg(*pair.target, toes.target);
        const LegJoints source = SourceLeg(*pair.source, toes.source, result, sources);
        if (IsWhole(result) && IsWhole(source))
            legs.push_back({pair, source, result});
    }
    return legs;
}

} // namespace gw
