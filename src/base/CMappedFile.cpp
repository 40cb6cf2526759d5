#include "CMappedFile.h"

#include "SystemError.h"
#include "WatchedRange.h"

#include <algorithm>
#include <cerrno>
#include <utility>

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

// Up to this size, reading is as fast as mapping with its page faults, and other programs cannot disturb it
// later.
constexpr size_t kReadBytes = size_t{1} << 20;

void* PageAddress(const std::byte* bytes)
{
    return const_cast<std::byte*>(bytes); // system calls take a pointer to non-const
}

} // namespace

CMappedFile::~CMappedFile()
{
    Close();
}

CMappedFile::CMappedFile(CMappedFile&& other) noexcept
    : m_spkSmall(std::move(other.m_spkSmall)), m_pkBytes(std::exchange(other.m_pkBytes, nullptr)),
      m_uiSize(std::exchange(other.m_uiSize, 0)), m_iFile(std::exchange(other.m_iFile, -1)),
      m_pkRange(std::exchange(other.m_pkRange, nullptr))
{
}

CMappedFile& CMappedFile::operator=(CMappedFile&& other) noexcept
{
    std::swap(m_spkSmall, other.m_spkSmall);
    std::swap(m_pkBytes, other.m_pkBytes);
    std::swap(m_uiSize, other.m_uiSize);
    std::swap(m_iFile, other.m_iFile);
    std::swap(m_pkRange, other.m_pkRange);
    return *this;
}

EFailure CMappedFile::Open(const std::string& path)
{
    Close();
    ForgetSystemError();
    // Without O_NONBLOCK, opening a named pipe would wait for a writer before it can be refused.
    const int file = open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    if (file < 0)
    {
        KeepSystemError();
        return EFailure::NotFound;
    }
    const EFailure failure = Take(file);
    if (IsOfSystem(failure))
        KeepSystemError();
    if (m_iFile < 0)
        close(file);
    return failure;
}

EFailure CMappedFile::Take(int file)
{
    struct stat status;
    if (fstat(file, &status) != 0)
        return EFailure::NotFound;
    if (!S_ISREG(status.st_mode))
        return EFailure::NotRegular;
    const auto size = static_cast<size_t>(status.st_size);
    return size <= kReadBytes ? Read(file, size) : Map(file, size);
}

EFailure CMappedFile::Read(int file, size_t size)
{
    auto bytes = std::make_unique_for_overwrite<std::byte[]>(size);
    size_t done = 0;
    while (done < size)
    {
        const ssize_t count = read(file, bytes.get() + done, size - done);
        if (count < 0 && errno != EINTR)
            return EFailure::ReadError;
        if (count == 0)
            return EFailure::Changed;
        done += static_cast<size_t>(std::max<ssize_t>(count, 0));
    }
    m_spkSmall = std::move(bytes);
    m_pkBytes = m_spkSmall.get();
    m_uiSize = size;
    return EFailure::None;
}

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

// A file that is truncated within its last page raises no signal, so its size is compared too.
bool CMappedFile::IsWhole() const
{
    if (!IsMapped())
        return true;
    struct stat status;
    return !m_pkRange->cut && fstat(m_iFile, &status) == 0 && static_cast<size_t>(status.st_size) >= m_uiSize;
}

void CMappedFile::Close()
{
    if (IsMapped())
    {
        Unwatch(std::exchange(m_pkRange, nullptr));
        munmap(PageAddress(m_pkBytes), m_uiSize);
        close(std::exchange(m_iFile, -1));
    }
    m_spkSmall.reset();
    m_pkBytes = nullptr;
    m_uiSize = 0;
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
