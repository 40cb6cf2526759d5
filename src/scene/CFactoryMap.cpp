#include "CFactoryMap.h"

#include <mutex>

namespace gw {

CFactoryMap& CFactoryMap::Instance()
{
    static CFactoryMap map;
    return map;
}

void CFactoryMap::Set(std::string_view className, CObjectFactory factory)
{
    const std::unique_lock lock(m_kMutex);
    m_kFactory[std::string(className)] = factory;
}

CObjectFactory CFactoryMap::Find(std::string_view className) const
{
    const std::shared_lock lock(m_kMutex);
    const auto entry = m_kFactory.find(className);
    return entry == m_kFactory.end() ? nullptr : entry->second;
}

int RegisterClasses(std::span<const FactoryRow> rows)
{
    for (const FactoryRow& row : rows)
        CFactoryMap::Instance().Set(row.m_pkRecord->m_pcName, row.m_pkFactory);
    return static_cast<int>(rows.size());
}

CObject* MakeNothing(COrrinStream&)
{
    return nullptr;
}

} // namespace gw
