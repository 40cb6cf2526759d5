#include "CMadeFigure.h"

#include "Angles.h"
#include "CKeyframeControl.h"
#include "Skeleton.h"

#include <cmath>
#include <gtest/gtest.h>

namespace gw {

namespace {

struct JointRow
{
    const char* name;
    const char* parent;
    Vec3 offset; // mm
};

constexpr JointRow kJoints[] = {
    {"LThigh",     "LowerTorso", {100.0f, 0.0f, 0.0f}   },
    {"LCalf",      "LThigh",     {0.0f, -400.0f, 0.0f}  },
    {"LFoot",      "LCalf",      {0.0f, -400.0f, 0.0f}  },
    {"LToe",       "LFoot",      {0.0f, -70.0f, 150.0f} },
    {"RThigh",     "LowerTorso", {-100.0f, 0.0f, 0.0f}  },
    {"RCalf",      "RThigh",     {0.0f, -400.0f, 0.0f}  },
    {"RFoot",      "RCalf",      {0.0f, -400.0f, 0.0f}  },
    {"RToe",       "RFoot",      {0.0f, -70.0f, 150.0f} },
    {"UpperTorso", "LowerTorso", {0.0f, 300.0f, 0.0f}   },
    {"LUpperArm",  "UpperTorso", {180.0f, 200.0f, 0.0f} },
    {"LForearm",   "LUpperArm",  {280.0f, 0.0f, 0.0f}   },
    {"LHand",      "LForearm",   {250.0f, 0.0f, 0.0f}   },
    {"RUpperArm",  "UpperTorso", {-180.0f, 200.0f, 0.0f}},
    {"Neck",       "UpperTorso", {0.0f, 250.0f, 0.0f}   },
    {"Head",       "Neck",       {0.0f, 90.0f, 0.0f}    },
};

CKeyframeControl& TrackOf(const CNode& node)
{
    return *static_cast<CKeyframeControl*>(node.GetControl());
}

// A node with a track that holds its rest matrix.
CNode* MakeBone(const std::string& name, const Vec3& offset)
{
    auto* const node = new CNode;
    node->SetName(name.c_str());
    node->m_kMatrix.SetTranslation(offset);
    auto* const track = new CKeyframeControl;
    track->m_kRestMatrix = node->m_kMatrix;
    track->m_bHasRestMatrix = true;
    node->AttachControl(track);
    return node;
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

CMadeFigure::CMadeFigure(double unit) : m_fUnit(static_cast<float>(unit))
{
    m_spkRoot = MakeBone("LowerTorso", Vec3{0.0f, 900.0f, 0.0f} * m_fUnit);
    for (const JointRow& row : kJoints)
        AddBone(row.name, row.parent, row.offset);
}

CNode& CMadeFigure::Bone(const std::string& name) const
{
    return *FindNode(m_spkRoot.Get(), name.c_str());
}

CNode& CMadeFigure::AddBone(const std::string& name, const std::string& parent, const Vec3& offset)
{
    CNode* const bone = MakeBone(name, offset * m_fUnit);
    Bone(parent).AttachChild(bone);
    return *bone;
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

std::vector<CNode*> CMadeFigure::Bones() const
{
    return NodesOf(*m_spkRoot);
}

MotionClip CMadeFigure::Record(int frameCount, const std::function<void(CMadeFigure&, int frame)>& pose,
                               float frequency)
{
    for (int frame = 0; frame < frameCount; ++frame)
    {
        for (CNode* bone : Bones())
            bone->m_kMatrix = TrackOf(*bone).m_kRestMatrix;
        pose(*this, frame);
        for (CNode* bone : Bones())
            AppendKey(*bone, frame);
    }
    for (CNode* bone : Bones())
    {
        TrackOf(*bone).m_fFrequency = frequency;
        TrackOf(*bone).m_fEndTime = static_cast<float>(frameCount - 1);
    }
    return {m_spkRoot.Get(), frequency, frameCount};
}

void ExpectMeasured(double figure, double putIn)
{
    EXPECT_NEAR(figure, putIn, putIn == 0.0 ? 1e-3 : std::fabs(putIn) * 0.01);
}

std::vector<BonePair> PairByName(const CMadeFigure& source, const CMadeFigure& result)
{
    CNode* const sourceRoot = &source.Bone("LowerTorso");
    std::vector<BonePair> pairs;
    for (CNode* target : NodesOf(result.Bone("LowerTorso")))
    {
        if (CNode* bone = FindNode(sourceRoot, target->GetName()))
            pairs.push_back({target, bone});
    }
    return pairs;
}

} // namespace gw
