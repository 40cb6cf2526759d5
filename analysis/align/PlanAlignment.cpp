#include "Alignment.h"
#include "BodyPose.h"
#include "BodyStance.h"
#include "CKeyframeControl.h"
#include "CMotionEvidence.h"
#include "CReferencePose.h"
#include "CTreePoser.h"
#include "Directions.h"
#include "DoubledOffsets.h"
#include "JointTurns.h"
#include "RestCorrections.h"
#include "Skeleton.h"
#include "UpAxis.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace gw {

namespace {

bool HasBody(const BodyMotion& motion)
{
    return motion.root && motion.body.hip && TrunkTop(motion.body) &&
           motion.body.Leg(EBodySide::Left).thigh && motion.body.Leg(EBodySide::Right).thigh;
}

void AddUp(const Vec3& up, Corrections& corrections)
{
    if (up != kVec3UnitY)
        corrections.list.push_back(
            {ECorrection::UpAxis, std::string(AxisName(up)), AngleBetween(up, kVec3UnitY)});
}

void AddDoubled(const std::vector<CNode*>& joints, const std::vector<bool>& doubled, Corrections& corrections)
{
    for (size_t i = 0; i < joints.size(); ++i)
    {
        if (doubled[i])
            corrections.list.push_back({ECorrection::DoubledPositions, std::string(joints[i]->NameView())});
    }
}

// Finds the joints of the trunk that coincide with the next joint. For each, the bone goes to the first joint
// farther up that does not coincide with it.
std::vector<LooseWay> FindLooseWays(const CTreePoser& tree, const std::vector<JointRole>& roles, double leg)
{
    const auto isApart = [leg](const CNode* a, const CNode* b) {
        return Vec3Length(WayTo(a, b)) > kApart * leg;
    };
    std::vector<LooseWay> ways;
    for (size_t i = 0; i < roles.size(); ++i)
    {
        CNode* const from = tree.Joints()[i];
        CNode* to = roles[i].next;
        if (!IsTrunk(roles[i].part) || !to || isApart(from, to))
            continue;
        while (to && !isApart(from, to))
            to = roles[static_cast<size_t>(tree.IndexOf(to))].next;
        if (to)
            ways.push_back({from, to});
    }
    return ways;
}

// Returns whether the motion moves a joint to a different direction from its parent than its offset has.
// Checks the first, middle and last key.
bool IsMoved(const CNode& joint)
{
    constexpr double kSameWay = 0.5; // degrees
    const CKeyframeControl* const track = TrackOf(joint);
    const Vec3 rest = RestLocal(joint).Translation();
    if (!track || track->m_kPositionKeys.empty() || rest == kVec3Zero)
        return false;
    const size_t count = track->m_kPositionKeys.size();
    return std::ranges::any_of(std::array{size_t{0}, count / 2, count - 1}, [&](size_t key) {
        const Vec3 place = track->m_kPositionKeys[key];
        return place != kVec3Zero && AngleBetween(place, rest) > kSameWay;
    });
}

// Adds the limbs whose end joint is moved by the motion. Their bones point to that joint's mean position.
void AddMovedLimbs(const CTreePoser& tree, const std::vector<JointRole>& roles, std::vector<LooseWay>& ways)
{
    for (size_t i = 0; i < roles.size(); ++i)
    {
        CNode* const from = tree.Joints()[i];
        CNode* const to = roles[i].next;
        if (IsLimb(roles[i].part) && to && to->GetParentNode() == from && IsMoved(*to))
            ways.push_back({from, to});
    }
}

// Returns a joint's offset at rest. In a file that has all offsets in the motion, it is that of the first
// frame.
Vec3 OffsetOf(const CNode& joint, ELimbWays limbs)
{
    const Vec3 rest = RestLocal(joint).Translation();
    const CKeyframeControl* const track = TrackOf(joint);
    const bool isInMotion = limbs == ELimbWays::Mean && rest == kVec3Zero && joint.GetParentNode() && track &&
                            !track->m_kPositionKeys.empty();
    return isInMotion ? track->m_kPositionKeys.front() : rest;
}

bool IsFinite(const std::vector<Mat3>& turns)
{
    for (const Mat3& turn : turns)
    {
        for (const float element : turn.m)
        {
            if (!std::isfinite(element))
                return false;
        }
    }
    return true;
}

// Marks helper joints that have a joint of the body below them.
void MarkBearers(std::vector<JointAlignment>& joints)
{
    for (auto joint = joints.rbegin(); joint != joints.rend(); ++joint)
    {
        if (joint->bearsBody && joint->parent >= 0)
            joints[static_cast<size_t>(joint->parent)].bearsBody = true;
    }
}

// Plans the alignment of one motion, step by step.
class CAlignmentPlanner
{
public:
    CAlignmentPlanner(const BodyMotion& motion, Alignment& alignment)
        : motion_(motion), alignment_(alignment), m_kTree(NodesOf(*motion.root), motion.frequency),
          m_kRoles(FindRoles(m_kTree, motion.body))
    {
    }
    bool Plan();

private:
    void LookAtRest();
    void FindUp();
    void PoseReference(const CMotionEvidence& evidence);
    void FillJoints(const std::vector<Mat3>& turns, const CReferencePose& pose);

    const BodyMotion& motion_;
    Alignment& alignment_;
    CTreePoser m_kTree;
    std::vector<JointRole> m_kRoles;
    std::vector<LooseWay> m_kWays;
    std::vector<bool> m_kDoubled;
    bool m_bIsRest = false;  // the zero pose shows how the bones are oriented
    Vec3 m_kUp = kVec3UnitY; // up axis of the pose that shows it
};

void CAlignmentPlanner::LookAtRest()
{
    m_kTree.PoseRest();
    const double leg = LegLength(motion_.body);
    alignment_.corrections.list = FindRestCorrections(m_kTree, m_kRoles, leg);
    m_kWays = FindLooseWays(m_kTree, m_kRoles, leg);
    if (motion_.limbs == ELimbWays::Mean)
        AddMovedLimbs(m_kTree, m_kRoles, m_kWays);
    const BodyStance stance = RestStanceOf(motion_.body);
    m_kUp = NearestAxis(stance.up);
    m_bIsRest = stance.IsReference() || motion_.frameCount <= 0;
}

void CAlignmentPlanner::FindUp()
{
    const Vec3 worldUp = FindUpAxis(motion_.body, motion_.frequency, motion_.frameCount);
    m_kUp = m_bIsRest ? m_kUp : worldUp;
    alignment_.worldTurn = LeastSwing(worldUp, kVec3UnitY);
    AddUp(worldUp, alignment_.corrections);
}

void CAlignmentPlanner::PoseReference(const CMotionEvidence& evidence)
{
    if (m_bIsRest)
        m_kTree.PoseRest();
    else
        m_kTree.Pose(alignment_.corrections.referenceFrame = evidence.ReferenceFrame());
}

void CAlignmentPlanner::FillJoints(const std::vector<Mat3>& turns, const CReferencePose& pose)
{
    const auto hip = static_cast<size_t>(m_kTree.IndexOf(motion_.body.hip));
    const Mat3 pelvis = NormalizedRows(motion_.body.hip->m_kWorldMatrix) * pose.hips;
    alignment_.pelvisTurn = Mat3Transpose(pelvis) * turns[hip];
    for (size_t i = 0; i < turns.size(); ++i)
    {
        CNode* const joint = m_kTree.Joints()[i];
        alignment_.joints.push_back({joint, m_kTree.ParentOf(i), turns[i], OffsetOf(*joint, motion_.limbs),
                                     AxisOf(m_kRoles[i]), m_kDoubled[i],
                                     m_kRoles[i].part != EBodyPart::None});
    }
    MarkBearers(alignment_.joints);
}

bool CAlignmentPlanner::Plan()
{
    LookAtRest();
    FindUp();
    m_kDoubled = FindDoubled(m_kTree, motion_);
    AddDoubled(m_kTree.Joints(), m_kDoubled, alignment_.corrections);
    const CMotionEvidence evidence(motion_, alignment_.worldTurn, m_kWays, !m_bIsRest);
    PoseReference(evidence);
    const CReferencePose pose(motion_.body, m_kUp);
    const std::vector<Mat3> turns =
        FindJointTurns(m_kTree, m_kRoles, motion_.body, pose, evidence, m_bIsRest);
    FillJoints(turns, pose);
    motion_.root->UpdateScene(0.0f, true);
    return IsFinite(turns);
}

} // namespace

bool PlanAlignment(const BodyMotion& motion, Alignment& alignment)
{
    alignment = {};
    return HasBody(motion) && CAlignmentPlanner(motion, alignment).Plan();
}

} // namespace gw
