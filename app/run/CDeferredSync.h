#pragma once

#include <cstdint>
#include <map>
#include <string>

namespace gw {

/// Makes many files durable at once, at the end of a run; syncing each when it is written would take most of
/// the run's time.
class CDeferredSync
{
public:
    CDeferredSync() = default;
    ~CDeferredSync();
    CDeferredSync(const CDeferredSync&) = delete;
    CDeferredSync& operator=(const CDeferredSync&) = delete;

    /// Adds the file system of a file or folder; without a call that syncs a file system, only the file, or
    /// all files below the folder. Sync reports write failures from here on.
    void Add(const std::string& path);
    /// Waits until everything that was added is on disk. Returns a path where a write has failed since Add,
    /// or an empty text.
    std::string Sync() const;

private:
    struct Place
    {
        std::string path;
        int file = -1; ///< an open file of the file system; negative if none could be opened
    };

    std::map<uint64_t, Place> m_kPlaces; ///< by file system, or numbered
};

} // namespace gw
