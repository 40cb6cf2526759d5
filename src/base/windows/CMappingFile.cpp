// The whole file has its disk space from the start, so a full disk shows when it is created. The mapping
// would keep the file without its handle, but with the handle, the system deletes the file however the
// program ends.

#include "CMappingFile.h"

#include "Paths.h"
#include "WindowsCalls.h"

#include <fcntl.h>
#include <io.h>

namespace gw {

namespace {

// The system creates an empty file with a free name. Another program can remove the empty folder before.
std::wstring FreeName(const std::string& folder)
{
    constexpr int kAttempts = 8;
    wchar_t name[MAX_PATH];
    for (int i = 0; i < kAttempts; ++i)
    {
        if (CreateFolder(folder) && GetTempFileNameW(WideText(folder).c_str(), L"TK_", 0, name) != 0)
            return name;
    }
    return {};
}

} // namespace

CMappingFile::CMappingFile(const std::string& folder, uint64_t byteCount)
{
    const std::wstring name = FreeName(folder);
    if (name.empty())
        return;
    const HANDLE file =
        CreateFileW(name.c_str(), GENERIC_READ | GENERIC_WRITE, FILE_SHARE_READ | FILE_SHARE_WRITE, nullptr,
                    CREATE_ALWAYS, FILE_ATTRIBUTE_TEMPORARY | FILE_FLAG_DELETE_ON_CLOSE, nullptr);
    if (file == INVALID_HANDLE_VALUE)
    {
        DeleteFileW(name.c_str());
        return;
    }
    m_kPath = NarrowText(name);
    m_pkMapping = CreateFileMappingW(file, nullptr, PAGE_READWRITE, static_cast<DWORD>(byteCount >> 32),
                                     static_cast<DWORD>(byteCount), nullptr);
    if (m_pkMapping)
        m_iFile = _open_osfhandle(reinterpret_cast<intptr_t>(file), _O_BINARY | _O_NOINHERIT);
    if (m_iFile < 0)
        CloseHandle(file);
}

CMappingFile::~CMappingFile()
{
    if (m_pkMapping)
        CloseHandle(m_pkMapping);
    if (m_iFile >= 0)
        _close(m_iFile);
}

bool CMappingFile::Reserve(uint64_t, uint64_t) const
{
    return true;
}

std::byte* CMappingFile::Map(uint64_t offset, uint64_t byteCount) const
{
    return static_cast<std::byte*>(MapViewOfFile(m_pkMapping, FILE_MAP_ALL_ACCESS,
                                                 static_cast<DWORD>(offset >> 32), static_cast<DWORD>(offset),
                                                 byteCount));
}

void CMappingFile::Unmap(std::byte* address, uint64_t)
{
    UnmapViewOfFile(address);
}

} // namespace gw
