// A limb has two long bones of about equal length that make up most of it. The part before them (a clavicle,
// a helper at the hip) and the part after them (hand, foot) are short. Twist joints are on a bone's line in
// every pose, so a choice whose bone passes a joint that bends pays for the bend. All this holds in any pose
// and any unit.
//
// FitLimb tries every triple of joints in a chain, at most a few hundred, and returns the cheapest. A cost of
// 0 is a perfect limb; each violated expectation adds up to kMostOfOnePart, and the share of the chain that
// the two bones cover is subtracted, so good fits are negative.

#include "FitLimb.h"

#include "CJointTree.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// The usual proportions of a limb and the cost of deviating. Values are length ratios, found on skeletons
// from many programs.
struct Norms
{
    double ratio;        // natural logarithm of upper / lower bone length
    double before;       // distance before the upper bone, relative to both bones
    double beforeWeight; // if it is longer
    double behind;       // distance after the lower bone, relative to both bones
    double behindWeight;
    double spread; // half the distance between both sides' upper bones, relative to both bones
};
constexpr Norms kArmNorms{0.12, 0.60, 1.5, 0.45, 2.5, 0.34};
constexpr Norms kLegNorms{0.04, 0.20, 1.5, 0.40, 2.5, 0.12};
constexpr double kSpreadWeight = 0.4;
constexpr double kMostOfSpread = 0.6;
constexpr double kMostOfOnePart = 1.5;
constexpr double kBendWeight = 4.0;
constexpr double kShareWeight = 1.0;
constexpr double kPassedJoint = 0.1;  // bones seldom contain joints
constexpr double kPassedBranch = 0.5; // and never one where fingers or toes branch off
constexpr double kAsLongBranch = 0.6; // of the longest; twist joints in a bone reach half of it

const Norms& NormsOf(ELimb limb)
{
    return limb == ELimb::Arm ? kArmNorms : kLegNorms;
}

double Capped(double cost)
{
    return std::clamp(cost, 0.0, kMostOfOnePart);
}

// A chain as a line of stops: its joints and, after the last one, the end of its bone.
class CLine
{
public:
    CLine(const CJointTree& tree, const std::vector<int>& chain) : tree_(tree), chain_(chain)
    {
        double way = 0.0;
        for (size_t i = 0; i < chain.size(); ++i)
            m_kWay.push_back(way += i == 0 ? 0.0 : tree.Length(chain[i]));
        m_kWay.push_back(way + tree.TipLength(chain.back()));
    }

    size_t LastStop() const { return chain_.size(); }
    // Returns the cost of a bone that passes over inner joints.
    double PassedCost(size_t from, size_t to) const
    {
        double cost = 0.0;
        for (size_t stop = from + 1; stop < to; ++stop)
            cost += Way(stop, stop + 1) > 0.0 ? kPassedJoint + (Branches(stop) ? kPassedBranch : 0.0) : 0.0;
        return cost;
    }
    double Way(size_t from, size_t to) const { return m_kWay[to] - m_kWay[from]; }
    double WayBehind(size_t stop) const { return m_kWay.back() - m_kWay[stop]; }
    // Returns how much longer the path between two stops is than the straight line, in the pose with the
    // strongest bend.
    double Bend(size_t from, size_t to) const
    {
        if (to - from < 2)
            return 0.0;
        double most = 0.0;
        const CStances& stances = tree_.Stances();
        for (size_t stance = 0; stance < stances.Count(); ++stance)
            most = std::max(most, BendAt(stance, from, to));
        return most;
    }

    Vec3 Place(size_t stance, size_t stop) const
    {
        const CStances& stances = tree_.Stances();
        return stop == LastStop() ? stances.Tip(stance, chain_.back()) : stances.Place(stance, chain_[stop]);
    }
    size_t StanceCount() const { return tree_.Stances().Count(); }

private:
    bool Branches(size_t stop) const
    {
        const std::vector<int>& children = tree_.Children(chain_[stop]);
        const double least =
            children.empty() ? 0.0 : kAsLongBranch * tree_.Reach(tree_.MainChild(chain_[stop]));
        return std::ranges::count_if(children, [&](int child) { return tree_.Reach(child) >= least; }) > 1;
    }
    double BendAt(size_t stance, size_t from, size_t to) const
    {
        double way = 0.0;
        for (size_t stop = from; stop < to; ++stop)
            way += Vec3Length(Place(stance, stop + 1) - Place(stance, stop));
        const double straight = Vec3Length(Place(stance, to) - Place(stance, from));
        return straight > 0.0 ? way / straight - 1.0 : kMostOfOnePart;
    }

    const CJointTree& tree_;
    const std::vector<int>& chain_;
    std::vector<double> m_kWay; // path length from the first joint to each stop
};

LimbFit Judge(const CLine& line, const Norms& norms, const LimbJoints& joints)
{
    const double upper = line.Way(joints.upper, joints.lower);
    const double lower = line.Way(joints.lower, joints.end);
    LimbFit fit{joints, 0.0, upper + lower, upper > 0.0 && lower > 0.0};
    if (!fit.found)
        return fit;
    const double before = line.Way(0, joints.upper) / fit.length;
    const double behind = line.WayBehind(joints.end) / fit.length;
    const double share = fit.length / (line.Way(0, joints.end) + line.WayBehind(joints.end));
    fit.cost = line.PassedCost(joints.upper, joints.lower) + line.PassedCost(joints.lower, joints.end) +
               std::fabs(std::log(upper / lower) - norms.ratio) +
               Capped(norms.beforeWeight * (before - norms.before)) +
               Capped(norms.behindWeight * (behind - norms.behind)) +
               Capped(kBendWeight * line.Bend(joints.upper, joints.lower)) +
               Capped(kBendWeight * line.Bend(joints.lower, joints.end)) - kShareWeight * share;
    return fit;
}

// Returns the cost of upper bones that start too close to each other or too far apart, in the pose in which
// they are farthest apart. It is needed because a straight arm made of helpers and twist joints does not
// otherwise show where it starts.
double SpreadCost(const CLine& a, const CLine& b, double norm, const LimbJoints& joints)
{
    double widest = 0.0;
    for (size_t stance = 0; stance < a.StanceCount(); ++stance)
    {
        const auto bone = [&](size_t from, size_t to) {
            return Vec3Length(a.Place(stance, to) - a.Place(stance, from));
        };
        const double limb = bone(joints.upper, joints.lower) + bone(joints.lower, joints.end);
        const double half = 0.5 * Vec3Length(a.Place(stance, joints.upper) - b.Place(stance, joints.upper));
        widest = std::max(widest, limb > 0.0 ? half / limb : 0.0);
    }
    const double cost = widest > 0.0 ? kSpreadWeight * std::fabs(std::log(widest / norm)) : kMostOfSpread;
    return std::min(cost, kMostOfSpread);
}

// Returns the mean of both sides.
LimbFit Judge(const std::vector<CLine>& lines, const Norms& norms, const LimbJoints& joints)
{
    LimbFit all{joints, 0.0, 0.0, true};
    const double part = 1.0 / static_cast<double>(lines.size());
    for (const CLine& line : lines)
    {
        const LimbFit fit = Judge(line, norms, joints);
        all.found = all.found && fit.found;
        all.cost += fit.cost * part;
        all.length += fit.length * part;
    }
    if (all.found && lines.size() > 1)
        all.cost += SpreadCost(lines[0], lines[1], norms.spread, joints);
    return all;
}

std::vector<CLine> LinesOf(const CJointTree& tree, LimbChains chains)
{
    std::vector<CLine> lines;
    for (const std::vector<int>& chain : chains)
        lines.emplace_back(tree, chain);
    return lines;
}

} // namespace

LimbFit JudgeLimb(const CJointTree& tree, LimbChains chains, ELimb limb, const LimbJoints& joints)
{
    return Judge(LinesOf(tree, chains), NormsOf(limb), joints);
}

LimbFit FitLimb(const CJointTree& tree, LimbChains chains, ELimb limb)
{
    const std::vector<CLine> lines = LinesOf(tree, chains);
    const std::vector<int>& chain = chains.front();
    const auto isHelper = [&](size_t stop) { return stop < chain.size() && tree.HasStandIn(chain[stop]); };
    // A hand needs a joint; a leg can end where the shin bone ends.
    const size_t lastStop = limb == ELimb::Arm ? chain.size() - 1 : chain.size();
    LimbFit best;
    for (size_t upper = 0; upper < chain.size(); ++upper)
    {
        for (size_t lower = upper + 1; lower < chain.size(); ++lower)
        {
            for (size_t end = lower + 1; end <= lastStop; ++end)
            {
                if (isHelper(upper) || isHelper(lower) || isHelper(end))
                    continue;
                const LimbFit fit = Judge(lines, NormsOf(limb), {upper, lower, end});
                if (fit.found && (!best.found || fit.cost < best.cost))
                    best = fit;
            }
        }
    }
    return best;
}

} // namespace gw
