#include "CSharedMemory.h"

#include <sys/mman.h>

namespace gw {

namespace {

void* MapShared(size_t byteCount)
{
    void* const memory = mmap(nullptr, byteCount, PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0);
    return memory == MAP_FAILED ? nullptr : memory;
}

} // namespace

CSharedMemory::CSharedMemory(size_t byteCount) : m_uiByteCount(byteCount), m_pkMemory(MapShared(byteCount)) {}

CSharedMemory::~CSharedMemory()
{
    if (m_pkMemory)
        munmap(m_pkMemory, m_uiByteCount);
}

} // namespace gw
