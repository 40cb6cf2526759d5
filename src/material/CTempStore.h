#pragma once

#include "CTempFile.h"

#include <cstdint>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

namespace gw {

/// Handles from here on are blocks of the temp store: file index + 1 in the high half, block index + 1 in the
/// low half.
inline constexpr uint32_t kLeastTempHandle = 65'537;

/// Keeps large pixel blocks out of memory, in temporary files of which only the used parts are mapped.
/// Threads may use the store at the same time.
class CTempStore
{
public:
    /// Returns the store of the process, in the folder TKTmp under the system's temporary folder.
    static CTempStore& Instance();

    /// Uses a folder (with trailing separator), which need not exist.
    explicit CTempStore(std::string folder) : m_kFolder(std::move(folder)) {}
    ~CTempStore();
    CTempStore(const CTempStore&) = delete;
    CTempStore& operator=(const CTempStore&) = delete;

    /// Returns the handle of a new block, or 0 if a file cannot be created, the disk is full or the limit is
    /// reached.
    uint32_t Allocate(uint64_t byteCount);
    /// Frees a block, which must not be in use. Freeing the last block of a file deletes it, and the last
    /// file deletes the folder.
    void Free(uint32_t handle);
    /// Returns the address of a block, or null. Each call needs an Unmap.
    std::byte* Map(uint32_t handle);
    void Unmap(uint32_t handle);

    /// Limits the size of all files together; 0 means no limit.
    void SetLimit(uint64_t byteCount) { m_uiLimit = byteCount; }
    /// Returns the size of all files.
    uint64_t GetTotal() const { return m_uiTotal; }
    const std::string& GetFolder() const { return m_kFolder; }

    /// Deletes all *.tmp files in a folder, and the folder if it is then empty.
    static void Purge(const std::string& folder);

private:
    uint32_t AllocateInNewFile(uint64_t byteCount);
    size_t AddFile(std::unique_ptr<CTempFile> file);
    void RemoveFile(size_t index);
    CTempFile* FileOf(uint32_t handle) const;

    std::vector<std::unique_ptr<CTempFile>> m_kFiles; // can contain null
    std::string m_kFolder;
    uint64_t m_uiLimit = 0;
    uint64_t m_uiTotal = 0;
    std::mutex m_kMutex; // of the files and their blocks
};

} // namespace gw
