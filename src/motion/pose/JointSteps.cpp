#include "JointSteps.h"

#include "BodyTree.h"
#include "CNode.h"

#include <algorithm>

namespace gw {

namespace {

// Joints closer together than this, relative to their distance from the origin, are at the same place:
// rounding is a tenth of it, and the shortest bones are a thousand times longer.
constexpr double kSamePlace = 1e-6;
// The bones of an ankle take up at most this share of the shin; the ball of a foot is at a quarter.
constexpr double kAnkleShare = 0.05;

bool ArePlacedApart(const CNode& a, const CNode& b)
{
    return ArePlacedApart(a.m_kWorldMatrix.Translation(), b.m_kWorldMatrix.Translation());
}

// Returns the length of the chain of joints below; more than a finger has count as a finger's.
size_t BranchLength(CNode& top)
{
    constexpr size_t kMost = 5;
    std::vector<CNode*> level{&top};
    size_t length = 0;
    for (; !level.empty() && length < kMost; ++length)
    {
        std::vector<CNode*> below;
        for (const CNode* node : level)
        {
            const std::vector<CNode*> children = ChildNodes(*node);
            below.insert(below.end(), children.begin(), children.end());
        }
        level = std::move(below);
    }
    return length;
}

// The first of the longest branches: a heel without children must not be mistaken for the toes.
CNode* LongestBranch(const CNode& node)
{
    const std::vector<CNode*> children = ChildNodes(node);
    if (children.size() < 2)
        return children.empty() ? nullptr : children.front();
    return *std::ranges::max_element(children, {}, [](CNode* child) { return BranchLength(*child); });
}

// Returns a node's child on the path down to another node, or null if that is not below.
CNode* ChildTowards(const CNode& node, CNode* below)
{
    while (below && below->GetParentNode() != &node)
        below = below->GetParentNode();
    return below;
}

} // namespace

CNode* ToeFrom(CNode* first, const CNode& knee, const CNode& ankle)
{
    const Vec3 place = ankle.m_kWorldMatrix.Translation();
    const double least = kAnkleShare * Vec3Length(knee.m_kWorldMatrix.Translation() - place);
    CNode* toe = first;
    while (toe && Vec3Length(toe->m_kWorldMatrix.Translation() - place) < least)
        toe = JointBelow(*toe, nullptr);
    return toe ? toe : first;
}

CNode* JointAbove(const CNode& node)
{
    CNode* parent = node.GetParentNode();
    while (parent && !ArePlacedApart(node, *parent))
        parent = parent->GetParentNode();
    return parent;
}

CNode* NextBelow(const CNode& node, CNode* goal)
{
    CNode* const child = ChildTowards(node, goal);
    return child ? child : LongestBranch(node);
}

CNode* JointBelow(const CNode& node, CNode* goal)
{
    CNode* below = NextBelow(node, goal);
    while (below && !ArePlacedApart(node, *below))
        below = NextBelow(*below, goal);
    return below;
}

bool ArePlacedApart(const Vec3& a, const Vec3& b)
{
    return Vec3Length(b - a) > kSamePlace * (1.0 + Vec3Length(a));
}

} // namespace gw
