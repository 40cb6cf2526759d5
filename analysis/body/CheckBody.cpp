// Checks a body map against the skeleton's geometry. The tree is checked first: each joint must be below the
// joint that carries it, otherwise positions mean nothing. Then limbs: is there a clearly better choice of
// upper arm or thigh in the same chain (FitLimb), are left and right swapped (BodySides), are bone lengths
// plausible and symmetric? Thresholds are wide, because a doubt is shown to a user who chose the map.

#include "CheckBody.h"

#include "BodySides.h"
#include "BodyTree.h"
#include "CJointTree.h"
#include "CNode.h"
#include "FitLimb.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr double kBetterChoice = 0.4; // how much cheaper another choice for a limb must be
constexpr double kUneven = 1.5;       // ratio of left and right bone

// A joint's carrier: the first of these that the body has.
struct Carrier
{
    EBodyJoint joint;
    EBodyJoint carriers[4];
};
using enum EBodyJoint;
constexpr Carrier kCarriers[] = {
    {Spine,    {Hip, Hip, Hip, Hip}              },
    {Neck,     {Spine, Hip, Hip, Hip}            },
    {Head,     {Neck, Spine, Hip, Hip}           },
    {Clavicle, {Hip, Hip, Hip, Hip}              },
    {UpperArm, {Clavicle, Hip, Hip, Hip}         },
    {Forearm,  {UpperArm, Clavicle, Hip, Hip}    },
    {Hand,     {Forearm, UpperArm, Clavicle, Hip}},
    {Thigh,    {Hip, Hip, Hip, Hip}              },
    {Shin,     {Thigh, Hip, Hip, Hip}            },
    {Foot,     {Shin, Thigh, Hip, Hip}           },
    {Toe,      {Foot, Shin, Thigh, Hip}          },
};

const CNode* CarrierOf(const CBodyMap& body, BodyPlace place)
{
    const auto* row = std::ranges::find(kCarriers, place.joint, &Carrier::joint);
    if (row == std::end(kCarriers))
        return nullptr;
    for (const EBodyJoint carrier : row->carriers)
    {
        if (const CNode* node = JointAt(body, {carrier, place.side}))
            return node;
    }
    return nullptr;
}

// The joints of one limb as a chain from the trunk outward.
struct MappedLimb
{
    std::vector<int> chain;
    LimbJoints joints;
    bool found = false;
};

class CBodyChecker
{
public:
    CBodyChecker(const CBodyMap& body, const CJointTree& tree)
        : body_(body), tree_(tree), m_kLegs(LegsOf(tree, body))
    {
    }

    std::vector<BodyDoubt> Check();

private:
    void Doubt(EDoubt kind, BodyPlace place) { m_kDoubts.push_back({kind, place}); }
    int Joint(BodyPlace place) const { return tree_.IndexOf(JointAt(body_, place)); }
    void CheckCarriers();
    void CheckSides();
    void CheckLegsDown();
    void CheckLimb(ELimb limb, EBodySide side);
    void CheckEvenness(BodyPlace place);
    MappedLimb LimbOf(ELimb limb, EBodySide side) const;

    const CBodyMap& body_;
    const CJointTree& tree_;
    LegsOfBody m_kLegs;
    std::vector<BodyDoubt> m_kDoubts;
};

std::vector<BodyDoubt> CBodyChecker::Check()
{
    CheckCarriers();
    if (!m_kDoubts.empty()) // positions mean nothing if the tree is wrong
        return m_kDoubts;
    CheckLegsDown();
    CheckSides();
    for (const EBodySide side : kBodySides)
    {
        CheckLimb(ELimb::Arm, side);
        CheckLimb(ELimb::Leg, side);
    }
    for (const EBodyJoint joint : {UpperArm, Forearm, Thigh, Shin})
        CheckEvenness({joint, EBodySide::Left});
    return m_kDoubts;
}

void CBodyChecker::CheckCarriers()
{
    for (const BodyPlace& place : BodyPlaces())
    {
        const CNode* const node = JointAt(body_, place);
        const CNode* const carrier = CarrierOf(body_, place);
        if (node && carrier && (node == carrier || !IsAtOrBelow(node, carrier)))
            Doubt(EDoubt::NotBelow, place);
    }
}

void CBodyChecker::CheckLegsDown()
{
    const CStances& stances = tree_.Stances();
    const auto goesUp = [&](const LegsOfBody::Leg& leg, size_t stance) {
        const Vec3 down = stances.Place(stance, leg.knee) - stances.Place(stance, leg.thigh);
        return Vec3Dot(down, stances.Place(stance, m_kLegs.chest) - stances.Place(stance, m_kLegs.hip)) > 0.0;
    };
    for (const EBodySide side : kBodySides)
    {
        const LegsOfBody::Leg& leg = m_kLegs.legs[static_cast<size_t>(side)];
        bool always = m_kLegs.hip >= 0 && m_kLegs.chest >= 0 && leg.thigh >= 0 && leg.knee >= 0;
        for (size_t stance = 0; always && stance < stances.Count(); ++stance)
            always = goesUp(leg, stance);
        if (always)
            Doubt(EDoubt::LegsUp, {Thigh, side});
    }
}

void CBodyChecker::CheckSides()
{
    if (JudgeSides(tree_, m_kLegs) < -kSidesSure)
        Doubt(EDoubt::SidesSwapped, {Thigh, EBodySide::Left});
    const double arms =
        JudgeAlong(tree_, m_kLegs, Joint({UpperArm, EBodySide::Left}), Joint({UpperArm, EBodySide::Right}));
    if (arms < -kSidesSure)
        Doubt(EDoubt::SidesSwapped, {UpperArm, EBodySide::Left});
}

// The chain starts below the trunk, where the other side's limb branches off, and continues past the limb's
// end.
MappedLimb CBodyChecker::LimbOf(ELimb limb, EBodySide side) const
{
    constexpr size_t kMostBehind = 1; // the knuckles, but nothing held in the hand
    constexpr size_t kLongestChain = 24;
    const bool isArm = limb == ELimb::Arm;
    const EBodyJoint first = isArm ? UpperArm : Thigh;
    const EBodyJoint last = isArm ? Hand : Foot;
    const EBodySide other = side == EBodySide::Left ? EBodySide::Right : EBodySide::Left;
    const int upper = Joint({first, side});
    const int lower = Joint({isArm ? Forearm : Shin, side});
    const int end = Joint({last, side});
    const int mirror = Joint({first, other});
    if (upper < 0 || lower < 0 || end < 0 || mirror < 0)
        return {};
    MappedLimb mapped{tree_.WayDown(tree_.CommonAncestor(upper, mirror), end), {}, true};
    for (const int joint : tree_.MainChain(tree_.MainChild(end), kMostBehind))
        mapped.chain.push_back(joint);
    const auto stopOf = [&](int joint) {
        return static_cast<size_t>(std::ranges::find(mapped.chain, joint) - mapped.chain.begin());
    };
    mapped.joints = {stopOf(upper), stopOf(lower), stopOf(end)};
    mapped.found = mapped.joints.end < mapped.chain.size() && mapped.chain.size() <= kLongestChain;
    return mapped;
}

void CBodyChecker::CheckLimb(ELimb limb, EBodySide side)
{
    const BodyPlace place{limb == ELimb::Arm ? UpperArm : Thigh, side};
    const MappedLimb mapped = LimbOf(limb, side);
    if (!mapped.found)
        return;
    const LimbChains chains(&mapped.chain, 1);
    const LimbFit fit = JudgeLimb(tree_, chains, limb, mapped.joints);
    const LimbFit best = FitLimb(tree_, chains, limb);
    if (!fit.found)
        return Doubt(EDoubt::OddLength, place);
    if (!best.found || fit.cost < best.cost + kBetterChoice)
        return;
    if (limb == ELimb::Arm && best.joints.upper != mapped.joints.upper)
        return Doubt(mapped.joints.upper < best.joints.upper ? EDoubt::ArmIsClavicle : EDoubt::ClavicleIsArm,
                     place);
    Doubt(EDoubt::OddLength, place);
}

void CBodyChecker::CheckEvenness(BodyPlace place)
{
    const auto boneOf = [&](EBodySide side) {
        const BodyPlace next{static_cast<EBodyJoint>(static_cast<int>(place.joint) + 1), side};
        const int top = Joint({place.joint, side});
        const int bottom = Joint(next);
        double length = 0.0;
        for (const int joint : top < 0 || bottom < 0 ? std::vector<int>() : tree_.WayDown(top, bottom))
            length += tree_.Length(joint);
        return length;
    };
    const double left = boneOf(EBodySide::Left);
    const double right = boneOf(EBodySide::Right);
    if (left > 0.0 && right > 0.0 && std::max(left / right, right / left) > kUneven)
        Doubt(EDoubt::OddLength, place);
}

CNode* RootOf(CNode* node)
{
    while (node->GetParentNode())
        node = node->GetParentNode();
    return node;
}

} // namespace

std::vector<BodyDoubt> CheckBody(const CBodyMap& body, const CJointTree& tree)
{
    return CBodyChecker(body, tree).Check();
}

std::vector<BodyDoubt> CheckBody(const CBodyMap& body)
{
    for (const BodyPlace& place : BodyPlaces())
    {
        if (CNode* joint = JointAt(body, place))
            return CheckBody(body, CJointTree(*RootOf(joint)));
    }
    return {};
}

} // namespace gw
