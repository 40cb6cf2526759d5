#include "CFieldArchive.h"

#include <algorithm>
#include <cstring>

namespace gw {

size_t CFieldArchive::Fitting(int64_t count, size_t)
{
    return static_cast<size_t>(std::max<int64_t>(count, 0));
}

// The default, for archives without a shortcut for repeated values.
void CFieldArchive::Repeated(const char* name, EFieldKind kind, const void* value, size_t count)
{
    const size_t size = FieldBytes(kind);
    std::vector<std::byte> values(size * count);
    for (size_t i = 0; i < count; ++i)
        std::memcpy(values.data() + i * size, value, size);
    Values(name, kind, values.data(), count);
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

void CFieldCounter::Repeated(const char*, EFieldKind kind, const void*, size_t count)
{
    m_uiBytes += count * FieldBytes(kind);
}

void CFieldCounter::Slot(const char*, const CLinkSlot&)
{
    m_uiBytes += 4;
}

} // namespace gw
