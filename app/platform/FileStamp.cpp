#include "FileStamp.h"

#include "Files.h"

namespace gw {

std::optional<FileStamp> StampOf(const std::string& path)
{
    FileStatus status;
    if (!StatusOf(path, status))
        return std::nullopt;
    return FileStamp{status.device, status.inode, status.byteCount, status.modified, status.changed};
}

} // namespace gw
