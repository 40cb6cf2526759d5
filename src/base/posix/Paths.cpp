#include "Paths.h"

#include "NativePath.h"
#include "SystemError.h"

#include <cerrno>
#include <filesystem>
#include <system_error>

#include <sys/auxv.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace fs = std::filesystem;

bool IsReadOnly(const std::string& path)
{
    struct stat status;
    if (stat(path.c_str(), &status) != 0)
        return false;
    const bool hasWriteBit = (status.st_mode & (S_IWUSR | S_IWGRP | S_IWOTH)) != 0;
    const bool isWritable = access(path.c_str(), W_OK) == 0;
    // Root may write to a file without write bits, but then nobody is meant to.
    if (!hasWriteBit && isWritable)
        errno = EACCES;
    return !hasWriteBit || !isWritable;
}

bool CreateFolder(const std::string& path)
{
    std::error_code error;
    fs::create_directories(NativePath(path), error);
    if (error)
        KeepSystemError(error.value());
    return FolderExists(path);
}

std::string FollowLinks(const std::string& path)
{
    constexpr int kLinkLimit = 40; // the system's limit
    fs::path target(path);
    for (int i = 0; i < kLinkLimit; ++i)
    {
        std::error_code error;
        const fs::path next = fs::read_symlink(target, error);
        if (error)
            return target.string();
        target = target.parent_path() / next;
    }
    return {};
}

std::string TemporaryFolder()
{
    std::error_code error;
    const fs::path folder = fs::temp_directory_path(error);
    if (error)
        KeepSystemError(error.value());
    return error ? std::string() : WithSeparator(PathText(folder));
}

std::string ProgramFolder()
{
    std::error_code error;
    fs::path program = fs::read_symlink("/proc/self/exe", error);
    if (error) // a root file system without /proc, such as a package build's
    {
        // NOLINTNEXTLINE(performance-no-int-to-ptr): the system passes this address as a number
        const auto* const path = reinterpret_cast<const char*>(getauxval(AT_EXECFN));
        program = fs::canonical(path, error);
    }
    return SplitPath(PathText(program)).folder;
}

} // namespace gw
