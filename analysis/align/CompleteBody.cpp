#include "CompleteBody.h"

#include "CPoseSampler.h"

#include <algorithm>

namespace gw {

namespace {

// The child joint that lies farthest off at rest: the hand of a forearm, beside its twist joints.
CNode* FarthestChild(const CNode* joint)
{
    CNode* farthest = nullptr;
    double distance = 0.0;
    for (size_t i = 0; joint && i < joint->GetChildCount(); ++i)
    {
        CNode* const child = RecordCast<CNode>(joint->ChildAt(i));
        const double length = child ? Vec3Length(RestLocal(*child).Translation()) : 0.0;
        if (length <= distance)
            continue;
        farthest = child;
        distance = length;
    }
    return farthest;
}

// The joints from below the hip up to where the arms part.
void CompleteSpine(CBodyMap& body)
{
    if (!body.spine.empty() || !body.neck.empty() || body.head)
        return;
    std::vector<CNode*> spine;
    for (const BodyArm& arm : body.arms)
    {
        const CNode* const shoulder = arm.clavicle ? arm.clavicle : arm.upperArm;
        for (CNode* joint = shoulder ? shoulder->GetParentNode() : nullptr; joint;
             joint = joint->GetParentNode())
        {
            if (joint == body.hip)
            {
                std::ranges::reverse(spine);
                body.spine = std::move(spine);
                return;
            }
            spine.push_back(joint);
        }
        spine.clear();
    }
}

} // namespace

void CompleteBody(CBodyMap& body)
{
    CompleteSpine(body);
    for (BodyArm& arm : body.arms)
        arm.hand = arm.hand ? arm.hand : FarthestChild(arm.forearm);
    for (BodyLeg& leg : body.legs)
        leg.foot = leg.foot ? leg.foot : FarthestChild(leg.shin);
}

} // namespace gw
