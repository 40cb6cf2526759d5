#include "RestCorrections.h"

#include "Alignment.h"
#include "BodyPose.h"
#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CReferencePose.h"
#include "CTreePoser.h"
#include "Directions.h"
#include "TKBVHStream.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// In degrees: the largest angle between a limb and its axis, and the largest twist of its frame, that are not
// reported.
constexpr double kOffAxis = 30.0;

// Returns the twist of a bone's frame in degrees, relative to a frame that is only swung away from an axis.
double FrameTwist(const CNode& joint)
{
    CBoneMesh* const mesh = FindBoneMesh(joint);
    if (!mesh || !RecordCast<CBoneShapeMesh>(mesh))
        return 0.0;
    const Mat3 frame = NormalizedRows(mesh->m_kMatrix);
    const Vec3 direction = frame.Row(1);
    const Vec3 axis = NearestAxis(direction);
    return AngleOf(frame * Mat3Transpose(BoneTurn(axis) * LeastSwing(axis, direction)));
}

} // namespace

std::vector<Correction> FindRestCorrections(const CTreePoser& tree, const std::vector<JointRole>& roles,
                                            double legLength)
{
    std::vector<Correction> corrections;
    for (size_t i = 0; i < roles.size(); ++i)
    {
        const CNode& joint = *tree.Joints()[i];
        const Vec3 way = WayTo(roles[i].next ? &joint : nullptr, roles[i].next);
        if (!IsLimb(roles[i].part) || !(Vec3Length(way) > kApart * legLength))
            continue;
        const double off = AngleBetween(way, AxisOf(roles[i]));
        if (off > kOffAxis)
            corrections.push_back({ECorrection::RestPose, std::string(joint.NameView()), off});
        const double twist = FrameTwist(joint);
        if (twist > kOffAxis)
            corrections.push_back({ECorrection::BoneFrames, std::string(joint.NameView()), twist});
    }
    return corrections;
}

} // namespace gw
