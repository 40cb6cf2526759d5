#include "FindBodyByShape.h"

#include "BodySides.h"
#include "CJointTree.h"
#include "FitLimb.h"
#include "LimbPairs.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace gw {

namespace {

// A pair of chains as arms or legs.
struct Limbs
{
    LimbPair pair;
    LimbFit fit;

    int Joint(size_t side, size_t stop) const
    {
        const std::vector<int>& chain = pair.chains[side];
        return stop < chain.size() ? chain[stop] : CJointTree::kNone;
    }
    int Upper(size_t side) const { return Joint(side, fit.joints.upper); }
    int Lower(size_t side) const { return Joint(side, fit.joints.lower); }
    int End(size_t side) const { return Joint(side, fit.joints.end); }
};

// Which pair is the legs and which the arms.
struct FoundLimbs
{
    Limbs legs;
    Limbs arms;
    double score = 0.0;
};

bool IsInChains(const CJointTree& tree, int joint, const LimbPair& pair)
{
    return std::ranges::any_of(
        pair.chains, [&](const std::vector<int>& chain) { return tree.IsAtOrBelow(joint, chain.front()); });
}

// How high a branch rises over the joint that it leaves, away from the legs, summed over all poses.
double RiseOf(const CJointTree& tree, const FoundLimbs& limbs, int branch)
{
    constexpr size_t kDeepest = 8; // joints of neck and head: a plait hangs down again
    const CStances& stances = tree.Stances();
    const std::vector<int> chain = tree.MainChain(branch, kDeepest);
    double rise = 0.0;
    for (size_t stance = 0; stance < stances.Count(); ++stance)
    {
        const Vec3& top = stances.Place(stance, tree.Parent(branch));
        const Vec3& left = stances.Place(stance, limbs.legs.Lower(0));
        const Vec3& right = stances.Place(stance, limbs.legs.Lower(1));
        const Vec3 up = Vec3Normalized(top - (left + right) * 0.5f);
        double highest = 0.0;
        for (const int joint : chain)
            highest = std::max({highest, Vec3Dot(stances.Place(stance, joint) - top, up),
                                Vec3Dot(stances.Tip(stance, joint) - top, up)});
        rise += highest;
    }
    return rise;
}

// The branch of the chest that goes on to the head: what rises highest beside the arms.
int FindNeck(const CJointTree& tree, const FoundLimbs& limbs)
{
    const LimbPair& arms = limbs.arms.pair;
    int neck = CJointTree::kNone;
    double highest = 0.0;
    for (const int child : tree.Children(arms.joint))
    {
        const bool isArm = child == arms.chains[0].front() || child == arms.chains[1].front();
        if (isArm || tree.IsAtOrBelow(limbs.legs.pair.joint, child))
            continue;
        const double rise = RiseOf(tree, limbs, child);
        if (rise <= highest)
            continue;
        highest = rise;
        neck = child;
    }
    return neck;
}

// How well two pairs suit: long limbs, and legs that are the longer ones, nearer to the root, and that have
// no head beside them.
double ScoreLimbs(const CJointTree& tree, const FoundLimbs& found)
{
    constexpr double kCostWeight = 0.25;
    constexpr double kOrderWeight = 0.3;
    const auto& [legs, arms, none] = found;
    const double size = legs.fit.length + arms.fit.length;
    const double order = (legs.fit.length > arms.fit.length ? 0.5 : -0.5) +
                         (tree.IsAtOrBelow(arms.pair.joint, legs.pair.joint) ? 1.0 : 0.0) -
                         (tree.IsAtOrBelow(legs.pair.joint, arms.pair.joint) ? 1.0 : 0.0);
    return size * (1.0 - kCostWeight * (legs.fit.cost + arms.fit.cost) + kOrderWeight * order);
}

FoundLimbs FindLimbs(const CJointTree& tree)
{
    const std::vector<LimbPair> pairs = FindLimbPairs(tree);
    std::vector<Limbs> legs;
    std::vector<Limbs> arms;
    for (const LimbPair& pair : pairs)
    {
        if (const LimbFit fit = FitLimb(tree, pair.chains, ELimb::Leg); fit.found)
            legs.push_back({pair, fit});
        if (const LimbFit fit = FitLimb(tree, pair.chains, ELimb::Arm); fit.found)
            arms.push_back({pair, fit});
    }
    FoundLimbs best;
    for (const Limbs& leg : legs)
    {
        for (const Limbs& arm : arms)
        {
            if (leg.pair.joint == arm.pair.joint || IsInChains(tree, arm.pair.joint, leg.pair) ||
                IsInChains(tree, leg.pair.joint, arm.pair))
                continue;
            FoundLimbs found{leg, arm, 0.0};
            found.score = ScoreLimbs(tree, found);
            if (found.score <= best.score || FindNeck(tree, found) == CJointTree::kNone)
                continue;
            best = found;
        }
    }
    return best;
}

// The joint of a chain from the chest upward that carries the skull: the first that branches, else the last,
// unless that only marks the top of the head.
size_t FindHead(const CJointTree& tree, const std::vector<int>& chain, double leg)
{
    constexpr double kLongestNeckBone = 0.21; // of a leg; skulls are longer
    constexpr double kSkullShare = 1.35;      // of the bone before
    size_t last = 0;
    while (last + 1 < chain.size() && tree.Children(chain[last]).size() < 2)
        ++last;
    const bool branches = tree.Children(chain[last]).size() >= 2;
    if (branches || last == 0 || tree.TipLength(chain[last]) > 0.02 * leg)
        return last;
    const double bone = tree.Length(chain[last]);
    const bool isSkull =
        bone > kLongestNeckBone * leg || (last > 1 && bone > kSkullShare * tree.Length(chain[last - 1]));
    return isSkull ? last - 1 : last;
}

std::vector<CNode*> NodesAt(const CJointTree& tree, std::span<const int> joints)
{
    std::vector<CNode*> nodes;
    for (const int joint : joints)
        nodes.push_back(tree.Node(joint));
    return nodes;
}

void FillTrunk(const CJointTree& tree, const FoundLimbs& limbs, CBodyMap& body)
{
    constexpr size_t kLongestNeck = 12;
    const int chest = limbs.arms.pair.joint;
    const int hip = tree.CommonAncestor(limbs.legs.pair.joint, chest);
    body.hip = tree.Node(hip);
    body.spine = NodesAt(tree, tree.WayDown(hip, chest));
    const std::vector<int> chain = tree.MainChain(FindNeck(tree, limbs), kLongestNeck);
    const size_t head = FindHead(tree, chain, limbs.legs.fit.length);
    body.neck = NodesAt(tree, std::span(chain).first(head));
    body.head = tree.Node(chain[head]);
}

// Of the joints before the upper arm the first that is as long as a clavicle: helpers come before it.
int FindClavicle(const CJointTree& tree, const Limbs& arms, size_t side)
{
    constexpr double kAsLong = 0.75; // of the longest of them
    const std::vector<int>& chain = arms.pair.chains[side];
    const auto boneOf = [&](size_t stop) { return tree.Length(chain[stop + 1]); };
    double longest = 0.0;
    for (size_t stop = 0; stop < arms.fit.joints.upper; ++stop)
        longest = std::max(longest, boneOf(stop));
    for (size_t stop = 0; stop < arms.fit.joints.upper; ++stop)
    {
        if (boneOf(stop) >= kAsLong * longest)
            return chain[stop];
    }
    return CJointTree::kNone;
}

// The first joint behind the ankle that is a good way from it.
int FindToe(const CJointTree& tree, const Limbs& legs, size_t side)
{
    constexpr double kShortestFoot = 0.03; // of a leg
    constexpr size_t kMostJoints = 4;
    const int foot = legs.End(side);
    double way = 0.0;
    for (const int toe : tree.MainChain(foot == CJointTree::kNone ? foot : tree.MainChild(foot), kMostJoints))
    {
        way += tree.Length(toe);
        if (way > kShortestFoot * legs.fit.length)
            return toe;
    }
    return CJointTree::kNone;
}

BodyArm ArmOf(const CJointTree& tree, const Limbs& arms, size_t side)
{
    return {tree.Node(FindClavicle(tree, arms, side)), tree.Node(arms.Upper(side)),
            tree.Node(arms.Lower(side)), tree.Node(arms.End(side))};
}

BodyLeg LegOf(const CJointTree& tree, const Limbs& legs, size_t side)
{
    return {tree.Node(legs.Upper(side)), tree.Node(legs.Lower(side)), tree.Node(legs.End(side)),
            tree.Node(FindToe(tree, legs, side))};
}

// Where no pose shows which way the body looks, left is +x: most files face +z with y up, the others -y with
// z up.
double SidesByHabit(const CJointTree& tree, const LegsOfBody& legs)
{
    const CStances& stances = tree.Stances();
    return stances.Place(0, legs.legs[0].thigh).x - stances.Place(0, legs.legs[1].thigh).x;
}

// Brings the sides of the limbs, so far in the order of the file, to left and right.
bool SortSides(const CJointTree& tree, CBodyMap& body)
{
    const LegsOfBody legs = LegsOf(tree, body);
    const double arms =
        JudgeAlong(tree, legs, tree.IndexOf(body.arms[0].upperArm), tree.IndexOf(body.arms[1].upperArm));
    const double sides = JudgeSides(tree, legs);
    const bool isSure = std::fabs(sides) > kSidesSure;
    if (arms < 0.0)
        std::swap(body.arms[0], body.arms[1]);
    if ((isSure ? sides : SidesByHabit(tree, legs)) < 0.0)
    {
        std::swap(body.arms[0], body.arms[1]);
        std::swap(body.legs[0], body.legs[1]);
    }
    return isSure && arms != 0.0;
}

} // namespace

CBodyMap FindBodyByShape(const CJointTree& tree, bool& sidesAreSure)
{
    CBodyMap body;
    sidesAreSure = false;
    const FoundLimbs limbs = FindLimbs(tree);
    if (!limbs.legs.fit.found)
        return body;
    FillTrunk(tree, limbs, body);
    for (size_t side = 0; side < body.arms.size(); ++side)
    {
        body.arms[side] = ArmOf(tree, limbs.arms, side);
        body.legs[side] = LegOf(tree, limbs.legs, side);
    }
    sidesAreSure = SortSides(tree, body);
    return body;
}

CBodyMap FindBodyByShape(CNode& root)
{
    bool sidesAreSure = false;
    return FindBodyByShape(CJointTree(root), sidesAreSure);
}

} // namespace gw
