// Samples the rest pose and up to 16 frames at equal distances, fewer for very large skeletons, so that
// memory is bounded. Joints are posed in place and restored afterwards.

#include "CStances.h"

#include "BoneMeshQueries.h"
#include "CKeyframeControl.h"
#include "CPoseSampler.h"
#include "Skeleton.h"

#include <algorithm>

namespace gw {

namespace {

constexpr size_t kMostFrames = 16;
constexpr size_t kMostPlaces = size_t{1} << 19; // of all frames together: 34 MB

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

// Restores the pose of a node.
class CPoseKeeper
{
public:
    explicit CPoseKeeper(CNode& node) : node_(node), m_kLocal(node.m_kMatrix), m_kWorld(node.m_kWorldMatrix)
    {
    }
    CPoseKeeper(const CPoseKeeper&) = delete;
    CPoseKeeper& operator=(const CPoseKeeper&) = delete;
    ~CPoseKeeper()
    {
        node_.m_kMatrix = m_kLocal;
        node_.m_kWorldMatrix = m_kWorld;
    }

private:
    CNode& node_;
    Mat4 m_kLocal;
    Mat4 m_kWorld;
};

// Returns the ends of the bones that have no joint after them. Some programs write an end of a fixed length,
// such as 1 in a file in meters: one that is much longer than every other bone is left out.
std::vector<Vec3> TipsOf(const std::vector<CNode*>& joints)
{
    constexpr double kMostTip = 1.5; // longest bones
    double longest = 0.0;
    for (size_t i = 1; i < joints.size(); ++i)
        longest = std::max<double>(longest, Vec3Length(RestLocal(*joints[i]).Translation()));
    std::vector<Vec3> tips;
    tips.reserve(joints.size());
    for (const CNode* joint : joints)
    {
        const Vec3 tip = joint->HasNoNodeChild() ? NodeBoneEnd(*joint) : kVec3Zero;
        tips.push_back(longest > 0.0 && Vec3Length(tip) > kMostTip * longest ? kVec3Zero : tip);
    }
    return tips;
}

} // namespace

CStances::CStances(CNode& root) : m_kJoints(NodesOf(root)), m_kInFrames(m_kJoints.size())
{
    m_kLocalTips = TipsOf(m_kJoints);
    m_kRest.reserve(m_kJoints.size());
    for (CNode* joint : m_kJoints)
    {
        const int parent = IndexOf(joint->GetParentNode());
        m_kIndex.emplace(joint, static_cast<int>(m_kRest.size()));
        m_kRest.push_back(parent < 0 ? RestLocal(*joint)
                                     : RestLocal(*joint) * m_kRest[static_cast<size_t>(parent)]);
    }
    const CKeyframeControl* const track = FirstTrack(m_kJoints);
    if (!track)
        return;
    const size_t frames = track->m_kKeyTimes.size();
    const size_t count = std::clamp<size_t>(kMostPlaces / m_kJoints.size(), 1, std::min(frames, kMostFrames));
    for (size_t i = 0; i < count; ++i)
    {
        const size_t frame = i * frames / count;
        m_kTimes.push_back(TimeOfPose(static_cast<double>(frame), track->m_fFrequency));
    }
}

int CStances::IndexOf(const CNode* joint) const
{
    const auto found = m_kIndex.find(joint);
    return found == m_kIndex.end() ? -1 : found->second;
}

const Mat4& CStances::World(size_t stance, int joint) const
{
    const auto index = static_cast<size_t>(joint);
    if (stance == 0)
        return m_kRest[index];
    std::vector<CNode*> waiting; // this joint and its ancestors; a skeleton can be too deep for recursion
    for (int above = joint; above >= 0 && m_kInFrames[static_cast<size_t>(above)].empty();
         above = IndexOf(waiting.back()->GetParentNode()))
        waiting.push_back(m_kJoints[static_cast<size_t>(above)]);
    for (; !waiting.empty(); waiting.pop_back())
        PoseInFrames(*waiting.back());
    return m_kInFrames[index][stance - 1];
}

// Poses a joint alone: its parent is given the world matrices that it has in the frames.
void CStances::PoseInFrames(CNode& node) const
{
    const auto joint = static_cast<size_t>(IndexOf(&node));
    const int above = IndexOf(node.GetParentNode());
    CNode* const parent = above < 0 ? nullptr : node.GetParentNode();
    const CPoseKeeper keeper(node);
    const CPoseKeeper parentKeeper(parent ? *parent : node);
    node.m_kWorldMatrix = m_kRest[joint]; // two controls of one joint leave it as it is
    std::vector<Mat4> worlds;
    worlds.reserve(m_kTimes.size());
    for (size_t frame = 0; frame < m_kTimes.size(); ++frame)
    {
        if (parent)
            parent->m_kWorldMatrix = m_kInFrames[static_cast<size_t>(above)][frame];
        node.CSpatial::UpdateTransform(m_kTimes[frame]);
        worlds.push_back(node.m_kWorldMatrix);
    }
    m_kInFrames[joint] = std::move(worlds);
}

} // namespace gw
