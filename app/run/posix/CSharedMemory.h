#pragma once

#include <cstddef>

namespace gw {

/// Memory that this process and the copies made of it share. It is zeroed.
class CSharedMemory
{
public:
    explicit CSharedMemory(size_t byteCount);
    ~CSharedMemory();
    CSharedMemory(const CSharedMemory&) = delete;
    CSharedMemory& operator=(const CSharedMemory&) = delete;

    /// Returns null if there is none.
    void* Get() const { return m_pkMemory; }

private:
    size_t m_uiByteCount;
    void* m_pkMemory;
};

} // namespace gw
