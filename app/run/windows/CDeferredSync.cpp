// Only administrators may sync a whole file system, so each file is synced.

#include "CDeferredSync.h"

#include "NativePath.h"
#include "Paths.h"
#include "SystemError.h"
#include "WindowsCalls.h"

namespace gw {

namespace {

// A file that is gone has nothing to sync, and one that another program holds open is that program's.
bool SyncOne(const std::string& path)
{
    const CHandle file(
        CreateFileW(WidePath(path).c_str(), GENERIC_WRITE, kShareAll, nullptr, OPEN_EXISTING, 0, nullptr));
    return !file || FlushFileBuffers(file.Get()) != 0;
}

bool SyncBelow(const std::string& folder)
{
    namespace fs = std::filesystem;
    bool good = true;
    std::error_code error;
    fs::recursive_directory_iterator entry(NativePath(folder), error);
    for (; !error && entry != fs::recursive_directory_iterator(); entry.increment(error))
        good = (!entry->is_regular_file(error) || SyncOne(PathText(entry->path()))) && good;
    return good;
}

} // namespace

CDeferredSync::~CDeferredSync() = default;

void CDeferredSync::Add(const std::string& path)
{
    m_kPlaces[m_kPlaces.size()] = {.path = path};
}

std::string CDeferredSync::Sync() const
{
    std::string failed;
    for (const auto& [number, place] : m_kPlaces)
    {
        if (FolderExists(place.path) ? SyncBelow(place.path) : SyncOne(place.path))
            continue;
        KeepSystemError();
        failed = place.path;
    }
    return failed;
}

} // namespace gw
