#pragma once

#include <cstddef>
#include <string>

namespace gw {

/// Memory that processes of one user share by its name. It is zeroed, and exists as long as one of them.
class CSharedMemory
{
public:
    explicit CSharedMemory(size_t byteCount);
    /// Opens the memory that another process has created.
    explicit CSharedMemory(const std::string& name);
    ~CSharedMemory();
    CSharedMemory(const CSharedMemory&) = delete;
    CSharedMemory& operator=(const CSharedMemory&) = delete;

    /// Returns null if there is none.
    void* Get() const { return m_pkMemory; }
    const std::string& Name() const { return m_kName; }

private:
    std::string m_kName;
    void* m_pkHandle; ///< of the system
    void* m_pkMemory;
};

} // namespace gw
