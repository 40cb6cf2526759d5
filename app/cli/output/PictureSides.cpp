#include "PictureSides.h"

#include "FindBody.h"
#include "Skeleton.h"
#include "UpAxis.h"

#include <initializer_list>

namespace gw {

namespace {

void SetBelow(PictureMotion& motion, const CNode* top, EPictureSide side)
{
    if (!top)
        return;
    for (const CNode* node : motion.root ? NodesOf(*motion.root) : std::vector<CNode*>())
    {
        const CNode* above = node;
        while (above && above != top)
            above = above->GetParentNode();
        if (above)
            motion.sides[node] = side;
    }
}

} // namespace

void FindPictureSides(PictureMotion& motion, bool turnsUpright, float secondsPerFrame)
{
    if (!motion.root)
        return;
    const CBodyMap body = FindBody(*motion.root).body;
    for (const EBodySide side : kBodySides)
    {
        const EPictureSide shown = side == EBodySide::Left ? EPictureSide::Left : EPictureSide::Right;
        const BodyArm& arm = body.Arm(side);
        SetBelow(motion, arm.clavicle ? arm.clavicle : arm.upperArm, shown);
        SetBelow(motion, body.Leg(side).thigh, shown);
    }
    motion.leftHip = body.Leg(EBodySide::Left).thigh;
    motion.rightHip = body.Leg(EBodySide::Right).thigh;
    for (const CNode* node = body.hip ? body.hip->GetParentNode() : nullptr; node;
         node = node->GetParentNode())
        motion.sides[node] = EPictureSide::Hidden;
    if (turnsUpright)
        motion.up = FindUpAxis(body, secondsPerFrame, static_cast<int>(motion.lastFrame) + 1);
}

} // namespace gw
