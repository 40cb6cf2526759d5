#include "CFieldArchive.h"

#include <algorithm>

namespace gw {

size_t CFieldArchive::Fitting(int64_t count, size_t)
{
    return static_cast<size_t>(std::max<int64_t>(count, 0));
}

void CFieldCounter::Text(const char*, CText& text)
{
    m_uiBytes += 4 + text.View().size();
}

bool CFieldCounter::Presence(const char*, bool present)
{
    m_uiBytes += 4;
    return present;
}

size_t CFieldCounter::Count(const char*, size_t count, size_t)
{
    m_uiBytes += 4;
    return count;
}

void CFieldCounter::Values(const char*, EFieldKind kind, void*, size_t count)
{
    m_uiBytes += count * FieldBytes(kind);
}

void CFieldCounter::Slot(const char*, const CLinkSlot&)
{
    m_uiBytes += 4;
}

} // namespace gw
