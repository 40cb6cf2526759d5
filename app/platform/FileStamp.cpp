#include "FileStamp.h"

#include <sys/stat.h>

namespace gw {

namespace {

int64_t Nanoseconds(const timespec& time)
{
    return int64_t{time.tv_sec} * 1'000'000'000 + time.tv_nsec;
}

} // namespace

std::optional<FileStamp> StampOf(const std::string& path)
{
    struct stat status = {};
    if (stat(path.c_str(), &status) != 0)
        return std::nullopt;
    return FileStamp{status.st_dev, status.st_ino, static_cast<uint64_t>(status.st_size),
                     Nanoseconds(status.st_mtim), Nanoseconds(status.st_ctim)};
}

} // namespace gw
