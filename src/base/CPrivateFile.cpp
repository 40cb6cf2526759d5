#include "CPrivateFile.h"

#include "LiveNames.h"
#include "Paths.h"
#include "PrivateNames.h"
#include "SystemError.h"

#include <cerrno>
#include <utility>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

bool FailWrite()
{
    KeepSystemError();
    return false;
}

} // namespace

bool WriteAll(int file, std::string_view text)
{
    while (!text.empty())
    {
        const ssize_t written = write(file, text.data(), text.size());
        if (written < 0 && errno != EINTR)
            return FailWrite();
        text.remove_prefix(written < 0 ? 0 : static_cast<size_t>(written));
    }
    return true;
}

bool WriteAllAt(int file, std::string_view text, uint64_t offset)
{
    while (!text.empty())
    {
        const ssize_t written = pwrite(file, text.data(), text.size(), static_cast<off_t>(offset));
        if (written < 0 && errno != EINTR)
            return FailWrite();
        const size_t count = written < 0 ? 0 : static_cast<size_t>(written);
        text.remove_prefix(count);
        offset += count;
    }
    return true;
}

CPrivateFile::CPrivateFile(const std::string& besidePath, std::string_view extension)
{
    Create(FolderOf(besidePath), extension, S_IRUSR | S_IWUSR);
}

CPrivateFile::~CPrivateFile()
{
    Remove();
}

bool CPrivateFile::Create(const std::string& folder, std::string_view extension, unsigned mode)
{
    constexpr int kAttempts = 16; // even a second attempt is extremely rare
    Remove();
    SweepOnce(folder);
    for (int i = 0; i < kAttempts; ++i)
    {
        m_kPath = PrivateName(folder, extension);
        // before the file exists, because a signal could arrive in between
        m_iLiveName = AddLiveName(m_kPath);
        m_iFile = open(m_kPath.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, mode);
        const bool isTaken = m_iFile < 0 && errno == EEXIST;
        if (m_iFile < 0)
            KeepSystemError();
        if (m_iFile >= 0 && LockNewFile(m_iFile))
            return true;
        const bool isSwept = m_iFile >= 0;
        Release();
        if (!isTaken && !isSwept)
            break;
    }
    return false;
}

bool CPrivateFile::CreateTemporary(std::string_view extension)
{
    const std::string folder = TemporaryFolder();
    return !folder.empty() && Create(folder, extension, S_IRUSR | S_IWUSR);
}

bool CPrivateFile::Write(std::string_view text)
{
    return m_iFile >= 0 && ftruncate(m_iFile, 0) == 0 && WriteAllAt(m_iFile, text, 0);
}

void CPrivateFile::Remove()
{
    // Deleted while it is still locked; otherwise another program could delete it at the same time.
    if (m_iFile >= 0)
        unlink(m_kPath.c_str());
    Release();
}

void CPrivateFile::Release()
{
    if (m_iFile >= 0)
        close(std::exchange(m_iFile, -1));
    RemoveLiveName(std::exchange(m_iLiveName, -1));
    m_kPath.clear();
}

} // namespace gw
