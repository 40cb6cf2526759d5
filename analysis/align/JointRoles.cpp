// Gives every joint of a skeleton its body part. The body map only names the main joints, so each limb is
// filled as a chain: a joint between two named ones belongs to the upper one. Everything else keeps no part
// and follows its parent.

#include "JointRoles.h"

#include "BodyTree.h"
#include "CTreePoser.h"

#include <span>

namespace gw {

namespace {

struct Stop
{
    CNode* joint;
    EBodyPart part;
};

class CRoleFinder
{
public:
    CRoleFinder(const CTreePoser& tree, const CBodyMap& body)
        : tree_(tree), body_(body), m_kRoles(tree.Joints().size())
    {
    }
    std::vector<JointRole> Find();

private:
    JointRole* RoleOf(const CNode* joint)
    {
        const int index = tree_.IndexOf(joint);
        return index < 0 ? nullptr : &m_kRoles[static_cast<size_t>(index)];
    }
    void AddChain(std::span<const Stop> chain, EBodySide side);
    void AddTrunk();
    void AddLimbs(EBodySide side);
    void FillShoulder(EBodySide side);
    CNode* TrunkAbove(const CNode* joint);

    const CTreePoser& tree_;
    const CBodyMap& body_;
    std::vector<JointRole> m_kRoles;
};

// Missing joints are skipped.
void CRoleFinder::AddChain(std::span<const Stop> chain, EBodySide side)
{
    std::vector<Stop> stops;
    for (const Stop& stop : chain)
    {
        if (RoleOf(stop.joint))
            stops.push_back(stop);
    }
    for (size_t i = 0; i < stops.size(); ++i)
    {
        const auto& [joint, part] = stops[i];
        CNode* next = i + 1 < stops.size() ? stops[i + 1].joint : nullptr;
        next = IsAtOrBelow(next, joint) && next != joint ? next : nullptr;
        const EBodyPart between = part == EBodyPart::Hip ? EBodyPart::Spine : part;
        while (next && next->GetParentNode() != joint)
        {
            CNode* const inner = next->GetParentNode();
            *RoleOf(inner) = {between, side, next, false};
            next = inner;
        }
        *RoleOf(joint) = {part, side, next, false};
    }
}

void CRoleFinder::AddTrunk()
{
    std::vector<Stop> stops{
        {body_.hip, EBodyPart::Hip}
    };
    for (CNode* joint : body_.spine)
        stops.push_back({joint, EBodyPart::Spine});
    for (CNode* joint : body_.neck)
        stops.push_back({joint, EBodyPart::Neck});
    stops.push_back({body_.head, EBodyPart::Head});
    AddChain(stops, EBodySide::Left);
    for (const CNode* joint = body_.hip->GetParentNode(); RoleOf(joint); joint = joint->GetParentNode())
        *RoleOf(joint) = {EBodyPart::AboveHip, EBodySide::Left, body_.hip, false};
}

CNode* CRoleFinder::TrunkAbove(const CNode* joint)
{
    CNode* above = joint ? joint->GetParentNode() : nullptr;
    while (above && RoleOf(above) && !IsTrunk(RoleOf(above)->part))
        above = above->GetParentNode();
    return above && RoleOf(above) ? above : nullptr;
}

void CRoleFinder::AddLimbs(EBodySide side)
{
    const BodyArm& arm = body_.Arm(side);
    const BodyLeg& leg = body_.Leg(side);
    const Stop armStops[] = {
        {arm.clavicle, EBodyPart::Clavicle},
        {arm.upperArm, EBodyPart::UpperArm},
        {arm.forearm,  EBodyPart::Forearm },
        {arm.hand,     EBodyPart::Hand    }
    };
    const Stop legStops[] = {
        {leg.thigh, EBodyPart::Thigh},
        {leg.shin,  EBodyPart::Shin },
        {leg.foot,  EBodyPart::Foot },
        {leg.toe,   EBodyPart::Toe  }
    };
    AddChain(armStops, side);
    AddChain(legStops, side);
    FillShoulder(side);
}

// A joint between the trunk and an upper arm is a clavicle if the body does not name one.
void CRoleFinder::FillShoulder(EBodySide side)
{
    const BodyArm& arm = body_.Arm(side);
    CNode* const trunk = TrunkAbove(arm.upperArm);
    if (!trunk)
        return;
    if (side == EBodySide::Left)
        RoleOf(trunk)->carriesArms = true;
    CNode* next = arm.upperArm;
    for (CNode* joint = next->GetParentNode(); joint != trunk && !arm.clavicle;
         joint = joint->GetParentNode())
    {
        *RoleOf(joint) = {EBodyPart::Clavicle, side, next, false};
        next = joint;
    }
}

std::vector<JointRole> CRoleFinder::Find()
{
    AddTrunk();
    for (const EBodySide side : kBodySides)
        AddLimbs(side);
    return std::move(m_kRoles);
}

} // namespace

std::vector<JointRole> FindRoles(const CTreePoser& tree, const CBodyMap& body)
{
    return CRoleFinder(tree, body).Find();
}

bool IsTrunk(EBodyPart part)
{
    return part == EBodyPart::Hip || part == EBodyPart::Spine || part == EBodyPart::Neck;
}

Vec3 AxisOf(const JointRole& role)
{
    switch (role.part)
    {
    case EBodyPart::Hip:
    case EBodyPart::Spine:
    case EBodyPart::Neck:
    case EBodyPart::Head:
        return kVec3UnitY;
    case EBodyPart::Clavicle:
    case EBodyPart::UpperArm:
    case EBodyPart::Forearm:
    case EBodyPart::Hand:
        return role.side == EBodySide::Left ? kVec3UnitX : -kVec3UnitX;
    case EBodyPart::Thigh:
    case EBodyPart::Shin:
    case EBodyPart::Foot:
    case EBodyPart::Toe:
        return -kVec3UnitY;
    default:
        return kVec3Zero;
    }
}

} // namespace gw
