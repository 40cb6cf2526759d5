#include "CSharedMemory.h"

#include "Processes.h"
#include "WindowsCalls.h"

#include <cstdint>

namespace gw {

namespace {

std::string NewName()
{
    return "Local\\gaitwright-" + std::to_string(ProcessNumber()) + '-' + std::to_string(RandomNumber());
}

HANDLE Create(const std::string& name, uint64_t byteCount)
{
    return CreateFileMappingW(INVALID_HANDLE_VALUE, nullptr, PAGE_READWRITE,
                              static_cast<DWORD>(byteCount >> 32), static_cast<DWORD>(byteCount),
                              WideText(name).c_str());
}

void* Map(HANDLE memory)
{
    return memory ? MapViewOfFile(memory, FILE_MAP_WRITE, 0, 0, 0) : nullptr;
}

} // namespace

CSharedMemory::CSharedMemory(size_t byteCount)
    : m_kName(NewName()), m_pkHandle(Create(m_kName, byteCount)), m_pkMemory(Map(m_pkHandle))
{
}

CSharedMemory::CSharedMemory(const std::string& name)
    : m_kName(name), m_pkHandle(OpenFileMappingW(FILE_MAP_WRITE, FALSE, WideText(name).c_str())),
      m_pkMemory(Map(m_pkHandle))
{
}

CSharedMemory::~CSharedMemory()
{
    if (m_pkMemory)
        UnmapViewOfFile(m_pkMemory);
    if (m_pkHandle)
        CloseHandle(m_pkHandle);
}

} // namespace gw
