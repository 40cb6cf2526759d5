#include "CSection.h"

#include "WindowsCalls.h"

namespace gw {

namespace {

CRITICAL_SECTION* SectionIn(std::byte* memory)
{
    return reinterpret_cast<CRITICAL_SECTION*>(memory);
}

} // namespace

CSection::CSection()
{
    static_assert(sizeof m_kSection == sizeof(CRITICAL_SECTION));
    InitializeCriticalSection(SectionIn(m_kSection));
}

CSection::~CSection()
{
    DeleteCriticalSection(SectionIn(m_kSection));
}

void CSection::lock()
{
    EnterCriticalSection(SectionIn(m_kSection));
}

void CSection::unlock()
{
    LeaveCriticalSection(SectionIn(m_kSection));
}

} // namespace gw
