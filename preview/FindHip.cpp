#include "FindHip.h"

#include "CNode.h"

#include <algorithm>
#include <vector>

namespace gw {

namespace {

// Toes and helper joints are shorter than a leg: thigh, calf, foot.
constexpr size_t kLimbNodes = 3;

struct Branch
{
    CNode* top;
    size_t nodeCount = 1;
    size_t longestPath = 1; // in nodes
    std::vector<Branch> branches = {};
};

Branch BranchAt(CNode& top)
{
    Branch branch{&top};
    for (size_t slot = 0; slot < top.GetChildCount(); ++slot)
    {
        CNode* const child = RecordCast<CNode>(top.ChildAt(slot));
        if (!child)
            continue;
        const Branch& below = branch.branches.emplace_back(BranchAt(*child));
        branch.nodeCount += below.nodeCount;
        branch.longestPath = std::max(branch.longestPath, 1 + below.longestPath);
    }
    return branch;
}

} // namespace

CNode* FindHip(CNode& root)
{
    const Branch tree = BranchAt(root);
    const auto isLimb = [](const Branch& branch) { return branch.longestPath >= kLimbNodes; };
    for (const Branch* branch = &tree; !branch->branches.empty();)
    {
        if (std::ranges::count_if(branch->branches, isLimb) > 1)
            return branch->top;
        branch = &*std::ranges::max_element(branch->branches, {}, &Branch::nodeCount);
    }
    return &root;
}

} // namespace gw
