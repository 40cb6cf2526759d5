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

// Returns null without shared memory. Space is allocated immediately; otherwise, a full disk would show only
// as a signal at the first access.
int32_t* MapCount(const std::string& sharedName)
{
    const int file = shm_open(sharedName.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, S_IRUSR | S_IWUSR);
    if (file < 0)
        return nullptr;
    void* memory = MAP_FAILED;
    if (IsOwn(file) && posix_fallocate(file, 0, sizeof(int32_t)) == 0)
        memory = mmap(nullptr, sizeof(int32_t), PROT_READ | PROT_WRITE, MAP_SHARED, file, 0);
    close(file);
    return memory == MAP_FAILED ? nullptr : static_cast<int32_t*>(memory);
}

} // namespace

CInstanceCounter::CInstanceCounter(const std::string& name)
    : m_kSharedName('/' + name + '-' + std::to_string(geteuid())), m_piCount(MapCount(m_kSharedName))
{
    if (!m_piCount)
        m_piCount = &m_iOwn;
}

CInstanceCounter::~CInstanceCounter()
{
    if (m_piCount != &m_iOwn)
        munmap(m_piCount, sizeof *m_piCount);
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
