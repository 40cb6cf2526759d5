#include "MapSharedCount.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

// Anybody can create an object with this name; only the user's own is accepted.
bool IsOwn(int file)
{
    struct stat status = {};
    return fstat(file, &status) == 0 && status.st_uid == geteuid();
}

} // namespace

std::string SharedCountName(const std::string& name)
{
    return '/' + name + '-' + std::to_string(geteuid());
}

// Space is allocated immediately; otherwise, a full disk would show only as a signal at the first access.
std::shared_ptr<int32_t> MapSharedCount(const std::string& sharedName)
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

} // namespace gw
