#include "CStances.h"

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CKeyframeControl.h"
#include "CPoseSampler.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr size_t kMostFrames = 16;
constexpr size_t kMostPlaces = size_t{1} << 19; // of all frames together: 31 MB with tips and turns

const CKeyframeControl* FirstTrack(const std::vector<CNode*>& nodes)
{
    for (const CNode* node : nodes)
    {
        const CKeyframeControl* track = RecordCast<CKeyframeControl>(node->GetControl());
        if (track && !track->m_kKeyTimes.empty())
            return track;
    }
    return nullptr;
}

// Puts the nodes of a tree back to where they were.
class CPoseKeeper
{
public:
    explicit CPoseKeeper(const std::vector<CNode*>& nodes) : m_kNodes(nodes)
    {
        for (const CNode* node : nodes)
            m_kMatrices.emplace_back(node->m_kMatrix, node->m_kWorldMatrix);
    }
    CPoseKeeper(const CPoseKeeper&) = delete;
    CPoseKeeper& operator=(const CPoseKeeper&) = delete;
    ~CPoseKeeper()
    {
        for (size_t i = 0; i < m_kNodes.size(); ++i)
            std::tie(m_kNodes[i]->m_kMatrix, m_kNodes[i]->m_kWorldMatrix) = m_kMatrices[i];
    }

private:
    const std::vector<CNode*>& m_kNodes;
    std::vector<std::pair<Mat4, Mat4>> m_kMatrices;
};

} // namespace

// The matrix of a bone mesh comes from a file's offset by two angles: one in the plane of X and Y, one in
// that of X and Z. Where the offset has an x, both together give it back; else only the signs of y and z are
// left.
Vec3 BoneTip(const CNode& node)
{
    constexpr float kNoPart = 1e-3f;
    const CBoneShapeMesh* mesh = RecordCast<CBoneShapeMesh>(FindBoneMesh(node));
    if (!mesh || !node.HasNoNodeChild())
        return kVec3Zero;
    const Mat4& m = mesh->m_kMatrix;
    const float sine = -m.m[8];
    const float cosine = std::sqrt(std::max(0.0f, 1.0f - sine * sine));
    const Vec3 inXY{cosine > kNoPart ? m.m[4] / cosine : 0.0f, m.m[5], 0.0f};
    const float x = std::fabs(inXY.x);
    Vec3 direction{0.0f, m.m[5], std::fabs(sine) > kNoPart ? sine : 0.0f};
    if (x > kNoPart && cosine > kNoPart)
        direction = {inXY.x / x, inXY.y / x, sine / cosine};
    return Vec3Normalized(direction) * mesh->m_fLength;
}

CStances::CStances(CNode& root) : m_kJoints(NodesOf(root))
{
    for (CNode* joint : m_kJoints)
    {
        m_kIndex.emplace(joint, static_cast<int>(m_kIndex.size()));
        m_kLocalTips.push_back(BoneTip(*joint));
    }
    AddRestPose();
    AddFrames();
}

int CStances::IndexOf(const CNode* joint) const
{
    const auto found = m_kIndex.find(joint);
    return found == m_kIndex.end() ? -1 : found->second;
}

void CStances::BeginPose()
{
    m_kPlaces.emplace_back().reserve(m_kJoints.size());
    m_kTips.emplace_back().reserve(m_kJoints.size());
    m_kTurns.emplace_back().reserve(m_kJoints.size());
}

void CStances::AddJoint(size_t joint, const Mat4& world)
{
    m_kPlaces.back().push_back(world.Translation());
    m_kTips.back().push_back(TransformCoord(m_kLocalTips[joint], world));
    m_kTurns.back().push_back(NormalizedRows(world));
}

void CStances::AddRestPose()
{
    BeginPose();
    std::vector<Mat4> worlds;
    for (size_t i = 0; i < m_kJoints.size(); ++i)
    {
        const int parent = IndexOf(m_kJoints[i]->GetParentNode());
        const Mat4& local = RestLocal(*m_kJoints[i]);
        worlds.push_back(parent < 0 ? local : local * worlds[static_cast<size_t>(parent)]);
        AddJoint(i, worlds.back());
    }
}

void CStances::AddFrames()
{
    const CKeyframeControl* track = FirstTrack(m_kJoints);
    if (!track)
        return;
    const CPoseKeeper keeper(m_kJoints);
    CPoseSampler sampler(track->m_fFrequency);
    for (CNode* joint : m_kJoints)
        sampler.Watch(joint);
    const size_t frames = track->m_kKeyTimes.size();
    const size_t count = std::clamp<size_t>(kMostPlaces / m_kJoints.size(), 1, std::min(frames, kMostFrames));
    for (size_t i = 0; i < count; ++i)
    {
        sampler.Pose(static_cast<double>(i * frames / count));
        BeginPose();
        for (size_t joint = 0; joint < m_kJoints.size(); ++joint)
            AddJoint(joint, m_kJoints[joint]->m_kWorldMatrix);
    }
}

} // namespace gw
