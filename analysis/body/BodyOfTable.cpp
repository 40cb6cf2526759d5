#include "BodyOfTable.h"

#include "BodyTree.h"
#include "CRetargeter.h"
#include "HostBones.h"
#include "Skeleton.h"

namespace gw {

namespace {

CNode* OnlyChild(const CNode* node)
{
    const std::vector<CNode*> children = node ? ChildNodes(*node) : std::vector<CNode*>();
    return children.size() == 1 ? children.front() : nullptr;
}

} // namespace

CBodyMap BodyOfTable(const CRetargeter& table, const CNodeNames& targets)
{
    const auto source = [&](const char* target) { return table.SourceOf(targets.Find(target)); };
    CBodyMap body;
    body.hip = source(kRootBone);
    body.head = source(kHeadBone);
    CNode* const neck = source(kNeckBone);
    body.spine = NodesBetween(body.hip, neck ? neck : body.head);
    if (neck)
    {
        body.neck = NodesBetween(neck, body.head);
        body.neck.insert(body.neck.begin(), neck);
    }
    for (const EBodySide side : kBodySides)
    {
        const HostSide& names = kHostSides[static_cast<size_t>(side)];
        body.Arm(side) = {source(names.collar), source(names.upperArm), source(names.forearm),
                          source(names.hand)};
        body.Leg(side) = {source(names.thigh), source(names.calf), source(names.foot), source(names.toe)};
        if (!body.Leg(side).toe)
            body.Leg(side).toe = OnlyChild(body.Leg(side).foot);
    }
    return body;
}

} // namespace gw
