// A row's offset O is multiplied from the left to the source bone's rotation S: the target bone's rotation is
// O · S. So O must take the target bone's direction to the source bone's direction in its own space, which
// any pose shows. The twist about the bone remains free. It is chosen in a pose in which the source stands:
// there the target is placed in its own rest pose, facing where the source faces, and each bone swings to its
// direction by the smallest rotation.

#include "CRowTurner.h"

#include "Angles.h"
#include "BoneOffset.h"
#include "Directions.h"
#include "Euler.h"

#include <cmath>

namespace gw {

namespace {

// Which matrix element is the sine depends on the bone's share type: 2 for arms in default maps, 1 without a
// share file and for all other bones.
bool IsSineOne(const Mat3& local, const HostRow& host)
{
    constexpr float kOne = 0.999998f; // within a tenth of a degree
    const bool isArm = host.joint >= EBodyJoint::Clavicle && host.joint <= EBodyJoint::Hand;
    return std::fabs(local.m[3]) > kOne || (isArm && std::fabs(local.m[6]) > kOne);
}

// Returns whether a file's Euler angles reproduce a rotation.
bool IsGivenBack(const Mat3& rotation)
{
    constexpr float kSame = 0.9999f; // cosine of four fifths of a degree
    const Mat3 read = EulerToMat3("ZYX", Mat3ToEulerDegrees(rotation));
    return Vec3Dot(read.Row(0), rotation.Row(0)) > kSame && Vec3Dot(read.Row(1), rotation.Row(1)) > kSame;
}

} // namespace

CRowTurner::CRowTurner(const CJointTree& tree, const CSourcePoses& poses, const CTargetBones& target,
                       const RowJoints& joints)
    : tree_(tree), poses_(poses), target_(target), joints_(joints), m_uiReference(poses.Reference()),
      m_kFacing(poses.Facing(m_uiReference))
{
    for (size_t row = 0; row < kHostRowCount; ++row)
    {
        if (joints_[row] != CJointTree::kNone && kHostRows[row].aim != EHostAim::None)
            Turn(row);
    }
    // A nudged bone can end up at a pole itself, so its parents are checked after it.
    for (size_t row = kHostRowCount; row-- > 0;)
    {
        if (joints_[row] != CJointTree::kNone)
            KeepOffPoles(row);
    }
}

Vec3 CRowTurner::Axis(size_t row) const
{
    const HostRow& host = kHostRows[row];
    return host.aim == EHostAim::Child ? target_.ChildAxis(host.target) : kVec3UnitY;
}

// Returns the joint that gives a source bone its direction, or kNone.
int CRowTurner::AimOf(size_t row) const
{
    const HostRow& host = kHostRows[row];
    if (host.aim == EHostAim::Child)
        return poses_.JointBelow(joints_[row], CJointTree::kNone);
    const size_t last = row + static_cast<size_t>(host.next);
    for (size_t next = row + 1; host.aim == EHostAim::Next && next <= last; ++next)
    {
        if (joints_[next] != CJointTree::kNone)
            return poses_.JointBelow(joints_[row], joints_[next]);
    }
    return CJointTree::kNone;
}

// Returns where a source bone points at rest, in its own space.
Vec3 CRowTurner::RestAim(size_t row, int aim) const
{
    const int joint = joints_[row];
    return Turned(poses_.Direction(0, joint, aim), Mat3Transpose(poses_.BoneTurn(0, joint)));
}

// Returns where a bone should point in the reference pose; nothing if it keeps its rest direction.
std::optional<Vec3> CRowTurner::ReferenceDirection(size_t row, int aim) const
{
    const int joint = joints_[row];
    if (aim != CJointTree::kNone)
        return poses_.Direction(m_uiReference, joint, aim);
    if (kHostRows[row].aim != EHostAim::Hand)
        return std::nullopt;
    Vec3 knuckles = kVec3Zero;
    for (const int child : tree_.Children(joint))
        knuckles = knuckles + poses_.Direction(m_uiReference, joint, child);
    const bool known = Vec3Length(knuckles) > 0.0;
    return known ? Vec3Normalized(knuckles) : ReferenceDirection(row - 1, AimOf(row - 1));
}

void CRowTurner::Turn(size_t row)
{
    const int aim = AimOf(row);
    const Vec3 axis = Axis(row);
    Mat3 turn = target_.RestTurn(kHostRows[row].target) * m_kFacing;
    if (const std::optional<Vec3> direction = ReferenceDirection(row, aim))
        turn = turn * LeastSwing(Turned(axis, turn), *direction);
    Mat3 offset = turn * Mat3Transpose(poses_.BoneTurn(m_uiReference, joints_[row]));
    // A joint in between can rotate and move the aim; the rest pose decides.
    if (aim != CJointTree::kNone)
        offset = offset * LeastSwing(Turned(axis, offset), RestAim(row, aim));
    m_kNumbers[row] = NearestOffset(offset, axis);
}

std::optional<double> CRowTurner::RestError(size_t row) const
{
    const int aim = joints_[row] == CJointTree::kNone ? CJointTree::kNone : AimOf(row);
    if (aim == CJointTree::kNone)
        return std::nullopt;
    return AngleBetween(Turned(Axis(row), OffsetOf(m_kNumbers[row])), RestAim(row, aim));
}

// Returns whether a child's rotation relative to its parent gets lost: a conversion cannot decompose it
// before the offset (see CPoseMatcher), or the Euler angles in the result do not reproduce it after the
// offset. Both happen if the sine of a middle angle is 1, and bones that are stiff in the source would stay
// there permanently.
bool CRowTurner::IsAtPole(size_t row, const RowNumbers& numbers, size_t child) const
{
    for (const size_t stance : {size_t{0}, m_uiReference})
    {
        const Mat3 above = OffsetOf(numbers) * poses_.BoneTurn(stance, joints_[row]);
        const Mat3 local = poses_.BoneTurn(stance, joints_[child]) * Mat3Transpose(above);
        if (IsSineOne(local, kHostRows[child]) || !IsGivenBack(OffsetOf(m_kNumbers[child]) * local))
            return true;
    }
    return false;
}

// Same for bones whose parent has no row: the root, and the thighs, whose pelvis bones keep their rest pose.
bool CRowTurner::IsAtPole(size_t row, const RowNumbers& numbers) const
{
    constexpr size_t kHip = 0;
    const bool isThigh = kHostRows[row].joint == EBodyJoint::Thigh && joints_[kHip] != CJointTree::kNone;
    if (row != kHip && !isThigh)
        return false;
    for (const size_t stance : {size_t{0}, m_uiReference})
    {
        const Mat3 world = OffsetOf(numbers) * poses_.BoneTurn(stance, joints_[row]);
        const Mat3 hip = OffsetOf(m_kNumbers[kHip]) * poses_.BoneTurn(stance, joints_[kHip]);
        const Mat3 pelvis = target_.RestTurn(kHostRows[isThigh ? row - 1 : row].target) *
                            Mat3Transpose(target_.RestTurn(kHostRows[kHip].target));
        if (!IsGivenBack(isThigh ? world * Mat3Transpose(pelvis * hip) : world))
            return true;
    }
    return false;
}

bool CRowTurner::IsNearPole(size_t row, const RowNumbers& numbers) const
{
    if (IsAtPole(row, numbers))
        return true;
    for (size_t child = row + 1; child < kHostRowCount; ++child)
    {
        const HostRow& host = kHostRows[child];
        const bool isChild = host.parent == static_cast<int>(child - row);
        if (isChild && joints_[child] != CJointTree::kNone && IsAtPole(row, numbers, child))
            return true;
    }
    return false;
}

// Nudges a bone's twist if it or a bone below would be at a pole.
void CRowTurner::KeepOffPoles(size_t row)
{
    constexpr float kNudges[] = {2.0f, -2.0f, 4.0f, -4.0f}; // degrees
    if (!IsNearPole(row, m_kNumbers[row]))
        return;
    const Vec3 axis = Axis(row);
    for (const float nudge : kNudges)
    {
        const Mat3 turn = Mat3FromAxisAngle(axis, nudge * kDegreesToRadians);
        const RowNumbers numbers = NearestOffset(turn * OffsetOf(m_kNumbers[row]), axis);
        if (IsNearPole(row, numbers))
            continue;
        m_kNumbers[row] = numbers;
        m_kNudged[row] = true;
        return;
    }
}

} // namespace gw
