#pragma once

#include "CTempFile.h"

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace gw {

/// Handles from here on are blocks of the temp store: the file's index + 1 in the high half, the block's
/// index + 1 in the low one.
inline constexpr uint32_t kLeastTempHandle = 65'537;

/// Keeps large blocks of pixels out of memory: in temporary files, of which only the parts in use are mapped.
/// Not for several threads, but what a handle is mapped to may be used by any.
class CTempStore
{
public:
    /// The one of the process, in the folder TKTmp under the system's temporary folder.
    static CTempStore& Instance();

    /// A store in a folder, which has a separator at its end. It need not exist.
    explicit CTempStore(std::string folder) : m_kFolder(std::move(folder)) {}
    ~CTempStore();
    CTempStore(const CTempStore&) = delete;
    CTempStore& operator=(const CTempStore&) = delete;

    /// The handle of a new block, or 0 where a file cannot be made, the disk is full or the limit is reached.
    uint32_t Allocate(uint64_t byteCount);
    /// Gives a block back; nobody may use it any more. The last block of a file takes the file along, and the
    /// last file the folder.
    void Free(uint32_t handle);
    /// The address of a block while it is used, or null. Each call needs an Unmap.
    std::byte* Map(uint32_t handle);
    void Unmap(uint32_t handle);

    /// The bytes that all files together may have; 0 for no limit.
    void SetLimit(uint64_t byteCount) { m_uiLimit = byteCount; }
    /// The size of all files.
    uint64_t GetTotal() const { return m_uiTotal; }
    const std::string& GetFolder() const { return m_kFolder; }

    /// Deletes all files *.tmp in a folder, and the folder where it is empty then.
    static void Purge(const std::string& folder);

private:
    uint32_t AllocateInNewFile(uint64_t byteCount);
    size_t AddFile(std::unique_ptr<CTempFile> file);
    void RemoveFile(size_t index);
    CTempFile* FileOf(uint32_t handle) const;

    std::vector<std::unique_ptr<CTempFile>> m_kFiles; // with null slots
    std::string m_kFolder;
    uint64_t m_uiLimit = 0;
    uint64_t m_uiTotal = 0;
};

} // namespace gw
