// The counter of instances in named memory of the user's session. The system frees the memory with the last
// counter that has opened it, so a crash is forgotten once no instance is left.

#include "CInstanceCounter.h"

#include "WindowsCalls.h"

#include <atomic>

namespace gw {

namespace {

using SharedCount = std::atomic_ref<int32_t>;
static_assert(SharedCount::is_always_lock_free); // otherwise the lock would be local to a process

// Returns memory of this process if it cannot be shared. The handle stays open: a view keeps the memory, but
// not its name.
std::shared_ptr<int32_t> MapCount(const std::string& sharedName)
{
    const HANDLE mapping = CreateFileMappingW(INVALID_HANDLE_VALUE, nullptr, PAGE_READWRITE, 0,
                                              sizeof(int32_t), WideText(sharedName).c_str());
    if (!mapping)
        return std::make_shared<int32_t>(0);
    void* const memory = MapViewOfFile(mapping, FILE_MAP_WRITE, 0, 0, sizeof(int32_t));
    if (!memory)
    {
        CloseHandle(mapping);
        return std::make_shared<int32_t>(0);
    }
    return {static_cast<int32_t*>(memory), [mapping](int32_t* count) {
                UnmapViewOfFile(count);
                CloseHandle(mapping);
            }};
}

} // namespace

CInstanceCounter::CInstanceCounter(const std::string& name)
    : m_kSharedName("Local\\" + name), m_spiCount(MapCount(m_kSharedName))
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
