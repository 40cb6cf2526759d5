#include "JointSteps.h"

#include "CNode.h"

namespace gw {

namespace {

// Joints no farther apart than this, by how far from the origin they are, are at the same place: rounding is
// a tenth of it, and the shortest bones are a thousand times longer.
constexpr double kSamePlace = 1e-6;

bool ArePlacedApart(const CNode& a, const CNode& b)
{
    const Vec3 place = a.m_kWorldMatrix.Translation();
    const Vec3 offset = b.m_kWorldMatrix.Translation() - place;
    return Vec3Length(offset) > kSamePlace * (1.0 + Vec3Length(place));
}

CNode* FirstChild(const CNode& node)
{
    for (size_t i = 0; i < node.GetChildCount(); ++i)
    {
        if (CNode* const child = RecordCast<CNode>(node.ChildAt(i)))
            return child;
    }
    return nullptr;
}

// The child of a node on the way down to another, or null where that is not below.
CNode* ChildTowards(const CNode& node, CNode* below)
{
    while (below && below->GetParentNode() != &node)
        below = below->GetParentNode();
    return below;
}

} // namespace

CNode* JointAbove(const CNode& node)
{
    CNode* parent = node.GetParentNode();
    while (parent && !ArePlacedApart(node, *parent))
        parent = parent->GetParentNode();
    return parent;
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

} // namespace gw
