#include "CPlatform.h"

#include "Paths.h"

#include <utility>

namespace gw {

namespace {

constexpr const char* kSharedFolder = GAITWRIGHT_SHARED_FROM_PROGRAMS; // in installations

} // namespace

std::string CustomProfileFolder(const CPlatform& platform, const std::string& keyPath)
{
    std::string folder = platform.ReadHostKey(keyPath, "Custom Data");
    if (folder.empty())
        folder = platform.DocumentsFolder();
    return WithSeparator(WithSeparator(std::move(folder)) + "BVH Profile");
}

std::string InstalledDataFolder()
{
    std::string beside = ExecutableFolder();
    std::string shared = PathFrom(beside, kSharedFolder);
    return !FileExists(beside + kTargetFile) && FolderExists(shared) ? shared : beside;
}

} // namespace gw
