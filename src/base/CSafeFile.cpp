// Safe save. The bytes are written to a hidden file in the destination's folder, synced, and renamed over the
// destination, so at every moment a complete file exists: the old one or the new one. The file must be in the
// same folder because a rename is atomic only within one file system.
//
// A replaced file keeps its group and permissions. While the bytes are written, the hidden file is readable
// by the user only; the permissions are set just before the rename. If nothing may be replaced
// (KeepExisting), the rename is one that fails if the destination exists, or a hard link, or a claimed empty
// file, in this order: each works on file systems that lack the ones before.

#include "CSafeFile.h"

#include "Paths.h"
#include "SystemError.h"

#include <cerrno>
#include <cstdio>
#include <filesystem>
#include <set>
#include <system_error>
#include <utility>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

constexpr unsigned kModeOfNew = 0666; // minus the user's umask, as for any new file
constexpr unsigned kModeWhileReplacing = 0600;
constexpr unsigned kPermissions = 0777; // set-id bits were granted to the old content only
constexpr unsigned kGroupBits = 070;
// Not the destination's extension, so that a program that lists files by extension never sees a half-written
// one.
constexpr std::string_view kPrivateExtension = ".tmp";

// Returns the end of a chain of symbolic links, whether or not a file exists there. Empty for a cycle.
std::string FollowLinks(const std::string& path)
{
    constexpr int kLinkLimit = 40; // the system's limit
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

bool IsThere(const std::string& path)
{
    struct stat status;
    return lstat(path.c_str(), &status) == 0;
}

// Of this thread, because a thread opens the file that it has asked to keep.
std::set<std::string>& KeptPaths()
{
    thread_local std::set<std::string> paths;
    return paths;
}

// Claims a free name with an empty file, for file systems without hard links. A crash can leave that file
// behind.
bool RenameToClaimed(const char* from, const char* to)
{
    const int file = open(to, O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, kModeWhileReplacing);
    if (file < 0)
        return false;
    close(file);
    if (rename(from, to) == 0)
        return true;
    unlink(to);
    return false;
}

// Renames without replacing anything; fails with EEXIST if the destination exists. NFS and some others lack
// the first call, FAT lacks the second.
bool RenameToFree(const char* from, const char* to)
{
    if (renameat2(AT_FDCWD, from, AT_FDCWD, to, RENAME_NOREPLACE) == 0)
        return true;
    if (errno != EINVAL && errno != ENOSYS && errno != ENOTSUP)
        return false;
    if (link(from, to) == 0)
    {
        unlink(from);
        return true;
    }
    return errno != EEXIST && RenameToClaimed(from, to);
}

} // namespace

CSafeFile::CommitGate CSafeFile::ms_kCommitGate;
bool CSafeFile::ms_bSyncsDeferred = false;

void CSafeFile::SetCommitGate(CommitGate gate)
{
    ms_kCommitGate = std::move(gate);
}

void CSafeFile::KeepExisting(const std::string& path)
{
    KeptPaths().insert(path);
}

void CSafeFile::ReplaceExisting(const std::string& path)
{
    KeptPaths().erase(path);
}

CSafeFile::~CSafeFile()
{
    Discard();
}

bool CSafeFile::Open(const std::string& path)
{
    Discard();
    ForgetSystemError();
    m_eFailure = EFailure::WriteError;
    m_bKeeps = KeptPaths().erase(path) > 0;
    if (m_bKeeps && IsThere(path))
    {
        m_eFailure = EFailure::Exists;
        return false;
    }
    m_kPath = FollowLinks(path);
    const std::string folder = FolderOf(m_kPath);
    if (m_kPath == folder || !MayReplace())
        return false;
    // A file that others may not read stays unreadable while it is being written. Commit restores the old
    // permissions.
    if (!m_kPrivate.Create(folder, kPrivateExtension, m_uiMode ? kModeWhileReplacing : kModeOfNew))
        return false;
    m_eFailure = EFailure::None;
    return true;
}

// Checks that the path is free or holds a file that may be replaced, and records its mode and group.
bool CSafeFile::MayReplace()
{
    struct stat status;
    if (stat(m_kPath.c_str(), &status) != 0)
    {
        const bool isFree = errno == ENOENT;
        if (!isFree)
            KeepSystemError();
        return isFree;
    }
    m_uiMode = status.st_mode & kPermissions;
    m_uiGroup = status.st_gid;
    if (!S_ISREG(status.st_mode) || !IsReadOnly(m_kPath))
        return S_ISREG(status.st_mode);
    // root may write to a file without write bits, but then nobody is meant to
    KeepSystemError(access(m_kPath.c_str(), W_OK) == 0 ? EACCES : errno);
    return false;
}

bool CSafeFile::Write(std::string_view text)
{
    m_bFailed = m_bFailed || m_kPrivate.File() < 0 || !WriteAll(m_kPrivate.File(), text);
    return !m_bFailed;
}

bool CSafeFile::Write(std::span<const std::byte> bytes)
{
    return Write(std::string_view(reinterpret_cast<const char*>(bytes.data()), bytes.size()));
}

bool CSafeFile::Rewrite(uint64_t offset, std::span<const std::byte> bytes)
{
    const std::string_view text(reinterpret_cast<const char*>(bytes.data()), bytes.size());
    m_bFailed = m_bFailed || m_kPrivate.File() < 0 || !WriteAllAt(m_kPrivate.File(), text, offset);
    return !m_bFailed;
}

bool CSafeFile::Commit()
{
    if (m_kPrivate.File() < 0)
        return false;
    errno = 0; // a commit that the run refuses has no system error
    const bool isWritten = !m_bFailed;
    const bool good = isWritten && KeepOwnership() && Sync() && Rename();
    if (isWritten && !good)
        KeepSystemError();
    if (good)
        m_kPrivate.Release();
    else if (m_eFailure == EFailure::None)
        m_eFailure = EFailure::WriteError;
    Discard();
    return good;
}

// If the user may not assign the file to its old group, the new group must not get the old group's
// permissions.
bool CSafeFile::KeepOwnership()
{
    if (m_uiMode == 0)
        return true;
    struct stat status;
    if (fstat(m_kPrivate.File(), &status) != 0)
        return false;
    unsigned mode = m_uiMode;
    if (status.st_gid != m_uiGroup && fchown(m_kPrivate.File(), static_cast<uid_t>(-1), m_uiGroup) != 0)
        mode = (mode & ~kGroupBits) | (mode & (mode << 3) & kGroupBits);
    return fchmod(m_kPrivate.File(), mode) == 0;
}

// Some file systems report write errors only on close. The lock, and with it the name, stays with the other
// descriptor.
bool CSafeFile::Sync() const
{
    const int file = m_kPrivate.File();
    const bool isLater = ms_bSyncsDeferred && m_uiMode == 0;
    if (isLater) // starts writing to disk now, so the later sync of all files has less to do
        sync_file_range(file, 0, 0, SYNC_FILE_RANGE_WRITE);
    if ((!isLater && fsync(file) != 0) || (ms_kCommitGate && !ms_kCommitGate(m_kPrivate.Path())))
        return false;
    const int copy = fcntl(file, F_DUPFD_CLOEXEC, 0);
    return copy < 0 || close(copy) == 0;
}

bool CSafeFile::Rename()
{
    const char* const from = m_kPrivate.Path().c_str();
    if (!m_bKeeps)
        return rename(from, m_kPath.c_str()) == 0;
    if (RenameToFree(from, m_kPath.c_str()))
        return true;
    if (errno == EEXIST)
        m_eFailure = EFailure::Exists;
    return false;
}

void CSafeFile::Discard()
{
    m_kPrivate.Remove();
    m_kPath.clear();
    m_uiMode = 0;
    m_bFailed = false;
}

} // namespace gw
