#pragma once

#include <cstddef>
#include <cstdint>
#include <mutex>
#include <optional>
#include <string>

namespace gw {

/// A temporary file whose blocks can be mapped into memory. It has its size from the start, but space on the
/// disk is reserved block by block before anything is touched, so that a full disk is an answer. The file
/// goes with the object. Each operation on blocks holds the file's lock throughout.
class CTempFile
{
public:
    virtual ~CTempFile();
    CTempFile(const CTempFile&) = delete;
    CTempFile& operator=(const CTempFile&) = delete;

    /// False where the folder took no file; nothing else may be asked then.
    bool IsOpen() const { return m_iFile >= 0; }
    uint64_t GetSize() const { return m_uiSize; }
    const std::string& GetPath() const { return m_kPath; }
    /// Whether more than one block can be had of it.
    bool TakesBlocks() const { return m_bTakesBlocks; }

    /// The index of a new block, or none where the file or the disk has no room.
    virtual std::optional<uint32_t> Allocate(uint64_t byteCount) = 0;
    /// Gives a block back. True when that was the last one.
    virtual bool Free(uint32_t block) = 0;
    /// The address of a block, mapped at its first use; null for no such block. Uses are counted.
    virtual std::byte* Map(uint32_t block) = 0;
    virtual void Unmap(uint32_t block) = 0;

protected:
    /// A part of the file that can be seen while somebody uses it.
    struct View
    {
        uint64_t m_uiOffset = 0;
        uint64_t m_uiSize = 0;
        int32_t m_iUses = 0;
        std::byte* m_pkAddress = nullptr;
    };

    /// Makes a file of its own in a folder, which is made first where it is missing.
    CTempFile(const std::string& folder, uint64_t byteCount, bool takesBlocks);

    bool Reserve(const View& view);
    std::byte* Use(View& view);
    static void Drop(View& view);
    static void Close(View& view);

    std::mutex m_kSection;

private:
    std::string m_kPath;
    uint64_t m_uiSize;
    int m_iFile = -1; // stays open: views are mapped of it later
    bool m_bTakesBlocks;
};

} // namespace gw
