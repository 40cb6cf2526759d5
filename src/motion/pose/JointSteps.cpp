#include "JointSteps.h"

#include "BodyTree.h"
#include "CNode.h"

#include <algorithm>

namespace gw {

namespace {

// Joints no farther apart than this, by how far from the origin they are, are at the same place: rounding is
// a tenth of it, and the shortest bones are a thousand times longer.
constexpr double kSamePlace = 1e-6;
// Of a shin, what the bones of an ankle take up at most; the ball of a foot lies at a quarter.
constexpr double kAnkleShare = 0.05;

bool ArePlacedApart(const CNode& a, const CNode& b)
{
    return ArePlacedApart(a.m_kWorldMatrix.Translation(), b.m_kWorldMatrix.Translation());
}

// How many joints go on below one another; more than a finger has are as many as a finger has.
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

// The first of the longest: a heel that ends at once does not stand for the toes.
CNode* LongestBranch(const CNode& node)
{
    const std::vector<CNode*> children = ChildNodes(node);
    if (children.size() < 2)
        return children.empty() ? nullptr : children.front();
    return *std::ranges::max_element(children, {}, [](CNode* child) { return BranchLength(*child); });
}

// The child of a node on the way down to another, or null where that is not below.
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
