#pragma once

#include "CFailureRecord.h"

#include <cstddef>
#include <memory>
#include <span>
#include <string>
#include <string_view>

namespace gw {

struct WatchedRange;

/// The bytes of a regular file. Large files are mapped, small ones are read, which is cheaper. Folders and
/// devices are refused. An empty file has no bytes. If the file is truncated while it is mapped, the missing
/// bytes read as zeros; see IsWhole. Windows does not let a mapped file be replaced, so there all are read.
class CMappedFile
{
public:
    CMappedFile() = default;
    ~CMappedFile();
    CMappedFile(CMappedFile&& other) noexcept;
    CMappedFile& operator=(CMappedFile&& other) noexcept;
    CMappedFile(const CMappedFile&) = delete;
    CMappedFile& operator=(const CMappedFile&) = delete;

    /// Opens a file in place of the current one. Returns EFailure::None on success. After a failure, no file
    /// is open.
    EFailure Open(const std::string& path);
    void Close();

    /// Returns whether the file still had all its bytes when they were read. Call it after the last read: if
    /// it returns false, discard what was read. True if no file is open.
    bool IsWhole() const;

    std::span<const std::byte> Bytes() const { return {m_pkBytes, m_uiSize}; }
    std::string_view Text() const { return {reinterpret_cast<const char*>(m_pkBytes), m_uiSize}; }
    /// Releases the pages before an offset. They are loaded again if they are read again.
    void Forget(size_t endOffset);

private:
    EFailure Take(int file);
    EFailure Read(int file, size_t size);
    EFailure Map(int file, size_t size);
    void Unmap();
    bool IsMapped() const { return m_pkBytes && !m_spkSmall; }

    std::unique_ptr<std::byte[]> m_spkSmall; // the bytes, if they are not mapped
    const std::byte* m_pkBytes = nullptr;
    size_t m_uiSize = 0;
    int m_iFile = -1;                  // set if the file is mapped
    WatchedRange* m_pkRange = nullptr; // set if the file is mapped
};

} // namespace gw
