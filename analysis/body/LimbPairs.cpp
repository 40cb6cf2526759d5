#include "LimbPairs.h"

#include "CJointTree.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// A body's limbs are among the longest chains. The limit keeps an unusual tree as fast as a large one.
constexpr size_t kMostPairs = 24;
constexpr size_t kMostBranches = 8; // per joint
constexpr size_t kLongestChain = 20;
constexpr size_t kLeastJoints = 2;
// Of the longest path through the tree. Arms are a third of it, even next to a long object in a hand.
constexpr double kLeastReach = 0.08;
// Real skeletons differ between left and right.
constexpr double kMostDifference = 0.25; // of the longer of both bones
constexpr double kAnyDifference = 0.03;  // of the whole limb: short bones can differ a lot

std::vector<int> LongBranches(const CJointTree& tree, int joint)
{
    std::vector<int> branches;
    for (const int child : tree.Children(joint))
    {
        if (tree.Reach(child) > kLeastReach * tree.Reach(0))
            branches.push_back(child);
    }
    std::ranges::stable_sort(branches, std::ranges::greater(), [&](int child) { return tree.Reach(child); });
    branches.resize(std::min(branches.size(), kMostBranches));
    return branches;
}

bool IsMirrored(const CJointTree& tree, int a, int b, double limb)
{
    const double longer = std::max(tree.Length(a), tree.Length(b));
    const double difference = std::fabs(tree.Length(a) - tree.Length(b));
    return difference <= std::max(kMostDifference * longer, kAnyDifference * limb);
}

LimbPair MirroredPair(const CJointTree& tree, int a, int b)
{
    LimbPair pair{
        tree.Parent(a), {tree.MainChain(a, kLongestChain), tree.MainChain(b, kLongestChain)},
         0.0
    };
    auto& [first, second] = pair.chains;
    const double limb = std::min(tree.Reach(a), tree.Reach(b));
    size_t joints = 0;
    while (joints < std::min(first.size(), second.size()) &&
           IsMirrored(tree, first[joints], second[joints], limb))
        pair.length += tree.Length(first[joints++]);
    first.resize(joints);
    second.resize(joints);
    if (joints > 0)
        pair.length += std::min(tree.TipLength(first.back()), tree.TipLength(second.back()));
    return pair;
}

void AddPairs(const CJointTree& tree, int joint, std::vector<LimbPair>& pairs)
{
    const std::vector<int> branches = LongBranches(tree, joint);
    for (size_t i = 0; i < branches.size(); ++i)
    {
        for (size_t k = i + 1; k < branches.size(); ++k)
        {
            LimbPair pair = MirroredPair(tree, branches[i], branches[k]);
            if (pair.chains[0].size() >= kLeastJoints)
                pairs.push_back(std::move(pair));
        }
    }
}

} // namespace

std::vector<LimbPair> FindLimbPairs(const CJointTree& tree)
{
    std::vector<LimbPair> pairs;
    for (int joint = 0; joint < tree.Count(); ++joint)
    {
        if (tree.Children(joint).size() < 2)
            continue;
        AddPairs(tree, joint, pairs);
        std::ranges::stable_sort(pairs, std::ranges::greater(), &LimbPair::length);
        pairs.resize(std::min(pairs.size(), kMostPairs));
    }
    return pairs;
}

} // namespace gw
