#include "CMappedFile.h"

#include "Files.h"
#include "SystemError.h"

#include <utility>

namespace gw {

namespace {

// Up to this size, reading is as fast as mapping with its page faults, and other programs cannot disturb it
// later.
constexpr size_t kReadBytes = size_t{1} << 20;

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
    const int file = OpenFile(path, EOpen::Read);
    if (file < 0)
    {
        KeepSystemError();
        return EFailure::NotFound;
    }
    const EFailure failure = Take(file);
    if (IsOfSystem(failure))
        KeepSystemError();
    if (m_iFile < 0)
        CloseFile(file);
    return failure;
}

EFailure CMappedFile::Take(int file)
{
    FileStatus status;
    if (!StatusOf(file, status))
        return EFailure::NotFound;
    if (status.kind != EFileKind::Regular)
        return EFailure::NotRegular;
    const auto size = static_cast<size_t>(status.byteCount);
    return size <= kReadBytes ? Read(file, size) : Map(file, size);
}

EFailure CMappedFile::Read(int file, size_t size)
{
    auto bytes = std::make_unique_for_overwrite<std::byte[]>(size);
    size_t done = 0;
    while (done < size)
    {
        const ptrdiff_t count = ReadSome(file, bytes.get() + done, size - done);
        if (count < 0)
            return EFailure::ReadError;
        if (count == 0)
            return EFailure::Changed;
        done += static_cast<size_t>(count);
    }
    m_spkSmall = std::move(bytes);
    m_pkBytes = m_spkSmall.get();
    m_uiSize = size;
    return EFailure::None;
}

void CMappedFile::Close()
{
    if (IsMapped())
        Unmap();
    m_spkSmall.reset();
    m_pkBytes = nullptr;
    m_uiSize = 0;
}

} // namespace gw
