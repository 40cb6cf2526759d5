#include "BoneEnds.h"

#include "BonePairs.h"
#include "CPoseSampler.h"
#include "JointSteps.h"

#include <cmath>

namespace gw {

namespace {

template <class Visit>
void EachChild(const CNode& node, const Visit& visit)
{
    for (size_t i = 0; i < node.GetChildCount(); ++i)
    {
        if (CNode* child = RecordCast<CNode>(node.ChildAt(i)))
            visit(*child);
    }
}

// The first mapped bone at or below a node, depth first.
CNode* FirstMapped(CNode& node, const CSourceTable& sources)
{
    if (sources.SourceOf(&node))
        return &node;
    CNode* mapped = nullptr;
    EachChild(node, [&](CNode& child) { mapped = mapped ? mapped : FirstMapped(child, sources); });
    return mapped;
}

// How far sideways a node lies from another in the rest pose, as a share of their distance. Nodes at one
// place count as far: a hip's helper says nothing of the way that the leg takes.
double SidewaysShare(const CNode& from, const CNode& to)
{
    const Vec3 offset = RestWorld(to).Translation() - RestWorld(from).Translation();
    const double length = Vec3Length(offset);
    return length > 0.0 ? std::fabs(static_cast<double>(offset.x)) / length : 1.0;
}

// The mapped bone that a target bone leads to, or null.
CNode* NextMapped(const CNode& target, const CSourceTable& sources)
{
    CNode* next = nullptr;
    double least = 0.0;
    EachChild(target, [&](CNode& child) {
        CNode* mapped = FirstMapped(child, sources);
        const double share = mapped ? SidewaysShare(target, *mapped) : 0.0;
        if (!mapped || (next && share >= least))
            return;
        next = mapped;
        least = share;
    });
    return next;
}

bool IsAbove(const CNode& node, const CNode* below)
{
    while (below && below != &node)
        below = below->GetParentNode();
    return below != nullptr;
}

// The nearest node at or above a source bone that has the next bone's source below it: the bone itself where
// the rows follow the skeleton, the chest where a collar drives the torso and the next bone is the neck.
CNode* SourceStart(CNode& source, const CNode* next)
{
    CNode* start = &source;
    while (next && start && (start == next || !IsAbove(*start, next)))
        start = start->GetParentNode();
    return start ? start : &source;
}

} // namespace

BoneEnds FindBoneEnds(const BonePair& pair, const CSourceTable& sources)
{
    CNode* const next = NextMapped(*pair.target, sources);
    CNode* const sourceNext = sources.SourceOf(next);
    CNode* const start = SourceStart(*pair.source, sourceNext);
    return {JointBelow(*pair.target, next), JointBelow(*start, sourceNext), start};
}

} // namespace gw
