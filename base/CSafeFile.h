#pragma once

#include <cstddef>
#include <span>
#include <string>
#include <string_view>

namespace gw {

/// Replaces a file in one step: bytes go to a private file in the same folder, and Commit renames it over the
/// destination. Without a Commit, or when anything failed, the old file stays as it was and the private one
/// is removed. A symbolic link is followed, an existing file's mode is kept.
class CSafeFile
{
public:
    CSafeFile() = default;
    ~CSafeFile();
    CSafeFile(const CSafeFile&) = delete;
    CSafeFile& operator=(const CSafeFile&) = delete;

    /// Starts writing beside a destination. False when the folder takes no file or the destination is none
    /// that may be replaced (a folder, a read-only file).
    bool Open(const std::string& path);
    /// Writes all bytes; false when the file system does not take them, and Commit will then fail too.
    bool Write(std::string_view text);
    bool Write(std::span<const std::byte> bytes);
    /// Syncs and renames. False leaves the destination untouched.
    bool Commit();
    /// Where the bytes lie before Commit.
    const std::string& PrivatePath() const { return m_kPrivatePath; }

private:
    void Discard();

    std::string m_kPath;
    std::string m_kPrivatePath;
    int m_iFile = -1;
    unsigned m_uiMode = 0;
    bool m_bFailed = false;
};

} // namespace gw
