#include "CBodyMap.h"

#include "CRetargeter.h"
#include "Skeleton.h"

#include <algorithm>

namespace gw {

namespace {

struct SideNames
{
    const char* clavicle;
    const char* upperArm;
    const char* forearm;
    const char* hand;
    const char* thigh;
    const char* calf;
    const char* foot;
    const char* toe;
};

constexpr SideNames kTargetNames[] = {
    {"LCollar", "LUpperArm", "LForearm", "LHand", "LThigh", "LCalf", "LFoot", "LToe"},
    {"RCollar", "RUpperArm", "RForearm", "RHand", "RThigh", "RCalf", "RFoot", "RToe"},
};

// The joints above one, from below `top` down to the parent of `bottom`; none where `top` is not above it.
std::vector<CNode*> JointsBetween(const CNode* top, const CNode* bottom)
{
    std::vector<CNode*> joints;
    for (CNode* node = bottom ? bottom->GetParentNode() : nullptr; node != top; node = node->GetParentNode())
    {
        if (!node)
            return {};
        joints.push_back(node);
    }
    std::ranges::reverse(joints);
    return joints;
}

CNode* OnlyChild(const CNode* node)
{
    CNode* only = nullptr;
    for (size_t i = 0; node && i < node->GetChildCount(); ++i)
    {
        CNode* const child = RecordCast<CNode>(node->ChildAt(i));
        if (child && only)
            return nullptr;
        only = child ? child : only;
    }
    return only;
}

} // namespace

bool CBodyMap::DrivesBody() const
{
    const auto armIsThere = [](const BodyArm& arm) { return arm.upperArm && arm.forearm && arm.hand; };
    const auto legIsThere = [](const BodyLeg& leg) { return leg.thigh && leg.shin; };
    return hip && !spine.empty() && head && std::ranges::all_of(arms, armIsThere) &&
           std::ranges::all_of(legs, legIsThere);
}

bool CBodyMap::HasFeet() const
{
    return std::ranges::all_of(legs, [](const BodyLeg& leg) { return leg.foot != nullptr; });
}

CBodyMap BodyOfTable(const CRetargeter& table, const CNodeNames& targets)
{
    const auto source = [&](const char* target) { return table.SourceOf(targets.Find(target)); };
    CBodyMap body;
    body.hip = source("LowerTorso");
    body.head = source("Head");
    CNode* const neck = source("Neck");
    body.spine = JointsBetween(body.hip, neck ? neck : body.head);
    if (neck)
    {
        body.neck = JointsBetween(neck, body.head);
        body.neck.insert(body.neck.begin(), neck);
    }
    for (const EBodySide side : kBodySides)
    {
        const SideNames& names = kTargetNames[static_cast<size_t>(side)];
        body.Arm(side) = {source(names.clavicle), source(names.upperArm), source(names.forearm),
                          source(names.hand)};
        body.Leg(side) = {source(names.thigh), source(names.calf), source(names.foot), source(names.toe)};
        if (!body.Leg(side).toe)
            body.Leg(side).toe = OnlyChild(body.Leg(side).foot);
    }
    return body;
}

} // namespace gw
