#include "CMappedFile.h"

#include "WatchedRange.h"

#include <algorithm>
#include <cerrno>
#include <utility>

#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

void* PageAddress(const std::byte* bytes)
{
    return const_cast<std::byte*>(bytes); // system calls take a pointer to non-const
}

} // namespace

EFailure CMappedFile::Map(int file, size_t size)
{
    void* const mapped = mmap(nullptr, size, PROT_READ, MAP_PRIVATE, file, 0);
    if (mapped == MAP_FAILED)
        return errno == ENOMEM ? EFailure::OutOfMemory : EFailure::ReadError;
    m_pkRange = Watch(mapped, size);
    if (!m_pkRange) // more mapped files at a time than any program here needs
    {
        munmap(mapped, size);
        return Read(file, size);
    }
    // A hint only: files are read from front to back once.
    madvise(mapped, size, MADV_SEQUENTIAL);
    m_pkBytes = static_cast<const std::byte*>(mapped);
    m_uiSize = size;
    m_iFile = file;
    return EFailure::None;
}

void CMappedFile::Unmap()
{
    Unwatch(std::exchange(m_pkRange, nullptr));
    munmap(PageAddress(m_pkBytes), m_uiSize);
    close(std::exchange(m_iFile, -1));
}

// A file that is truncated within its last page raises no signal, so its size is compared too.
bool CMappedFile::IsWhole() const
{
    if (!IsMapped())
        return true;
    struct stat status;
    return !m_pkRange->cut && fstat(m_iFile, &status) == 0 && static_cast<size_t>(status.st_size) >= m_uiSize;
}

void CMappedFile::Forget(size_t endOffset)
{
    if (!IsMapped())
        return;
    const auto pageSize = static_cast<size_t>(sysconf(_SC_PAGESIZE));
    const size_t length = std::min(endOffset, m_uiSize) / pageSize * pageSize;
    if (length > 0)
        madvise(PageAddress(m_pkBytes), length, MADV_DONTNEED);
}

} // namespace gw
