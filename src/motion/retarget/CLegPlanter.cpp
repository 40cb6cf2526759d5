// Plants feet by inverse kinematics. For each leg, the source's ankle relative to its pelvis, scaled to the
// target, becomes the goal of a closed-form solver (CLimbChain), and the source's knee is the hint for its
// bend. The solver works in its own frame, in which the hinge axis is Y, so goals are converted with
// AxisSwapForward and results are converted back.

#include "CLegPlanter.h"

#include "CFaithfulLeg.h"
#include "CKeyframeControl.h"
#include "HostBones.h"
#include "Skeleton.h"

#include <algorithm>

namespace gw {

namespace {

// Converts the solver's rotations back to the bones' frame. Equivalent to Ry(-z) · Rz(x) · Rx(-y), where x,
// y, z are the rotation's "YXZ" angles, but without computing the angles.
Mat3 LimbToBone(const Mat3& m)
{
    const Vec3 rows[] = {-m.Row(1), -m.Row(2), m.Row(0)};
    Mat3 out;
    for (int row = 0; row < 3; ++row)
        out.SetRow(row, {-rows[row].y, -rows[row].z, rows[row].x});
    return out;
}

size_t Index(int bone)
{
    return static_cast<size_t>(bone);
}

} // namespace

CLegPlanter::CLegPlanter(const CRetargeter& retargeter, CPoseMatcher& matcher, CNode& targetRoot)
    : matcher_(matcher), m_iTorso(matcher.IndexOf(FindNode(&targetRoot, kRootBone))),
      m_pkSourcePelvis(m_iTorso < 0 ? nullptr : retargeter.SourceOf(matcher.Bones()[Index(m_iTorso)].node)),
      m_kSolver(2)
{
    if (!m_pkSourcePelvis)
        return;
    const CNodeNames names(targetRoot);
    for (const HostSide& side : kHostSides)
        Plan(retargeter, names, side);
}

bool CLegPlanter::Plan(const CRetargeter& retargeter, const CNodeNames& names, const HostSide& side)
{
    const auto& bones = matcher_.Bones();
    const int thigh = matcher_.IndexOf(names.Find(side.thigh));
    const int foot = matcher_.IndexOf(names.Find(side.foot));
    const int calf = foot < 0 ? -1 : bones[Index(foot)].parent;
    if (thigh < 0 || calf < 0 || bones[Index(calf)].parent < 0)
        return false;
    const auto offset = [&](int bone) {
        const CNode* node = bones[Index(bone)].node;
        return OffsetRotation(retargeter.OffsetAngles(node), retargeter.OffsetMatrix(node));
    };
    LegRecord leg{Index(thigh),
                  Index(calf),
                  Index(foot),
                  retargeter.SourceOf(bones[Index(foot)].node),
                  retargeter.SourceOf(bones[Index(bones[Index(calf)].parent)].node),
                  offset(thigh),
                  offset(calf),
                  {}};
    if (!leg.sourceFoot)
        return false;
    for (int bone = calf; bone >= 0; bone = bones[Index(bone)].parent)
        leg.path.push_back(Index(bone));
    std::ranges::reverse(leg.path);
    m_kLegs.push_back(std::move(leg));
    return true;
}

void CLegPlanter::LeaveOut(const std::vector<CFaithfulLeg>& legs)
{
    std::erase_if(m_kLegs, [&](const LegRecord& leg) {
        return std::ranges::find(legs, leg.thigh, &CFaithfulLeg::Thigh) != legs.end();
    });
}

void CLegPlanter::Plant(size_t frame, float scale, const std::vector<CKeyframeControl*>& tracks)
{
    for (size_t k = 0; k < m_kLegs.size(); ++k)
        PlantLeg(k, frame, scale, tracks);
}

void CLegPlanter::UpdatePath(const LegRecord& leg)
{
    for (const size_t bone : leg.path)
        matcher_.UpdateWorld(bone);
}

// Returns the length of a bone's translation under its parent's scale along the bone.
double CLegPlanter::SegmentLength(size_t index) const
{
    const CPoseMatcher::Bone& bone = matcher_.Bones()[index];
    const Mat4& parentWorld = matcher_.Bones()[Index(bone.parent)].world;
    return Vec3Length(bone.translation) * Vec3Length(parentWorld.Row(1));
}

// Returns a point in front of the source's thigh, toward which the knee bends.
Vec3 CLegPlanter::HintPoint(const LegRecord& leg) const
{
    if (!leg.sourceThigh)
        return kVec3Zero;
    Vec3 point = leg.sourceThigh->m_kMatrix.Translation();
    point.z += static_cast<float>(Vec3Length(point));
    const CSpatial* parent = leg.sourceThigh->GetParent();
    return parent ? TransformCoord(point, parent->m_kWorldMatrix) : point;
}

// Computes the ankle's goal, and the point toward which the knee bends, relative to the hip in the solver's
// frame.
void CLegPlanter::LegGoal(const LegRecord& leg, float scale, Vec3& goal, Vec3& hint) const
{
    const auto& bones = matcher_.Bones();
    const Vec3 sourcePelvis = m_pkSourcePelvis->m_kWorldMatrix.Translation();
    const Vec3 fromHip = bones[Index(m_iTorso)].world.Translation() - bones[leg.thigh].world.Translation();
    const auto toLimb = [&](const Vec3& point) {
        return TransformCoord(fromHip + (point - sourcePelvis) * scale, AxisSwapForward);
    };
    goal = toLimb(leg.sourceFoot->m_kWorldMatrix.Translation());
    hint = toLimb(HintPoint(leg));
}

void CLegPlanter::PlantLeg(size_t k, size_t frame, float scale, const std::vector<CKeyframeControl*>& tracks)
{
    const LegRecord& leg = m_kLegs[k];
    UpdatePath(leg);
    const auto& bones = matcher_.Bones();
    const CPoseMatcher::Bone& thigh = bones[leg.thigh];
    m_kSolver.SetLimb(k, {0.0f, static_cast<float>(SegmentLength(leg.calf)), 0.0f},
                      {0.0f, static_cast<float>(SegmentLength(leg.foot)), 0.0f}, kVec3UnitZ, kVec3UnitX);

    Vec3 goalPoint;
    Vec3 hint;
    LegGoal(leg, scale, goalPoint, hint);
    Mat4 goal = kMat4Identity;
    goal.SetTranslation(goalPoint);
    CLegSolver::Pose pose;
    if (!m_kSolver.Solve(k, hint, goal, pose))
        return;
    const Mat3 unparent = thigh.parent < 0
                              ? kMat3Identity
                              : Mat3InverseOrIdentity(NormalizedRows(bones[Index(thigh.parent)].world));
    const Mat3 thighRotation = leg.thighOffset * (LimbToBone(pose.hip) * unparent);
    const Mat3 calfRotation = leg.calfOffset * LimbToBone(pose.knee);
    tracks[leg.thigh]->m_kRotationKeys[frame] = QuatFromMat3(thighRotation);
    tracks[leg.calf]->m_kRotationKeys[frame] = QuatFromMat3(calfRotation);
}

} // namespace gw
