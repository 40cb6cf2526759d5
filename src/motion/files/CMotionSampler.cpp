#include "CMotionSampler.h"

#include "CKeyframeControl.h"
#include "CNode.h"
#include "Skeleton.h"

namespace gw {

namespace {

// Returns whether a control poses a node by its own keys and nothing else.
bool StandsAlone(const CControl& control, const CNode& node)
{
    const auto* track = dynamic_cast<const CKeyframeControl*>(&control);
    return track && track->m_uiParentMask == 0 && track->GetTarget() == &node && !track->GetNext();
}

} // namespace

CMotionSampler::CMotionSampler(CNode& root)
    : root_(root), m_kNodes(NodesOf(root)), m_kTracks(m_kNodes.size()), m_bPosesNodes(FindTracks())
{
}

// Other controls could pose a node as well, so there must not be any.
bool CMotionSampler::FindTracks()
{
    std::vector<CObject*> controls;
    root_.FindObjects(controls, nullptr, &CControl::ms_kRTTI, true);
    size_t trackCount = 0;
    for (size_t i = 0; i < m_kNodes.size(); ++i)
    {
        CControl* const control = m_kNodes[i]->GetControl();
        if (!control)
            continue;
        if (!StandsAlone(*control, *m_kNodes[i]))
            return false;
        m_kTracks[i] = static_cast<CKeyframeControl*>(control);
        ++trackCount;
    }
    return trackCount == controls.size();
}

void CMotionSampler::PoseNode(size_t index, float time)
{
    if (m_kTracks[index])
        m_kTracks[index]->UpdateTransform(time);
}

void CMotionSampler::PoseTree(float time)
{
    if (!m_bPosesNodes)
        return root_.UpdateScene(time, true);
    for (size_t i = 0; i < m_kNodes.size(); ++i)
        PoseNode(i, time);
}

float TimeOfFrame(int i, float frequency, float frameScale)
{
    // Rounded once, so that a whole frame's position maps back to exactly that frame (CControl::MapTime).
    return static_cast<float>(i / (static_cast<double>(frequency) * static_cast<double>(frameScale)));
}

} // namespace gw
