// Finds a human body in a tree of joints whose names mean nothing.
//
// The idea: a body is the only thing in a skeleton with two pairs of long mirrored limbs. FindLimbPairs lists
// pairs of chains that leave one joint and match bone for bone. FitLimb rates each pair as arms and as legs:
// which joints would begin its two long bones, and at what cost. All combinations of two pairs are then
// scored, and the best one wins, provided that something rises between the arms that can be a neck.
// Everything else follows: the hip is where the legs meet the trunk, the spine is the path from there to the
// arms, and the neck is the branch that rises highest.
//
// The score is the total limb length, reduced by the cost of both fits (a fit of cost 1 loses a quarter) and
// raised if legs are longer than arms and closer to the root. Length dominates on purpose: fingers, ears and
// skirts mirror each other too, but are short. Ratios such as kLongestNeckBone are fractions of a leg and
// were measured on skeletons from many programs, so units do not matter.
//
// Rest poses can be useless, with all bones on a line or the legs folded up. So "up" is measured over the
// rest pose and several frames. Left and right come from feet and knees (BodySides); if these show nothing,
// left is +x and the caller is told that the sides are a guess.
//
// The number of pairs is limited (kMostPairs in LimbPairs.cpp) and chains are finite, so even a tree with
// thousands of joints ends after a few hundred combinations.

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

// A pair of chains, interpreted as arms or legs.
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

// The choice of legs and arms.
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

// Returns how high a branch rises above its joint, away from the legs, summed over all poses.
double RiseOf(const CJointTree& tree, const FoundLimbs& limbs, int branch)
{
    constexpr size_t kDeepest = 8; // joints of neck and head; a longer chain may be a plait that hangs down
    const CStances& stances = tree.Stances();
    const std::vector<int> chain = tree.MainChain(branch, kDeepest);
    double rise = 0.0;
    for (size_t stance = 0; stance < stances.Count(); ++stance)
    {
        const Vec3 top = stances.Place(stance, tree.Parent(branch));
        const Vec3 left = stances.Place(stance, limbs.legs.Lower(0));
        const Vec3 right = stances.Place(stance, limbs.legs.Lower(1));
        const Vec3 up = Vec3Normalized(top - (left + right) * 0.5f);
        double highest = 0.0;
        for (const int joint : chain)
            highest = std::max({highest, Vec3Dot(stances.Place(stance, joint) - top, up),
                                Vec3Dot(stances.Tip(stance, joint) - top, up)});
        rise += highest;
    }
    return rise;
}

// Returns the branch of the chest that leads to the head: the one that rises highest, except the arms.
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

// Rates a choice of two pairs: long limbs, with legs that are longer and closer to the root.
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

// Returns the joint, in a chain from the chest upward, that carries the skull: the first one that branches,
// otherwise the last, unless that is only a marker at the top of the head.
size_t FindHead(const CJointTree& tree, const std::vector<int>& chain, double leg)
{
    constexpr double kLongestNeckBone = 0.21; // of a leg; skulls are longer than that
    constexpr double kSkullShare = 1.35;      // of the previous bone
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

// Returns the first joint before the upper arm that is as long as a clavicle; shorter ones are helpers.
int FindClavicle(const CJointTree& tree, const Limbs& arms, size_t side)
{
    constexpr double kAsLong = 0.75; // of the longest one
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

// Returns the first joint after the ankle that is clearly apart from it.
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

// Used if no pose shows where the body faces: left is +x, because most files face +z with y up, and the
// others -y with z up.
double SidesByHabit(const CJointTree& tree, const LegsOfBody& legs)
{
    const CStances& stances = tree.Stances();
    return stances.Place(0, legs.legs[0].thigh).x - stances.Place(0, legs.legs[1].thigh).x;
}

// Sorts the limbs, so far in file order, into left and right.
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
