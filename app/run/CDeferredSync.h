#pragma once

#include <map>
#include <string>

#include <sys/types.h>

namespace gw {

/// Makes many files durable in one pass, where a sync of each would cost most of a run's time.
class CDeferredSync
{
public:
    CDeferredSync() = default;
    ~CDeferredSync();
    CDeferredSync(const CDeferredSync&) = delete;
    CDeferredSync& operator=(const CDeferredSync&) = delete;

    /// Adds the file system of a file or folder. A failure to write there is reported by Sync from then on.
    void Add(const std::string& path);
    /// Returns when everything on these file systems is on the disk. Answers a path on one where a write
    /// failed since Add, or an empty text.
    std::string Sync() const;

private:
    struct FileSystem
    {
        std::string path;
        int file = -1; ///< an open file there, below 0 where none could be opened
    };

    std::map<dev_t, FileSystem> m_kOpen;
};

} // namespace gw
