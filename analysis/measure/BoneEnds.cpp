#include "BoneEnds.h"

#include "BodyParts.h"
#include "BodyTree.h"
#include "BonePairs.h"
#include "CPoseSampler.h"
#include "JointSteps.h"

#include <cmath>

namespace gw {

namespace {

// Returns the first mapped bone at or below a node, depth first.
CNode* FirstMapped(CNode& node, const CSourceTable& sources)
{
    if (sources.SourceOf(&node))
        return &node;
    CNode* mapped = nullptr;
    for (CNode* child : ChildNodes(node))
        mapped = mapped ? mapped : FirstMapped(*child, sources);
    return mapped;
}

// Returns a node's sideways distance from another in the rest pose, relative to their distance. Nodes at the
// same place count as far: a helper at the hip does not show the leg's direction.
double SidewaysShare(const CNode& from, const CNode& to)
{
    const Vec3 offset = RestWorld(to).Translation() - RestWorld(from).Translation();
    const double length = Vec3Length(offset);
    return length > 0.0 ? std::fabs(static_cast<double>(offset.x)) / length : 1.0;
}

// Returns the mapped bone that a target bone leads to, or null.
CNode* NextMapped(const CNode& target, const CSourceTable& sources)
{
    CNode* next = nullptr;
    double least = 0.0;
    for (CNode* child : ChildNodes(target))
    {
        CNode* mapped = FirstMapped(*child, sources);
        const double share = mapped ? SidewaysShare(target, *mapped) : 0.0;
        if (!mapped || (next && share >= least))
            continue;
        next = mapped;
        least = share;
    }
    return next;
}

// Returns the closest node at or above a source bone that has the next bone's source below it: usually the
// bone itself, but the chest if a collar drives the torso and the next bone is the neck.
CNode* SourceStart(CNode& source, const CNode* next)
{
    CNode* start = &source;
    while (next && start && (start == next || !IsAtOrBelow(next, start)))
        start = start->GetParentNode();
    return start ? start : &source;
}

} // namespace

BoneEnds FindBoneEnds(const BonePair& pair, const CSourceTable& sources)
{
    CNode* const next = NextMapped(*pair.target, sources);
    CNode* const sourceNext = sources.SourceOf(next);
    CNode* const start = SourceStart(*pair.source, sourceNext);
    const BoneEnds ends{JointBelow(*pair.target, next), JointBelow(*start, sourceNext), start};
    // A viewer sees a thigh from hip to knee. A twist joint in between may be off that line.
    const bool skipsTwists = IsLimb(pair.target->NameView()) && next && ends.target == next && ends.source &&
                             IsAtOrBelow(sourceNext, ends.source);
    return skipsTwists ? BoneEnds{next, sourceNext, start} : ends;
}

} // namespace gw
