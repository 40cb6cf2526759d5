#include "CPoseSampler.h"

#include "CKeyframeControl.h"

#include <cmath>

namespace gw {

const CKeyframeControl* TrackOf(const CNode& node)
{
    for (CControl* control = node.GetControl(); control; control = control->GetNext())
    {
        if (const CKeyframeControl* track = RecordCast<CKeyframeControl>(control))
            return track;
    }
    return nullptr;
}

const Mat4& RestLocal(const CNode& node)
{
    for (CControl* control = node.GetControl(); control; control = control->GetNext())
    {
        const CKeyframeControl* track = RecordCast<CKeyframeControl>(control);
        if (track && track->m_bHasRestMatrix)
            return track->m_kRestMatrix;
    }
    return node.m_kMatrix;
}

bool IsFrameTime(float frequency)
{
    return std::isfinite(frequency) && frequency > 0.0f;
}

float TimeOfPose(double frame, float frequency)
{
    return static_cast<float>(frame / (IsFrameTime(frequency) ? static_cast<double>(frequency) : 1.0));
}

void CPoseSampler::Watch(CNode* node)
{
    if (!node || !m_kWatched.insert(node).second)
        return;
    Watch(node->GetParentNode());
    m_kNodes.push_back(node);
}

void CPoseSampler::Pose(double frame)
{
    const float time = TimeOfPose(frame, m_fFrequency);
    for (CNode* node : m_kNodes)
        node->CSpatial::UpdateTransform(time); // this node alone: UpdateScene would continue to its children
}

Mat4 RestWorld(const CNode& node)
{
    Mat4 world = RestLocal(node);
    for (const CNode* parent = node.GetParentNode(); parent; parent = parent->GetParentNode())
        world = world * RestLocal(*parent);
    return world;
}

} // namespace gw
