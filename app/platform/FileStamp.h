#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace gw {

/// Identifies one state of a file without reading it: equal stamps mean that it is the same file and was not
/// written in between.
struct FileStamp
{
    uint64_t device = 0;
    uint64_t inode = 0;
    uint64_t byteCount = 0;
    int64_t modified = 0; ///< nanoseconds
    int64_t changed = 0;  ///< nanoseconds; also changes if `modified` is set back

    friend bool operator==(const FileStamp&, const FileStamp&) = default;
};

/// Returns the stamp of a file, following links; null if the file does not exist.
std::optional<FileStamp> StampOf(const std::string& path);

} // namespace gw
