#pragma once

#include "CMappingFile.h"
#include "CSection.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

namespace gw {

/// A temporary file whose blocks can be mapped into memory. Its size is fixed from the start, but disk space
/// is reserved block by block before it is touched, so that a full disk is reported as an error. The file is
/// deleted with the object. Operations on blocks lock the file.
class CTempFile
{
public:
    virtual ~CTempFile();
    CTempFile(const CTempFile&) = delete;
    CTempFile& operator=(const CTempFile&) = delete;

    /// Returns false if the file could not be created; then call nothing else.
    bool IsOpen() const { return m_kFile.IsOpen(); }
    uint64_t GetSize() const { return m_uiSize; }
    const std::string& GetPath() const { return m_kFile.Path(); }
    /// Returns whether the file can hold more than one block.
    bool TakesBlocks() const { return m_bTakesBlocks; }

    /// Returns the index of a new block, or nothing if the file or the disk is full.
    virtual std::optional<uint32_t> Allocate(uint64_t byteCount) = 0;
    /// Frees a block. Returns true if it was the last one.
    virtual bool Free(uint32_t block) = 0;
    /// Returns the address of a block, mapped at its first use; null if it does not exist. Uses are counted.
    virtual std::byte* Map(uint32_t block) = 0;
    virtual void Unmap(uint32_t block) = 0;

protected:
    /// A mapped part of the file.
    struct View
    {
        uint64_t m_uiOffset = 0;
        uint64_t m_uiSize = 0;
        int32_t m_iUses = 0;
        std::byte* m_pkAddress = nullptr;
    };

    /// Creates a file in a folder, which is created if necessary.
    CTempFile(const std::string& folder, uint64_t byteCount, bool takesBlocks);

    bool Reserve(const View& view);
    std::byte* Use(View& view);
    static void Drop(View& view);
    static void Close(View& view);

    CSection m_kSection;

private:
    CMappingFile m_kFile;
    uint64_t m_uiSize;
    bool m_bTakesBlocks;
};

} // namespace gw
