#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

namespace gw {

/// A temporary file of a fixed size, whose parts can be mapped into memory. It is deleted with the object.
class CMappingFile
{
public:
    /// Creates the file in a folder that ends in a separator. A missing folder is created first.
    CMappingFile(const std::string& folder, uint64_t byteCount);
    ~CMappingFile();
    CMappingFile(const CMappingFile&) = delete;
    CMappingFile& operator=(const CMappingFile&) = delete;

    /// Returns false if the file could not be created; then call nothing else.
    bool IsOpen() const { return m_iFile >= 0; }
    const std::string& Path() const { return m_kPath; }
    /// Reserves disk space for a part before it is touched; false if the disk is full.
    bool Reserve(uint64_t offset, uint64_t byteCount) const;
    /// Returns the address of a part, or null. Offsets are multiples of 65,536.
    std::byte* Map(uint64_t offset, uint64_t byteCount) const;
    static void Unmap(std::byte* address, uint64_t byteCount);

private:
    std::string m_kPath;
    int m_iFile = -1;            // stays open, because parts are mapped later
    void* m_pkMapping = nullptr; // the system's object, where it has one
};

} // namespace gw
