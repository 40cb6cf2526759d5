#pragma once

#include "CFailure.h"

#include <cstddef>
#include <memory>
#include <span>
#include <string>
#include <string_view>

namespace gw {

struct WatchedRange;

/// The bytes of a regular file, mapped and not copied; a small one is read, which costs less. Folders and
/// devices are refused. An empty file maps to no bytes. Bytes that a file loses while it is mapped read as
/// zeros; see IsWhole.
class CMappedFile
{
public:
    CMappedFile() = default;
    ~CMappedFile();
    CMappedFile(CMappedFile&& other) noexcept;
    CMappedFile& operator=(CMappedFile&& other) noexcept;
    CMappedFile(const CMappedFile&) = delete;
    CMappedFile& operator=(const CMappedFile&) = delete;

    /// Replaces what was mapped. None on success, else why not; nothing is mapped then.
    EFailure Open(const std::string& path);
    void Close();

    /// Whether the file still had all its bytes when they were read. To be asked after the last read: what
    /// was read of a file that was cut short meanwhile is worth nothing. True when nothing is open.
    bool IsWhole() const;

    std::span<const std::byte> Bytes() const { return {m_pkBytes, m_uiSize}; }
    std::string_view Text() const { return {reinterpret_cast<const char*>(m_pkBytes), m_uiSize}; }
    /// Gives back the pages before an offset that will not be read again; they are read anew if they are.
    void Forget(size_t endOffset);

private:
    EFailure Take(int file);
    EFailure Read(int file, size_t size);
    EFailure Map(int file, size_t size);
    bool IsMapped() const { return m_pkBytes && !m_spkSmall; }

    std::unique_ptr<std::byte[]> m_spkSmall; // where the bytes are not mapped
    const std::byte* m_pkBytes = nullptr;
    size_t m_uiSize = 0;
    int m_iFile = -1;                  // of a mapping
    WatchedRange* m_pkRange = nullptr; // likewise
};

} // namespace gw
