#include "CDeferredSync.h"
#include "SystemError.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

// Without an open file, only everything can be synced, and errors are not reported.
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
    for (const auto& [device, system] : m_kOpen)
    {
        if (system.file >= 0)
            close(system.file);
    }
}

void CDeferredSync::Add(const std::string& path)
{
    struct stat status = {};
    if (stat(path.c_str(), &status) == 0 && !m_kOpen.contains(status.st_dev))
        m_kOpen[status.st_dev] = {path, open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK)};
}

std::string CDeferredSync::Sync() const
{
    std::string failed;
    for (const auto& [device, system] : m_kOpen)
    {
        if (SyncOne(system.file))
            continue;
        KeepSystemError();
        failed = system.path;
    }
    return failed;
}

} // namespace gw
