#include "CompleteBody.h"

#include "BodyTree.h"
#include "CPoseSampler.h"

namespace gw {

namespace {

// Returns the child joint that is farthest away at rest: for a forearm, the hand instead of a twist joint.
// Returns null if there is none.
CNode* FarthestChild(const CNode* joint)
{
    CNode* farthest = nullptr;
    double distance = 0.0;
    for (CNode* child : joint ? ChildNodes(*joint) : std::vector<CNode*>())
    {
        const double length = Vec3Length(RestLocal(*child).Translation());
        if (length <= distance)
            continue;
        farthest = child;
        distance = length;
    }
    return farthest;
}

// Fills in the joints from below the hip up to where the arms branch.
void CompleteSpine(CBodyMap& body)
{
    if (!body.spine.empty() || !body.neck.empty() || body.head)
        return;
    for (const BodyArm& arm : body.arms)
    {
        const CNode* const shoulder = arm.clavicle ? arm.clavicle : arm.upperArm;
        if (shoulder != body.hip && IsAtOrBelow(shoulder, body.hip))
        {
            body.spine = NodesBetween(body.hip, shoulder);
            return;
        }
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
