#include "CSourceMotion.h"

#include "AttachBoneMeshes.h"
#include "EditMotion.h"
#include "Paths.h"

namespace gw {

CSourceMotion::CSourceMotion()
{
    m_kMotion.boneMeshes = EBoneMeshes::Empty; // a source is not shown
}

void CSourceMotion::Select(const std::string& clip, float rate)
{
    m_kMotion.importChoice = {clip, rate};
    m_fRate = rate;
}

bool CSourceMotion::Load(const std::string& path)
{
    m_bScene = HasExtension(path, kSceneExtension);
    const bool isLoaded =
        m_bScene ? LoadSourceScene(path, m_kScene, m_kRecord, {}, m_ePictures) : m_kMotion.Load(path);
    if (!m_bScene)
        m_kRecord = m_kMotion.Record();
    else if (isLoaded)
        AttachBoneMeshes(Root()); // as for motion files, because bone meshes define the bones' directions
    if (isLoaded && m_fRate > 0.0f)
        SetFrameTime(*Root(), 1.0f / m_fRate);
    return isLoaded;
}

CNode* CSourceMotion::Root() const
{
    return m_bScene ? FirstNode(m_kScene.GetRoot(0)) : m_kMotion.motionRoot.Get();
}

SourceTiming CSourceMotion::Timing() const
{
    return m_bScene ? TimingOf(ConversionTrack(Root())) : TimingOf(m_kMotion);
}

} // namespace gw
