#include "CReferencePose.h"

#include "BodyPose.h"
#include "BoneMeshQueries.h"
#include "Turns.h"

namespace gw {

namespace {

CNode* FirstChild(const CNode& node)
{
    for (size_t i = 0; i < node.GetChildCount(); ++i)
    {
        if (CNode* child = RecordCast<CNode>(node.ChildAt(i)))
            return child;
    }
    return nullptr;
}

} // namespace

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
    for (const CNode* below = FirstChild(joint); below; below = FirstChild(*below))
    {
        if (Vec3Length(PlaceOf(*below) - from) > apart)
            return PlaceOf(*below) - from;
        last = below;
    }
    const Vec3 end = NodeBoneEnd(*last);
    return end == kVec3Zero ? kVec3Zero : TransformCoord(end, last->m_kWorldMatrix) - from;
}

} // namespace gw
