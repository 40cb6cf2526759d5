#include "CMadeFigure.h"

#include "Angles.h"
#include "BodyTree.h"
#include "CBoneMesh.h"
#include "CKeyframeControl.h"
#include "MotionNode.h"
#include "Skeleton.h"
#include "TKBVHStream.h"

#include <algorithm>

namespace gw {
namespace {

constexpr MadeBone kPerson[] = {
    {"LowerTorso", "", {0.0f, 900.0f, 0.0f}},
    {"LThigh", "LowerTorso", {100.0f, 0.0f, 0.0f}},
    {"LCalf", "LThigh", {0.0f, -400.0f, 0.0f}},
    {"LFoot", "LCalf", {0.0f, -400.0f, 0.0f}},
    {"LToe", "LFoot", {0.0f, -70.0f, 150.0f}},
    {"RThigh", "LowerTorso", {-100.0f, 0.0f, 0.0f}},
    {"RCalf", "RThigh", {0.0f, -400.0f, 0.0f}},
    {"RFoot", "RCalf", {0.0f, -400.0f, 0.0f}},
    {"RToe", "RFoot", {0.0f, -70.0f, 150.0f}},
    {"UpperTorso", "LowerTorso", {0.0f, 300.0f, 0.0f}},
    {"LUpperArm", "UpperTorso", {180.0f, 200.0f, 0.0f}},
    {"LForearm", "LUpperArm", {280.0f, 0.0f, 0.0f}},
    {"LHand", "LForearm", {250.0f, 0.0f, 0.0f}},
    {"RUpperArm", "UpperTorso", {-180.0f, 200.0f, 0.0f}},
    {"Neck", "UpperTorso", {0.0f, 250.0f, 0.0f}},
    {"Head", "Neck", {0.0f, 90.0f, 0.0f}},
};

CKeyframeControl& TrackOf(const CNode& node)
{
    return *static_cast<CKeyframeControl*>(node.GetControl());
}

void AppendKey(const CNode& node, int frame)
{
    CKeyframeControl& track = TrackOf(node);
    track.m_kKeyTimes.push_back(static_cast<float>(frame));
    track.m_kRotationKeys.push_back(QuatFromMat3(NormalizedRows(node.m_kMatrix)));
    track.m_kPositionKeys.push_back(node.m_kMatrix.Translation());
    track.m_kScaleKeys.push_back(kVec3One);
}

} // namespace

CMadeFigure::CMadeFigure(double unit) : CMadeFigure(kPerson, unit) {}

CMadeFigure::CMadeFigure(std::span<const MadeBone> bones, double unit) : m_fUnit(static_cast<float>(unit))
{
    for (const auto& [name, parent, offset, degreesZ] : bones)
        AddBone(name, parent, offset, degreesZ);
}

bool CMadeFigure::HasBone(const std::string& name) const
{
    return FindNode(m_spkRoot.Get(), name.c_str());
}

CNode& CMadeFigure::Bone(const std::string& name) const
{
    return *FindNode(m_spkRoot.Get(), name.c_str());
}

CNode& CMadeFigure::AddBone(const std::string& name, const std::string& parent, const Vec3& offset,
                            double degreesZ)
{
    CNode* bone = nullptr;
    if (parent.empty())
        m_spkRoot = bone = new CNode;
    else
        bone = &AttachNode(Bone(parent));
    bone->SetName(name.c_str());
    const auto radians = static_cast<float>(degreesZ * kDegreesToRadians64);
    bone->m_kMatrix = Mat4Compose(Mat3FromAxisAngle(kVec3UnitZ, radians), offset * m_fUnit);
    return *bone;
}

void CMadeFigure::AddMesh(const std::string& name, const Vec3& end)
{
    CNode& bone = Bone(name);
    std::vector<Vec3> ends;
    for (const CNode* child : ChildNodes(bone))
        ends.push_back(child->m_kMatrix.Translation());
    const bool isLast = ends.empty();
    if (isLast)
        ends.push_back(end * m_fUnit);
    const double length = Vec3Length(*std::ranges::max_element(ends, {}, Vec3Length));
    CBoneMesh& mesh = AttachBone(bone, name, ends.size(), static_cast<float>(length));
    mesh.m_kEnd = isLast ? ends[0] : kVec3Zero;
    if (ends.size() == 1)
        mesh.m_kMatrix = Mat4Compose(BoneTurn(ends[0]), kVec3Zero);
}

void CMadeFigure::Remove(const std::string& name)
{
    CNode& bone = Bone(name);
    bone.GetParentNode()->DetachChild(&bone);
}

void CMadeFigure::Turn(const std::string& name, const Vec3& axis, double degrees)
{
    Mat4& matrix = Bone(name).m_kMatrix;
    const Mat3 turn = Mat3FromAxisAngle(axis, static_cast<float>(degrees * kDegreesToRadians64));
    matrix = Mat4Compose(NormalizedRows(matrix) * turn, matrix.Translation());
}

void CMadeFigure::Move(const std::string& name, const Vec3& offset)
{
    Mat4& matrix = Bone(name).m_kMatrix;
    matrix.SetTranslation(matrix.Translation() + offset * m_fUnit);
}

CMadeFigure::Recorded
CMadeFigure::Record(int frameCount, const std::function<void(CMadeFigure&, int frame)>& pose, float frequency)
{
    const std::vector<CNode*> bones = NodesOf(*m_spkRoot);
    for (CNode* bone : bones)
    {
        if (!bone->GetControl())
            AttachTrack(*bone, 0, frequency, bone->m_kMatrix);
    }
    for (int frame = 0; frame < frameCount; ++frame)
    {
        for (CNode* bone : bones)
            bone->m_kMatrix = TrackOf(*bone).m_kRestMatrix;
        pose(*this, frame);
        for (const CNode* bone : bones)
            AppendKey(*bone, frame);
    }
    for (const CNode* bone : bones)
        TrackOf(*bone).m_fEndTime = static_cast<float>(frameCount - 1);
    return {m_spkRoot.Get(), frequency, frameCount};
}

} // namespace gw
