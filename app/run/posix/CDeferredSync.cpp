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
    for (const auto& [device, place] : m_kPlaces)
    {
        if (place.file >= 0)
            close(place.file);
    }
}

void CDeferredSync::Add(const std::string& path)
{
    struct stat status = {};
    if (stat(path.c_str(), &status) == 0 && !m_kPlaces.contains(status.st_dev))
        m_kPlaces[status.st_dev] = {path, open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK)};
}

std::string CDeferredSync::Sync() const
{
    std::string failed;
    for (const auto& [device, place] : m_kPlaces)
    {
        if (SyncOne(place.file))
            continue;
        KeepSystemError();
        failed = place.path;
    }
    return failed;
}

} // namespace gw
