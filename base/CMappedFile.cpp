#include "CMappedFile.h"

#include <algorithm>
#include <cerrno>
#include <utility>

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

EFailure MapFile(int file, const std::byte*& bytes, size_t& size)
{
    struct stat status;
    if (fstat(file, &status) != 0)
        return EFailure::NotFound;
    if (!S_ISREG(status.st_mode))
        return EFailure::NotRegular;
    if (status.st_size == 0)
        return EFailure::None; // nothing can be mapped of no bytes

    const auto length = static_cast<size_t>(status.st_size);
    void* const mapped = mmap(nullptr, length, PROT_READ, MAP_PRIVATE, file, 0);
    if (mapped == MAP_FAILED)
        return errno == ENOMEM ? EFailure::OutOfMemory : EFailure::ReadError;
    // A hint only: files are read from front to back once.
    madvise(mapped, length, MADV_SEQUENTIAL);
    bytes = static_cast<const std::byte*>(mapped);
    size = length;
    return EFailure::None;
}

void* PageAddress(const std::byte* bytes)
{
    return const_cast<std::byte*>(bytes); // the system's calls take no pointer to const
}

} // namespace

CMappedFile::~CMappedFile()
{
    Close();
}

CMappedFile::CMappedFile(CMappedFile&& other) noexcept
    : m_pkBytes(std::exchange(other.m_pkBytes, nullptr)), m_uiSize(std::exchange(other.m_uiSize, 0))
{
}

CMappedFile& CMappedFile::operator=(CMappedFile&& other) noexcept
{
    std::swap(m_pkBytes, other.m_pkBytes);
    std::swap(m_uiSize, other.m_uiSize);
    return *this;
}

EFailure CMappedFile::Open(const std::string& path)
{
    Close();
    // Without O_NONBLOCK a named pipe would wait for a writer before it can be refused.
    const int file = open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    if (file < 0)
        return EFailure::NotFound;
    const EFailure failure = MapFile(file, m_pkBytes, m_uiSize);
    close(file);
    return failure;
}

void CMappedFile::Close()
{
    if (m_pkBytes)
        munmap(PageAddress(m_pkBytes), m_uiSize);
    m_pkBytes = nullptr;
    m_uiSize = 0;
}

void CMappedFile::Forget(size_t endOffset)
{
    if (!m_pkBytes)
        return;
    const auto pageSize = static_cast<size_t>(sysconf(_SC_PAGESIZE));
    const size_t length = std::min(endOffset, m_uiSize) / pageSize * pageSize;
    if (length > 0)
        madvise(PageAddress(m_pkBytes), length, MADV_DONTNEED);
}

} // namespace gw
