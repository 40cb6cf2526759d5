#include "CVectorKeyControl.h"

#include "CFieldArchive.h"

namespace gw {

void CVectorKeyControl::Fields(CFieldArchive& archive)
{
    CControl::Fields(archive);
    archive.Block("m_kKeys", m_kKeys);
    archive.Block("m_kKeyTimes", m_kKeyTimes);
}

uint64_t CVectorKeyControl::GetMemoryUsed() const
{
    return CControl::GetMemoryUsed() + 28 + m_kKeys.size() * sizeof(Vec3) +
           m_kKeyTimes.size() * sizeof(float);
}

Vec3 CVectorKeyControl::ValueAt(float time, const Vec3& empty)
{
    return HasKeys() ? LinearKey(m_kKeys, FindKeys(MapTime(time), m_kKeyTimes, m_uiCursor), empty) : empty;
}

} // namespace gw
