// Selects poses in which a body can be judged. A rest pose that is not a standing pose (bones along one axis,
// arms overhead) says nothing, so frames of the motion replace it.

#include "CBodyPoses.h"

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CKeyframeControl.h"

#include <algorithm>

namespace gw {

namespace {

constexpr size_t kFrameCount = 6;
// In degrees from straight down. Arms stretched overhead in a rest pose come from a file's first frame, not
// from modeling.
constexpr double kArmsUp = 135.0;

bool ShowsBody(const BodyStance& rest)
{
    return rest.Stands() && rest.armsDown && *rest.armsDown < kArmsUp;
}

float FrameTimeOf(const CNode& node)
{
    const CKeyframeControl* const track = TrackOf(node);
    return track ? track->m_fFrequency : 1.0f;
}

Vec3 Middle(const Vec3& a, const Vec3& b)
{
    return (a + b) * 0.5f;
}

} // namespace

CBodyPoses::CBodyPoses(const CBodyMap& body, const BodyStance& rest, CRestWorlds& worlds)
    : body_(body), worlds_(worlds), m_kSampler(FrameTimeOf(*body.Leg(EBodySide::Left).thigh))
{
    if (!ShowsBody(rest))
        PlanFrames();
    for (const EBodySide side : kBodySides)
    {
        Watch(body.Arm(side).upperArm);
        Watch(body.Leg(side).thigh);
    }
}

CBodyPoses::~CBodyPoses()
{
    for (const Kept& kept : m_kKept)
    {
        kept.node->m_kMatrix = kept.local;
        kept.node->m_kWorldMatrix = kept.world;
    }
}

void CBodyPoses::Watch(CNode* node)
{
    if (m_kFrames.empty()) // nothing will be posed
        return;
    m_kSampler.Watch(node);
    for (; node && std::ranges::find(m_kKept, node, &Kept::node) == m_kKept.end();
         node = node->GetParentNode())
        m_kKept.push_back({node, node->m_kMatrix, node->m_kWorldMatrix});
}

void CBodyPoses::PlanFrames()
{
    const CKeyframeControl* const track = TrackOf(*body_.Leg(EBodySide::Left).thigh);
    const size_t count = track ? track->m_kKeyTimes.size() : 0;
    for (size_t i = 0; i < std::min(count, kFrameCount); ++i)
    {
        const size_t frame = i * (count - 1) / std::max<size_t>(kFrameCount - 1, 1);
        m_kFrames.push_back(static_cast<double>(frame));
    }
}

void CBodyPoses::Take(size_t pose)
{
    if (!m_kFrames.empty())
        m_kSampler.Pose(m_kFrames[pose]);
}

Mat4 CBodyPoses::World(const CNode& node) const
{
    return m_kFrames.empty() ? worlds_.Of(node) : node.m_kWorldMatrix;
}

Mat4 CBodyPoses::BoneWorld(const CNode& node) const
{
    const CBoneMesh* const mesh = FindBoneMesh(node);
    return mesh ? mesh->m_kMatrix * World(node) : World(node);
}

Mat3 CBodyPoses::Axes() const
{
    const Vec3 left = Place(*body_.Leg(EBodySide::Left).thigh);
    const Vec3 right = Place(*body_.Leg(EBodySide::Right).thigh);
    const Vec3 arms =
        Middle(Place(*body_.Arm(EBodySide::Left).upperArm), Place(*body_.Arm(EBodySide::Right).upperArm));
    const Vec3 up = Vec3Normalized(arms - Middle(left, right));
    const Vec3 forward = Vec3Normalized(Vec3Cross(left - right, up));
    Mat3 axes;
    axes.SetRow(0, Vec3Cross(up, forward));
    axes.SetRow(1, up);
    axes.SetRow(2, forward);
    return axes;
}

} // namespace gw
