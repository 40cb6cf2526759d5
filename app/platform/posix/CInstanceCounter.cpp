#include "CInstanceCounter.h"

#include <atomic>

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

using SharedCount = std::atomic_ref<int32_t>;
static_assert(SharedCount::is_always_lock_free); // otherwise the lock would be local to a process

// Anybody can create an object with this name; only the user's own is accepted.
bool IsOwn(int file)
{
    struct stat status = {};
    return fstat(file, &status) == 0 && status.st_uid == geteuid();
}

// Returns memory of this process if it cannot be shared. Space is allocated immediately; otherwise, a full
// disk would show only as a signal at the first access.
std::shared_ptr<int32_t> MapCount(const std::string& sharedName)
{
    const int file = shm_open(sharedName.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, S_IRUSR | S_IWUSR);
    if (file < 0)
        return std::make_shared<int32_t>(0);
    void* memory = MAP_FAILED;
    if (IsOwn(file) && posix_fallocate(file, 0, sizeof(int32_t)) == 0)
        memory = mmap(nullptr, sizeof(int32_t), PROT_READ | PROT_WRITE, MAP_SHARED, file, 0);
    close(file);
    if (memory == MAP_FAILED)
        return std::make_shared<int32_t>(0);
    return {static_cast<int32_t*>(memory), [](int32_t* count) { munmap(count, sizeof *count); }};
}

} // namespace

CInstanceCounter::CInstanceCounter(const std::string& name)
    : m_kSharedName('/' + name + '-' + std::to_string(geteuid())), m_spiCount(MapCount(m_kSharedName))
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
