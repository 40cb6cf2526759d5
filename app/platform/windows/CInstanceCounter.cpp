// The counter of instances in named memory of the user's session. The system frees the memory with the last
// process that has opened it, so a crash is forgotten once no instance is left.

#include "CInstanceCounter.h"

#include "WindowsCalls.h"

#include <atomic>

namespace gw {

namespace {

using SharedCount = std::atomic_ref<int32_t>;
static_assert(SharedCount::is_always_lock_free); // otherwise the lock would be local to a process

// Returns null without shared memory. The handle is closed: the view keeps the memory.
int32_t* MapCount(const std::string& sharedName)
{
    const HANDLE mapping = CreateFileMappingW(INVALID_HANDLE_VALUE, nullptr, PAGE_READWRITE, 0,
                                              sizeof(int32_t), WideText(sharedName).c_str());
    if (!mapping)
        return nullptr;
    void* const memory = MapViewOfFile(mapping, FILE_MAP_WRITE, 0, 0, sizeof(int32_t));
    CloseHandle(mapping);
    return static_cast<int32_t*>(memory);
}

} // namespace

CInstanceCounter::CInstanceCounter(const std::string& name)
    : m_kSharedName("Local\\" + name), m_piCount(MapCount(m_kSharedName))
{
    if (!m_piCount)
        m_piCount = &m_iOwn;
}

CInstanceCounter::~CInstanceCounter()
{
    if (m_piCount != &m_iOwn)
        UnmapViewOfFile(m_piCount);
}

int32_t CInstanceCounter::Enter()
{
    return SharedCount(*m_piCount).fetch_add(1);
}

void CInstanceCounter::Leave()
{
    SharedCount(*m_piCount).fetch_sub(1);
}

void CInstanceCounter::Reset()
{
    SharedCount(*m_piCount).store(0);
}

int32_t CInstanceCounter::Value() const
{
    return SharedCount(*m_piCount).load() - 1;
}

} // namespace gw
