// Samples the rest pose and up to 16 frames at equal distances, fewer for very large skeletons, so that
// memory is bounded. The tree is posed in place and restored afterwards.

#include "CStances.h"

#include "BoneMeshQueries.h"
#include "CKeyframeControl.h"
#include "Skeleton.h"

#include <algorithm>

namespace gw {

namespace {

constexpr size_t kMostFrames = 16;
constexpr size_t kMostPlaces = size_t{1} << 19; // of all frames together: 31 MB with tips and rotations

const CKeyframeControl* FirstTrack(const std::vector<CNode*>& nodes)
{
    for (const CNode* node : nodes)
    {
        const CKeyframeControl* const track = TrackOf(*node);
        if (track && !track->m_kKeyTimes.empty())
            return track;
    }
    return nullptr;
}

// Restores the pose of a tree.
class CPoseKeeper
{
public:
    explicit CPoseKeeper(const std::vector<CNode*>& nodes) : nodes_(nodes)
    {
        for (const CNode* node : nodes)
            m_kMatrices.emplace_back(node->m_kMatrix, node->m_kWorldMatrix);
    }
    CPoseKeeper(const CPoseKeeper&) = delete;
    CPoseKeeper& operator=(const CPoseKeeper&) = delete;
    ~CPoseKeeper()
    {
        for (size_t i = 0; i < nodes_.size(); ++i)
            std::tie(nodes_[i]->m_kMatrix, nodes_[i]->m_kWorldMatrix) = m_kMatrices[i];
    }

private:
    const std::vector<CNode*>& nodes_;
    std::vector<std::pair<Mat4, Mat4>> m_kMatrices;
};

} // namespace

CStances::CStances(CNode& root)
{
    const std::vector<CNode*> joints = NodesOf(root);
    for (const CNode* joint : joints)
        m_kLocalTips.push_back(joint->HasNoNodeChild() ? NodeBoneEnd(*joint) : kVec3Zero);
    const CPoseKeeper keeper(joints);
    const CKeyframeControl* const track = FirstTrack(joints);
    tree_.emplace(joints, track ? track->m_fFrequency : 0.0f);
    tree_->PoseRest();
    AddPose();
    if (!track)
        return;
    const size_t frames = track->m_kKeyTimes.size();
    const size_t count = std::clamp<size_t>(kMostPlaces / joints.size(), 1, std::min(frames, kMostFrames));
    for (size_t i = 0; i < count; ++i)
    {
        tree_->Pose(static_cast<double>(i * frames / count));
        AddPose();
    }
}

void CStances::AddPose()
{
    Places& places = m_kPlaces.emplace_back();
    Places& tips = m_kTips.emplace_back();
    std::vector<Mat3>& axes = m_kAxes.emplace_back();
    places.reserve(Joints().size());
    tips.reserve(Joints().size());
    axes.reserve(Joints().size());
    for (size_t joint = 0; joint < Joints().size(); ++joint)
    {
        const Mat4& world = Joints()[joint]->m_kWorldMatrix;
        places.push_back(world.Translation());
        tips.push_back(TransformCoord(m_kLocalTips[joint], world));
        Mat3& own = axes.emplace_back();
        for (int row = 0; row < 3; ++row)
            own.SetRow(row, world.Row(row));
    }
}

Mat3 CStances::Turn(size_t stance, int joint) const
{
    Mat3 turn = m_kAxes[stance][static_cast<size_t>(joint)];
    for (int row = 0; row < 3; ++row)
        turn.SetRow(row, Vec3Normalized(turn.Row(row)));
    return turn;
}

} // namespace gw
