#include "BoneEnds.h"

#include "BonePairs.h"
#include "CPoseSampler.h"

#include <cmath>

namespace gw {

namespace {

// Joints no farther apart than this, by how far from the origin they are, are at the same place: rounding is
// a tenth of it, and the shortest bones are a thousand times longer.
constexpr double kSamePlace = 1e-6;

template <class Visit>
void EachChild(const CNode& node, const Visit& visit)
{
    for (size_t i = 0; i < node.GetChildCount(); ++i)
    {
        if (CNode* child = RecordCast<CNode>(node.ChildAt(i)))
            visit(*child);
    }
}

CNode* FirstChild(const CNode& node)
{
    CNode* first = nullptr;
    EachChild(node, [&](CNode& child) { first = first ? first : &child; });
    return first;
}

bool ArePlacedApart(const CNode& a, const CNode& b)
{
    const Vec3 place = a.m_kWorldMatrix.Translation();
    const Vec3 offset = b.m_kWorldMatrix.Translation() - place;
    return Vec3Length(offset) > kSamePlace * (1.0 + Vec3Length(place));
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

// The child of a node on the way down to another, or null where that is not below.
CNode* ChildTowards(const CNode& node, CNode* below)
{
    while (below && below->GetParentNode() != &node)
        below = below->GetParentNode();
    return below;
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

CNode* JointBelow(const CNode& node, CNode* goal)
{
    for (const CNode* at = &node;;)
    {
        CNode* child = ChildTowards(*at, goal);
        child = child ? child : FirstChild(*at);
        if (!child || ArePlacedApart(node, *child))
            return child;
        at = child;
    }
}

} // namespace

BoneEnds FindBoneEnds(const BonePair& pair, const CSourceTable& sources)
{
    CNode* const next = NextMapped(*pair.target, sources);
    CNode* const sourceNext = sources.SourceOf(next);
    CNode* const start = SourceStart(*pair.source, sourceNext);
    return {JointBelow(*pair.target, next), JointBelow(*start, sourceNext), start};
}

CNode* JointAbove(const CNode& node)
{
    CNode* parent = node.GetParentNode();
    while (parent && !ArePlacedApart(node, *parent))
        parent = parent->GetParentNode();
    return parent;
}

} // namespace gw
