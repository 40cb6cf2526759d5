// The folder is shared by all users of the machine, so it is checked not to be a link, and file names are
// created exclusively.

#include "CMappingFile.h"

#include "Paths.h"

#include <cerrno>

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

constexpr std::string_view kNamePattern = "TK_XXXXXX.tmp";
constexpr int kExtensionLength = 4;

// Creates the folder that all users of the machine share, like the one that contains it. Returns false if
// somebody has put a link or a file in its place.
bool MakeSharedFolder(const std::string& folder)
{
    if (!FolderExists(folder) && CreateFolder(folder))
        chmod(folder.c_str(), 01777);
    return IsFolderItself(folder);
}

// Another program can remove the empty folder at any time before the file is created.
int CreateIn(const std::string& folder, std::string& path)
{
    constexpr int kAttempts = 8;
    for (int i = 0; i < kAttempts; ++i)
    {
        if (!MakeSharedFolder(folder))
            continue; // it may have been removed again at once
        path = folder + std::string(kNamePattern);
        const int file = mkostemps(path.data(), kExtensionLength, O_CLOEXEC);
        if (file >= 0)
            return file;
        if (errno != ENOENT)
            break;
    }
    path.clear();
    return -1;
}

} // namespace

CMappingFile::CMappingFile(const std::string& folder, uint64_t byteCount) : m_iFile(CreateIn(folder, m_kPath))
{
    if (m_iFile < 0 || ftruncate(m_iFile, static_cast<off_t>(byteCount)) == 0)
        return;
    close(m_iFile);
    m_iFile = -1;
}

CMappingFile::~CMappingFile()
{
    if (m_iFile >= 0)
        close(m_iFile);
    if (!m_kPath.empty())
        unlink(m_kPath.c_str());
}

bool CMappingFile::Reserve(uint64_t offset, uint64_t byteCount) const
{
    int error = EINTR;
    while (error == EINTR)
        error = posix_fallocate(m_iFile, static_cast<off_t>(offset), static_cast<off_t>(byteCount));
    return error == 0;
}

std::byte* CMappingFile::Map(uint64_t offset, uint64_t byteCount) const
{
    void* const mapped =
        mmap(nullptr, byteCount, PROT_READ | PROT_WRITE, MAP_SHARED, m_iFile, static_cast<off_t>(offset));
    return mapped == MAP_FAILED ? nullptr : static_cast<std::byte*>(mapped);
}

void CMappingFile::Unmap(std::byte* address, uint64_t byteCount)
{
    munmap(address, byteCount);
}

} // namespace gw
