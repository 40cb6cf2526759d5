#include "CTriMeshUVWMapControl.h"

#include "CFieldArchive.h"
#include "CTriMeshUVWMap.h"

#include <algorithm>

namespace gw {

const CRTTI CTriMeshUVWMapControl::ms_kRTTI{"CTriMeshUVWMapControl", &CControl::ms_kRTTI};

void CTriMeshUVWMapControl::Fields(CFieldArchive& archive)
{
    CControl::Fields(archive);
    archive.Block("m_kFrames", m_kFrames);
    archive.Block("m_kKeyTimes", m_kKeyTimes);
}

uint64_t CTriMeshUVWMapControl::GetMemoryUsed() const
{
    return CControl::GetMemoryUsed() + 28 + m_kFrames.size() * sizeof(Vec3) +
           m_kKeyTimes.size() * sizeof(float);
}

bool CTriMeshUVWMapControl::Update(float time)
{
    CTriMeshUVWMap* map = RecordCast<CTriMeshUVWMap>(GetTarget());
    if (!m_bActive || !map)
        return false;
    if (!m_kKeyTimes.empty())
        ShowFrame(*map, FindKeys(MapTime(time), m_kKeyTimes, m_uiCursor).a);
    ++map->m_uiChangeStamp;
    return true;
}

// If the frame is missing, the last complete one is shown.
void CTriMeshUVWMapControl::ShowFrame(CTriMeshUVWMap& map, size_t frame) const
{
    const std::span<Vec3> coordinates = map.UVWBuffer();
    const size_t frameCount = coordinates.empty() ? 0 : m_kFrames.size() / coordinates.size();
    if (frameCount == 0)
        return;
    const size_t start = std::min(frame, frameCount - 1) * coordinates.size();
    std::ranges::copy(std::span(m_kFrames).subspan(start, coordinates.size()), coordinates.begin());
}

} // namespace gw
