#include "CInstanceCounter.h"

#include "MapSharedCount.h"

#include <atomic>

namespace gw {

namespace {

using SharedCount = std::atomic_ref<int32_t>;
static_assert(SharedCount::is_always_lock_free); // otherwise the lock would be local to a process

} // namespace

CInstanceCounter::CInstanceCounter(const std::string& name)
    : m_kSharedName(SharedCountName(name)), m_spiCount(MapSharedCount(m_kSharedName))
{
}

int32_t CInstanceCounter::Enter()
{
    return SharedCount(*m_spiCount).fetch_add(1);
}

void CInstanceCounter::Leave()
{
    SharedCount(*m_spiCount).fetch_sub(1);
}

void CInstanceCounter::Reset()
{
    SharedCount(*m_spiCount).store(0);
}

int32_t CInstanceCounter::Value() const
{
    return SharedCount(*m_spiCount).load() - 1;
}

} // namespace gw
