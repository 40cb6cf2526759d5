#include "CMorphControl.h"

#include "CFieldArchive.h"
#include "CGeometry.h"

#include <algorithm>

namespace gw {

const CRTTI CMorphControl::ms_kRTTI{"CMorphControl", &CControl::ms_kRTTI};

void CMorphControl::Fields(CFieldArchive& archive)
{
    CControl::Fields(archive);
    archive.SignedBlock("m_kDeltas", m_kDeltas);
    archive.Block("m_kWeights", m_kWeights);
    archive.Block("m_kKeyTimes", m_kKeyTimes);
}

uint64_t CMorphControl::GetMemoryUsed() const
{
    return CControl::GetMemoryUsed() + 36 + m_kDeltas.size() * sizeof(Vec3) +
           (m_kWeights.size() + m_kKeyTimes.size()) * sizeof(float);
}

bool CMorphControl::Update(float time)
{
    if (!m_bActive)
        return false;
    if (m_kKeyTimes.empty() || m_kWeights.empty())
        return true;
    CGeometry* target = RecordCast<CGeometry>(GetTarget());
    if (!target)
        return false;
    const float weight = LinearKey(m_kWeights, FindKeys(MapTime(time), m_kKeyTimes, m_uiCursor), 0.0f);
    if (weight == 0.0f)
        return true;
    MovePoints(*target, weight);
    ++target->m_uiChangeStamp;
    return true;
}

void CMorphControl::MovePoints(CGeometry& target, float weight) const
{
    const std::span<Vec3> points = target.WorldXYZBuffer();
    const size_t count = std::min(points.size(), m_kDeltas.size());
    if (!target.m_bWorldValid)
    {
        for (size_t i = 0; i < count; ++i)
            points[i] = points[i] + m_kDeltas[i] * weight;
        return;
    }
    // The points are already in world space: rotate the offset with the mesh, but do not translate it.
    Mat4 turn = target.m_kWorldMatrix;
    turn.SetTranslation(kVec3Zero);
    for (size_t i = 0; i < count; ++i)
        points[i] = points[i] + TransformCoord(m_kDeltas[i], turn) * weight;
}

} // namespace gw
