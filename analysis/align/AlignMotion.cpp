// A joint's new local pose can be computed from the old one without its world matrix: with A the joint's own
// rotation and P its parent's, the rotation L becomes inverse(A) · L · P and the translation t becomes t · P.
// So a bone's length stays exact, however deep it is in the tree. A BVH contains rotations only; if a file
// scales bones, the scale is applied to the translations below.

#include "AlignMotion.h"

#include "BodyTree.h"
#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CKeyframeControl.h"
#include "CMotionSampler.h"
#include "Directions.h"
#include "MotionNode.h"
#include "TKBVHStream.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

// The part of a bone's length by which a position can differ from the rest pose's and still count as equal,
// or by which it can repeat an offset with other digits.
constexpr double kSamePosition = 1e-6;
constexpr double kSameRepeated = 0.01;

Vec3 Scaled(const Vec3& v, const Vec3& scale)
{
    return {v.x * scale.x, v.y * scale.y, v.z * scale.z};
}

// The first three rows of a transform: unit vectors and their lengths.
struct UnitRows
{
    Mat3 rotation;
    Vec3 lengths;
};

// Returns NormalizedRows and RowLengths, but measures each row only once.
UnitRows UnitRowsOf(const Mat4& m)
{
    const double lengths[] = {Vec3Length(m.Row(0)), Vec3Length(m.Row(1)), Vec3Length(m.Row(2))};
    UnitRows rows{
        {                              },
        { static_cast<float>(lengths[0]), static_cast<float>(lengths[1]), static_cast<float>(lengths[2])}
    };
    for (int row = 0; row < 3; ++row)
        rows.rotation.SetRow(row, Vec3DividedBy(m.Row(row), lengths[row]));
    return rows;
}

class CMotionAligner
{
public:
    CMotionAligner(const BodyMotion& motion, const Alignment& alignment, EAlignedJoints joints)
        : motion_(motion), alignment_(alignment), m_eJoints(joints),
          m_kScales(alignment.joints.size(), kVec3One)
    {
    }
    AlignedMotion Align();

private:
    const Mat3& ParentTurn(const JointAlignment& joint) const
    {
        return joint.parent < 0 ? alignment_.worldTurn : Turns(joint.parent);
    }
    bool Moves(const JointAlignment& joint) const
    {
        return joint.bearsBody || m_eJoints == EAlignedJoints::All;
    }
    const Mat3& Turns(int joint) const { return alignment_.joints[static_cast<size_t>(joint)].turn; }
    void AddJoint(const JointAlignment& joint);
    CKeyframeControl& AddTrack(CNode& node);
    void AddBone(const JointAlignment& joint, CNode& node);
    void AddKey(size_t index, int frame);

    const BodyMotion& motion_;
    const Alignment& alignment_;
    EAlignedJoints m_eJoints;
    AlignedMotion m_kResult;
    std::vector<CKeyframeControl*> m_kTracks; // null if a joint does not move
    std::vector<Vec3> m_kScales;              // world scale of each joint at the frame
    std::vector<Mat3> m_kBackTurns;           // the inverse of each joint's turn
};

void CMotionAligner::AddJoint(const JointAlignment& joint)
{
    CNode* node = nullptr;
    if (joint.parent < 0)
        m_kResult.root = node = new CNode;
    else
        node = &AttachNode(*m_kResult.joints[static_cast<size_t>(joint.parent)]);
    node->SetName(joint.node->GetName());
    m_kResult.joints.push_back(node);
    const Vec3 offset = Turned(joint.restOffset, ParentTurn(joint));
    node->m_kMatrix.SetTranslation(offset);
    AddBone(joint, *node);
    m_kTracks.push_back(Moves(joint) ? &AddTrack(*node) : nullptr);
    m_kBackTurns.push_back(Mat3Transpose(joint.turn));
}

CKeyframeControl& CMotionAligner::AddTrack(CNode& node)
{
    CKeyframeControl& track = AttachTrack(node, motion_.frameCount, motion_.frequency, node.m_kMatrix);
    track.m_kRotationKeys.reserve(track.m_kKeyTimes.size());
    return track;
}

void CMotionAligner::AddBone(const JointAlignment& joint, CNode& node)
{
    CBoneMesh* const old = FindBoneMesh(*joint.node);
    if (!old)
        return;
    const size_t children = ChildNodes(*joint.node).size();
    const Vec3 end = Turned(NodeBoneEnd(*joint.node), joint.turn);
    const EBoneMeshes meshes = old->XYZBuffer().empty() ? EBoneMeshes::Empty : EBoneMeshes::Drawn;
    CBoneMesh& mesh = AttachBone(node, std::string(node.NameView()), children, old->m_fLength, meshes);
    mesh.m_kEnd = children == 0 || old->m_kEnd != kVec3Zero ? end : kVec3Zero;
    if (joint.axis != kVec3Zero)
        mesh.m_kMatrix = Mat4Compose(BoneTurn(joint.axis), kVec3Zero);
}

void CMotionAligner::AddKey(size_t index, int frame)
{
    const JointAlignment& joint = alignment_.joints[index];
    const Mat4& local = joint.node->m_kMatrix;
    const Mat3& parentTurn = ParentTurn(joint);
    const UnitRows rows = UnitRowsOf(local);
    CKeyframeControl& track = *m_kTracks[index];
    track.m_kRotationKeys.push_back(QuatFromMat3(m_kBackTurns[index] * rows.rotation * parentTurn));

    const Vec3 above = joint.parent < 0 ? kVec3One : m_kScales[static_cast<size_t>(joint.parent)];
    m_kScales[index] = Scaled(above, rows.lengths);
    const Vec3 once = joint.tellOnce ? joint.restOffset : kVec3Zero;
    const Vec3 position = Turned(Scaled(local.Translation() - once, above), parentTurn);
    CKeyArray<Vec3>& keys = track.m_kPositionKeys;
    const Vec3 still = keys.empty() ? track.m_kRestMatrix.Translation() : keys.front();
    const double same = (joint.tellOnce ? kSameRepeated : kSamePosition) * Vec3Length(still);
    const bool isStill = keys.size() <= 1 && Vec3Length(position - still) <= same;
    if (isStill && !keys.empty())
        return; // the last key repeats for missing ones
    if (keys.size() == 1 && frame > 1)
        keys.assign(static_cast<size_t>(frame), Vec3(keys.front()));
    keys.push_back(isStill ? still : position);
}

AlignedMotion CMotionAligner::Align()
{
    for (const JointAlignment& joint : alignment_.joints)
        AddJoint(joint);
    CMotionSampler sampler(*motion_.root);
    for (int frame = 0; frame < motion_.frameCount; ++frame)
    {
        const float time = TimeOfFrame(frame, motion_.frequency);
        if (!sampler.PosesNodes())
            sampler.PoseTree(time);
        for (size_t index = 0; index < m_kTracks.size(); ++index)
        {
            if (!m_kTracks[index])
                continue;
            if (sampler.PosesNodes())
                sampler.PoseNode(index, time);
            AddKey(index, frame);
        }
    }
    motion_.root->UpdateScene(0.0f, true);
    m_kResult.root->UpdateScene(0.0f, true);
    return std::move(m_kResult);
}

} // namespace

AlignedMotion AlignMotion(const BodyMotion& motion, const Alignment& alignment, EAlignedJoints joints)
{
    return CMotionAligner(motion, alignment, joints).Align();
}

} // namespace gw
