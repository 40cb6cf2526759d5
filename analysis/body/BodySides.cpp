// Decides which side of a body is its left one. Left is up x forward, and forward is where the feet point or,
// less reliably, where the knees bend. Each pose votes with its weight; feet in a standing rest pose decide
// alone, because nobody twists their hips there.

#include "BodySides.h"

#include "CJointTree.h"
#include "Directions.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

using Leg = LegsOfBody::Leg;

// A foot in line with the shin does not show where the body faces, nor does a straight knee.
constexpr double kFootLeast = 0.25; // sine of the angle from the shin to the foot
constexpr double kKneeLeast = 0.05; // sine of the knee's angle
constexpr double kKneeSure = 0.35;
constexpr double kAlongAtRest = 0.5; // cosine
constexpr double kSureAtRest =
    0.8; // of 2: both feet, as far as they point perpendicular to the line between the thighs
// Feet and knees have different weights: a knee never bends backward, but it can turn outward.
constexpr float kKneeWeight = 0.7f;

class CPose
{
public:
    CPose(const CJointTree& tree, size_t stance) : tree_(tree), m_uiStance(stance) {}

    Vec3 Place(int joint) const { return tree_.Stances().Place(m_uiStance, joint); }
    Vec3 Direction(int from, int to) const { return Vec3Normalized(Place(to) - Place(from)); }
    Vec3 Up(const LegsOfBody& body) const { return Direction(body.hip, body.chest); }
    Vec3 Sideways(const LegsOfBody& body) const { return Direction(body.legs[1].thigh, body.legs[0].thigh); }

    // Returns where a foot points relative to its shin; zero if unclear.
    Vec3 FootForward(const Leg& leg) const
    {
        if (leg.ankle < 0)
            return kVec3Zero;
        const Vec3 end = tree_.Stances().Tip(m_uiStance, leg.toe >= 0 ? leg.toe : leg.ankle);
        const Vec3 part = Across(Vec3Normalized(end - Place(leg.ankle)), Direction(leg.knee, leg.ankle));
        return Vec3Length(part) > kFootLeast ? Vec3Normalized(part) : kVec3Zero;
    }
    // Returns where a bent knee moves; longer for a greater bend, up to 1.
    Vec3 KneeForward(const Leg& leg) const
    {
        const Vec3 ankle = leg.ankle >= 0 ? Place(leg.ankle) : tree_.Stances().Tip(m_uiStance, leg.knee);
        const Vec3 line = Vec3Normalized(ankle - Place(leg.thigh));
        const Vec3 part = Across(Direction(leg.thigh, leg.knee), line);
        const double sine = Vec3Length(part);
        if (sine < kKneeLeast)
            return kVec3Zero;
        return Vec3Normalized(part) * (kKneeWeight * static_cast<float>(std::min(1.0, sine / kKneeSure)));
    }
    Vec3 FeetForward(const LegsOfBody& body) const
    {
        return FootForward(body.legs[0]) + FootForward(body.legs[1]);
    }
    Vec3 KneesForward(const LegsOfBody& body) const
    {
        return KneeForward(body.legs[0]) + KneeForward(body.legs[1]);
    }

private:
    const CJointTree& tree_;
    size_t m_uiStance;
};

// Returns the mean over the poses that show anything.
template <class Say>
double MeanOfPoses(const CJointTree& tree, const Say& say)
{
    double sum = 0.0;
    double weight = 0.0;
    for (size_t stance = 0; stance < tree.Stances().Count(); ++stance)
    {
        const double said = say(CPose(tree, stance));
        sum += said;
        weight += std::fabs(said);
    }
    return weight > 0.0 ? sum / weight : 0.0;
}

bool IsWhole(const LegsOfBody& body)
{
    return body.hip >= 0 && body.chest >= 0 &&
           std::ranges::all_of(body.legs, [](const Leg& leg) { return leg.thigh >= 0 && leg.knee >= 0; });
}

// Checks only trunk and legs, because this runs for every profile that may fit, and arms and feet do not
// matter.
bool StandsAtRest(const CJointTree& tree, const CBodyMap& body)
{
    CBodyMap part;
    part.hip = body.hip;
    part.head = body.head;
    if (!body.head)
        part.spine = body.spine;
    for (const EBodySide side : kBodySides)
        part.Leg(side) = {body.Leg(side).thigh, body.Leg(side).shin, nullptr, nullptr};
    return StanceIn(tree, 0, part).Stands();
}

} // namespace

BodyStance StanceIn(const CJointTree& tree, size_t stance, const CBodyMap& body)
{
    return StanceOf(body, [&](const CNode& joint) {
        const int index = tree.IndexOf(&joint);
        return index < 0 ? kVec3Zero : tree.Stances().Place(stance, index);
    });
}

LegsOfBody LegsOf(const CJointTree& tree, const CBodyMap& body)
{
    CNode* const chest = body.spine.empty() ? nullptr : body.spine.back();
    LegsOfBody legs{
        tree.IndexOf(body.hip), tree.IndexOf(body.head ? body.head : chest), {}, StandsAtRest(tree, body)};
    for (const EBodySide side : kBodySides)
    {
        const BodyLeg& leg = body.Leg(side);
        LegsOfBody::Leg& joints = legs.legs[static_cast<size_t>(side)];
        joints = {tree.IndexOf(leg.thigh), tree.IndexOf(leg.shin), tree.IndexOf(leg.foot),
                  tree.IndexOf(leg.toe)};
        if (joints.toe < 0 && joints.ankle >= 0)
            joints.toe = tree.MainChild(joints.ankle);
    }
    return legs;
}

double JudgeSides(const CJointTree& tree, const LegsOfBody& body)
{
    if (!IsWhole(body))
        return 0.0;
    const auto leftward = [&](const CPose& pose, const Vec3& forward) {
        return Vec3Dot(Vec3Cross(pose.Up(body), forward), pose.Sideways(body));
    };
    const auto byFeet = [&](const CPose& pose) { return leftward(pose, pose.FeetForward(body)); };
    const auto byKnees = [&](const CPose& pose) { return leftward(pose, pose.KneesForward(body)); };
    // Nobody twists their hips in a standing rest pose.
    const double atRest = body.standsAtRest ? byFeet(CPose(tree, 0)) : 0.0;
    if (std::fabs(atRest) > kSureAtRest)
        return std::copysign(1.0, atRest);
    const double feet = MeanOfPoses(tree, byFeet);
    return feet != 0.0 ? feet : MeanOfPoses(tree, byKnees);
}

double JudgeAlong(const CJointTree& tree, const LegsOfBody& body, int first, int second)
{
    if (!IsWhole(body) || first < 0 || second < 0)
        return 0.0;
    const auto along = [&](const CPose& pose) {
        return Vec3Dot(pose.Direction(second, first), pose.Sideways(body));
    };
    const double atRest = body.standsAtRest ? along(CPose(tree, 0)) : 0.0;
    return std::fabs(atRest) > kAlongAtRest ? std::copysign(1.0, atRest) : MeanOfPoses(tree, along);
}

} // namespace gw
