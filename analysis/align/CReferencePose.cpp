#include "CReferencePose.h"

#include "BodyPose.h"
#include "BoneMeshQueries.h"
#include "Directions.h"
#include "JointSteps.h"

namespace gw {

CReferencePose::CReferencePose(const CBodyMap& body, const Vec3& upAxis)
    : up(upAxis), hips(TurnUpright(up, HipLine(body))), trunk(hips), legLength(LegLength(body))
{
    facing = Turned(kVec3UnitZ, Mat3Transpose(hips));
    if (const Vec3 shoulders = ShoulderLine(body); shoulders != kVec3Zero)
        trunk = TurnUpright(up, shoulders);
}

Vec3 ReachOf(const CNode& joint, double apart)
{
    const Vec3 from = PlaceOf(joint);
    const CNode* last = &joint;
    for (const CNode* below = NextBelow(joint, nullptr); below; below = NextBelow(*below, nullptr))
    {
        if (Vec3Length(PlaceOf(*below) - from) > apart)
            return PlaceOf(*below) - from;
        last = below;
    }
    const Vec3 end = NodeBoneEnd(*last);
    return end == kVec3Zero ? kVec3Zero : TransformCoord(end, last->m_kWorldMatrix) - from;
}

} // namespace gw
