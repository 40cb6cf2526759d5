#pragma once

#include <map>
#include <string>

#include <sys/types.h>

namespace gw {

/// Makes many files durable with one sync; syncing each would take most of a run's time.
class CDeferredSync
{
public:
    CDeferredSync() = default;
    ~CDeferredSync();
    CDeferredSync(const CDeferredSync&) = delete;
    CDeferredSync& operator=(const CDeferredSync&) = delete;

    /// Adds the file system of a file or folder. Sync reports write failures from here on.
    void Add(const std::string& path);
    /// Waits until everything on these file systems is on disk. Returns a path on a file system where a write
    /// has failed since Add, or an empty text.
    std::string Sync() const;

private:
    struct FileSystem
    {
        std::string path;
        int file = -1; ///< an open file on it; negative if none could be opened
    };

    std::map<dev_t, FileSystem> m_kOpen;
};

} // namespace gw
