// A joint's new axes come from one pose in which every bone's direction in the canonical stance is known. A
// bone is swung there by the smallest angle, starting from its parent's alignment, so that the pose's twist
// about the bone is kept: an arm that hangs with its palm at the thigh becomes one that stretches sideways,
// palm down. If knees and elbows bend enough to show their axes, these show the twist better than any rest
// pose, and overrule one that is far off.

#include "JointTurns.h"

#include "BodyPose.h"
#include "CMotionEvidence.h"
#include "CReferencePose.h"
#include "CTreePoser.h"
#include "Directions.h"
#include "FootTurn.h"
#include "HandTurn.h"

#include <cmath>

namespace gw {

namespace {

// below this, a hip's vector to the spine does not show the pelvis's direction
constexpr double kApartOfHip = 0.04;
// The maximum lean, in degrees, of a hip's vector to the spine that shows the direction of the pelvis. A
// vector to a joint at the small of the back points backward, and the one to a joint farther up leans less.
constexpr double kHipLean = 40.0;
constexpr double kChordLean = 20.0;
// The difference in degrees from which a hinge's axis overrules the pose: less is due to posture and the
// placement of joints.
constexpr double kTwistLimit = 30.0;

class CTurnFinder
{
public:
    CTurnFinder(const CTreePoser& tree, const std::vector<JointRole>& roles, const CBodyMap& body,
                const CReferencePose& pose, const CMotionEvidence& evidence, bool isRest)
        : tree_(tree), roles_(roles), body_(body), pose_(pose), evidence_(evidence), m_bIsRest(isRest),
          m_kSwings(roles.size()), m_kTurns(roles.size())
    {
    }
    std::vector<Mat3> Find();

private:
    Mat3 WorldTurn(size_t joint) const { return NormalizedRows(tree_.Joints()[joint]->m_kWorldMatrix); }
    Vec3 WayOn(const CNode& from, const CNode* next, double apart) const;
    Vec3 HipWay(size_t joint) const;
    Mat3 StartOf(size_t joint) const;
    Mat3 SwingOf(size_t joint) const;
    Mat3 TrunkSwing(size_t joint) const;
    Mat3 LimbSwing(size_t joint) const;
    Mat3 HingeTwist(size_t joint, const Mat3& swing) const;
    void Set(size_t joint);

    const CTreePoser& tree_;
    const std::vector<JointRole>& roles_;
    const CBodyMap& body_;
    const CReferencePose& pose_;
    const CMotionEvidence& evidence_;
    bool m_bIsRest;
    std::vector<Mat3> m_kSwings; // from the pose's world to the canonical one
    std::vector<Mat3> m_kTurns;
};

// Returns the vector to the next joint of the body that is apart; zero if there is none.
Vec3 CTurnFinder::WayOn(const CNode& from, const CNode* next, double apart) const
{
    if (const std::optional<Vec3> loose = evidence_.MeanWay(from))
        return Turned(*loose, NormalizedRows(from.m_kWorldMatrix));
    while (next && Vec3Length(WayTo(&from, next)) <= apart * pose_.legLength)
        next = roles_[static_cast<size_t>(tree_.IndexOf(next))].next;
    return WayTo(next ? &from : nullptr, next);
}

// Goes up the spine until the vector leans less.
Vec3 CTurnFinder::HipWay(size_t joint) const
{
    const CNode& hip = *tree_.Joints()[joint];
    for (const CNode* next = roles_[joint].next; next;
         next = roles_[static_cast<size_t>(tree_.IndexOf(next))].next)
    {
        const Vec3 way = WayOn(hip, next, kApartOfHip);
        const double limit = next == roles_[joint].next ? kHipLean : kChordLean;
        if (way != kVec3Zero && AngleBetween(way, pose_.up) < limit)
            return way;
    }
    return pose_.up;
}

Mat3 CTurnFinder::TrunkSwing(size_t joint) const
{
    const JointRole& role = roles_[joint];
    if (role.part == EBodyPart::Hip)
        return TurnUpright(HipWay(joint), HipLine(body_));
    const Vec3 way = WayOn(*tree_.Joints()[joint], role.next, kApart);
    if (role.carriesArms && way != kVec3Zero && ShoulderLine(body_) != kVec3Zero)
        return TurnUpright(way, ShoulderLine(body_));
    const Mat3& start = role.part == EBodyPart::Neck ? pose_.trunk : pose_.hips;
    return start * LeastSwing(Turned(way, start), kVec3UnitY);
}

// Returns what a limb's bone is swung from: the bone above if it belongs to the same limb, otherwise the
// trunk. Upper arms do not follow the clavicle's swing, which goes up where theirs goes down.
Mat3 CTurnFinder::StartOf(size_t joint) const
{
    const EBodyPart part = roles_[joint].part;
    const int parent = tree_.ParentOf(joint);
    const EBodyPart above = parent < 0 ? EBodyPart::None : roles_[static_cast<size_t>(parent)].part;
    const bool isRoot =
        part == EBodyPart::Clavicle || part == EBodyPart::UpperArm || part == EBodyPart::Thigh;
    if (above != EBodyPart::None && (above == part || !isRoot))
        return m_kSwings[static_cast<size_t>(parent)];
    return part == EBodyPart::Thigh ? pose_.hips : pose_.trunk;
}

// Returns the twist about the bone that brings a hinge's axis into place: knees bend about +X, a left elbow
// about -Y and a right one about +Y.
Mat3 CTurnFinder::HingeTwist(size_t joint, const Mat3& swing) const
{
    const JointRole& role = roles_[joint];
    const std::optional<Vec3> axis = evidence_.HingeAxis(*tree_.Joints()[joint]);
    if (!axis)
        return kMat3Identity;
    const bool isLeg = role.part == EBodyPart::Thigh || role.part == EBodyPart::Shin;
    const Vec3 elbow = role.side == EBodySide::Left ? -kVec3UnitY : kVec3UnitY;
    const Vec3 bone = AxisOf(role);
    const double twist =
        TwistBetween(Turned(*axis, WorldTurn(joint) * swing), isLeg ? kVec3UnitX : elbow, bone);
    return std::fabs(twist) > kTwistLimit ? TurnAbout(bone, twist) : kMat3Identity;
}

Mat3 CTurnFinder::LimbSwing(size_t joint) const
{
    const JointRole& role = roles_[joint];
    const Mat3 start = StartOf(joint);
    const Vec3 way = WayOn(*tree_.Joints()[joint], role.next, kApart);
    const Mat3 swing = start * LeastSwing(Turned(way, start), way == kVec3Zero ? kVec3Zero : AxisOf(role));
    return swing * HingeTwist(joint, swing);
}

Mat3 CTurnFinder::SwingOf(size_t joint) const
{
    switch (roles_[joint].part)
    {
    case EBodyPart::Hip:
    case EBodyPart::Spine:
    case EBodyPart::Neck:
        return TrunkSwing(joint);
    case EBodyPart::Head:
        return pose_.trunk; // a head that is level and looks ahead, however its neck leans
    case EBodyPart::Hand:
        return HandTurn(*tree_.Joints()[joint], roles_[joint].side, pose_, StartOf(joint));
    case EBodyPart::Clavicle:
    case EBodyPart::UpperArm:
    case EBodyPart::Forearm:
    case EBodyPart::Thigh:
    case EBodyPart::Shin:
        return LimbSwing(joint);
    default:
        return pose_.hips;
    }
}

void CTurnFinder::Set(size_t joint)
{
    const JointRole& role = roles_[joint];
    const int parent = tree_.ParentOf(joint);
    const bool isForefoot = role.part == EBodyPart::Foot || role.part == EBodyPart::Toe;
    Mat3& turn = m_kTurns[joint];
    if (tree_.Joints()[joint] == body_.Leg(role.side).foot)
        turn = FootTurn(body_.Leg(role.side), pose_, evidence_.SoleNormal(role.side), m_bIsRest);
    else if (isForefoot && parent >= 0) // is on the floor like the ankle's bone
        turn = WorldTurn(joint) * Mat3Transpose(WorldTurn(static_cast<size_t>(parent))) *
               m_kTurns[static_cast<size_t>(parent)];
    else if (role.part == EBodyPart::None && parent >= 0)
        turn = NormalizedRows(RestLocal(*tree_.Joints()[joint])) * m_kTurns[static_cast<size_t>(parent)];
    else
        turn = WorldTurn(joint) * SwingOf(joint);
    m_kSwings[joint] = Mat3Transpose(WorldTurn(joint)) * turn;
}

std::vector<Mat3> CTurnFinder::Find()
{
    for (size_t joint = 0; joint < roles_.size(); ++joint)
        Set(joint);
    return std::move(m_kTurns);
}

} // namespace

std::vector<Mat3> FindJointTurns(const CTreePoser& tree, const std::vector<JointRole>& roles,
                                 const CBodyMap& body, const CReferencePose& pose,
                                 const CMotionEvidence& evidence, bool isRest)
{
    return CTurnFinder(tree, roles, body, pose, evidence, isRest).Find();
}

} // namespace gw
