#include "CDeferredSync.h"

#include <algorithm>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

// Without an open file only everything can be synced, and errors cannot be learned.
bool SyncOne(int file)
{
    if (file >= 0)
        return syncfs(file) == 0;
    sync();
    return true;
}

} // namespace

CDeferredSync::~CDeferredSync()
{
    for (const auto& [device, file] : m_kOpen)
    {
        if (file >= 0)
            close(file);
    }
}

void CDeferredSync::Add(const std::string& path)
{
    struct stat status = {};
    if (stat(path.c_str(), &status) == 0 && !m_kOpen.contains(status.st_dev))
        m_kOpen[status.st_dev] = open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
}

bool CDeferredSync::Sync() const
{
    return std::ranges::count_if(m_kOpen, [](const auto& entry) { return !SyncOne(entry.second); }) == 0;
}

} // namespace gw
