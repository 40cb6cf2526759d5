#include "CSafeFile.h"

#include "CPrivateFile.h"
#include "Paths.h"
#include "PrivateNames.h"

#include <cerrno>
#include <filesystem>
#include <system_error>
#include <utility>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

constexpr unsigned kModeOfNew = 0666; // less the user's mask, as for any new file
constexpr unsigned kModeBits = 07777;
// Not the destination's, so that nobody who lists a folder by extension finds a half-written file.
constexpr std::string_view kPrivateExtension = ".tmp";

// Where a chain of symbolic links leads, be there a file or not. Empty for a ring.
std::string FollowLinks(const std::string& path)
{
    constexpr int kLinkLimit = 40; // the system's own
    std::filesystem::path target(path);
    for (int i = 0; i < kLinkLimit; ++i)
    {
        std::error_code error;
        const std::filesystem::path next = std::filesystem::read_symlink(target, error);
        if (error)
            return target.string();
        target = target.parent_path() / next;
    }
    return {};
}

// Whether a path is free or holds a file that may be replaced. `mode` becomes the file's, or 0 where the path
// is free.
bool MayReplace(const std::string& path, unsigned& mode)
{
    struct stat status;
    mode = 0;
    if (stat(path.c_str(), &status) != 0)
        return errno == ENOENT;
    mode = status.st_mode & kModeBits;
    return S_ISREG(status.st_mode) && !IsReadOnly(path);
}

} // namespace

CSafeFile::CommitGate CSafeFile::ms_kCommitGate;
bool CSafeFile::ms_bSyncsDeferred = false;

void CSafeFile::SetCommitGate(CommitGate gate)
{
    ms_kCommitGate = std::move(gate);
}

CSafeFile::~CSafeFile()
{
    Discard();
}

bool CSafeFile::Open(const std::string& path)
{
    Discard();
    m_kPath = FollowLinks(path);
    const std::string folder = FolderOf(m_kPath);
    if (m_kPath == folder || !MayReplace(m_kPath, m_uiMode))
        return false;
    // A file that others may not read is not laid open while it is written.
    const unsigned mode = m_uiMode ? m_uiMode : kModeOfNew;
    m_iFile = CreatePrivateFile(folder, kPrivateExtension, mode, m_kPrivatePath);
    return m_iFile >= 0;
}

bool CSafeFile::Write(std::string_view text)
{
    while (m_iFile >= 0 && !m_bFailed && !text.empty())
    {
        const ssize_t written = write(m_iFile, text.data(), text.size());
        if (written >= 0)
            text.remove_prefix(static_cast<size_t>(written));
        else if (errno != EINTR)
            m_bFailed = true;
    }
    return m_iFile >= 0 && !m_bFailed;
}

bool CSafeFile::Write(std::span<const std::byte> bytes)
{
    return Write(std::string_view(reinterpret_cast<const char*>(bytes.data()), bytes.size()));
}

bool CSafeFile::Rewrite(uint64_t offset, std::span<const std::byte> bytes)
{
    while (m_iFile >= 0 && !m_bFailed && !bytes.empty())
    {
        const ssize_t written = pwrite(m_iFile, bytes.data(), bytes.size(), static_cast<off_t>(offset));
        if (written >= 0)
        {
            bytes = bytes.subspan(static_cast<size_t>(written));
            offset += static_cast<uint64_t>(written);
        }
        else if (errno != EINTR)
            m_bFailed = true;
    }
    return m_iFile >= 0 && !m_bFailed;
}

bool CSafeFile::Commit()
{
    const int file = std::exchange(m_iFile, -1);
    if (file < 0)
        return false;
    bool good = !m_bFailed && (m_uiMode == 0 || fchmod(file, m_uiMode) == 0) && Sync(file);
    good = close(file) == 0 && good;
    good = good && rename(m_kPrivatePath.c_str(), m_kPath.c_str()) == 0;
    if (good)
        m_kPrivatePath.clear();
    Discard();
    return good;
}

bool CSafeFile::Sync(int file) const
{
    if (IsPrivateName(std::string_view(m_kPath).substr(FolderOf(m_kPath).size())))
        return true;
    const bool isLater = ms_bSyncsDeferred && m_uiMode == 0;
    if (isLater) // the disk begins now, so that little is left for the sync of all
        sync_file_range(file, 0, 0, SYNC_FILE_RANGE_WRITE);
    return (isLater || fsync(file) == 0) && (!ms_kCommitGate || ms_kCommitGate(m_kPrivatePath));
}

void CSafeFile::Discard()
{
    if (m_iFile >= 0)
        close(std::exchange(m_iFile, -1));
    if (!m_kPrivatePath.empty())
        unlink(m_kPrivatePath.c_str());
    m_kPrivatePath.clear();
    m_kPath.clear();
    m_uiMode = 0;
    m_bFailed = false;
}

} // namespace gw
