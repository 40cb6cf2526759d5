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
    /// Returns when everything on these file systems is on the disk. False if a write failed since Add.
    bool Sync() const;

private:
    std::map<dev_t, int> m_kOpen; ///< an open file for each file system, below 0 where it could not be opened
};

} // namespace gw
