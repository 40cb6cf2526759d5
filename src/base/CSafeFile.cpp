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

#include <mutex>
#include <set>
#include <thread>
#include <utility>

namespace gw {

namespace {

constexpr unsigned kModeOfNew = 0666; // minus the user's umask, as for any new file
constexpr unsigned kModeWhileReplacing = 0600;
constexpr unsigned kPermissions = 0777; // set-id bits were granted to the old content only
// Not the destination's extension, so that a program that lists files by extension never sees a half-written
// one.
constexpr std::string_view kPrivateExtension = ".tmp";

bool IsThere(const std::string& path)
{
    FileStatus status;
    return StatusOfLink(path, status);
}

// The files that are not to be replaced, each with the thread that asked: it is the one that opens the file.
// One set for all threads, because without memory, the first use of a thread's own set would end the program.
class CKeptPaths
{
public:
    void Add(const std::string& path)
    {
        const std::scoped_lock lock(m_kMutex);
        m_kPaths.emplace(std::this_thread::get_id(), path);
    }
    /// Returns whether the path was in the set.
    bool Remove(const std::string& path)
    {
        const std::scoped_lock lock(m_kMutex);
        return m_kPaths.erase({std::this_thread::get_id(), path}) > 0;
    }

private:
    std::mutex m_kMutex;
    std::set<std::pair<std::thread::id, std::string>> m_kPaths;
};

CKeptPaths& KeptPaths()
{
    static CKeptPaths paths;
    return paths;
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
    KeptPaths().Add(path);
}

void CSafeFile::ReplaceExisting(const std::string& path)
{
    KeptPaths().Remove(path);
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
    m_bKeeps = KeptPaths().Remove(path);
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
    FileStatus status;
    if (!StatusOf(m_kPath, status))
    {
        const bool isFree = IsNotFound(LastSystemError());
        if (!isFree)
            KeepSystemError();
        return isFree;
    }
    m_uiMode = status.mode & kPermissions;
    m_uiGroup = status.group;
    const bool isRegular = status.kind == EFileKind::Regular;
    if (!isRegular || !IsReadOnly(m_kPath))
        return isRegular;
    KeepSystemError();
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
    ClearLastSystemError(); // a commit that the run refuses has no system error
    const bool isWritten = !m_bFailed;
    const bool good = isWritten && KeepPermissions() && Sync() && Rename();
    if (isWritten && !good)
        KeepSystemError();
    if (good)
        m_kPrivate.Release();
    else if (m_eFailure == EFailure::None)
        m_eFailure = EFailure::WriteError;
    Discard();
    return good;
}

bool CSafeFile::KeepPermissions() const
{
    return m_uiMode == 0 || CopyPermissions(m_kPrivate.File(), m_kPath, m_uiMode, m_uiGroup);
}

bool CSafeFile::Sync() const
{
    const int file = m_kPrivate.File();
    const bool isLater = ms_bSyncsDeferred && m_uiMode == 0;
    if (isLater) // starts writing to disk now, so the later sync of all files has less to do
        StartSync(file);
    if ((!isLater && !SyncFile(file)) || (ms_kCommitGate && !ms_kCommitGate(m_kPrivate.Path())))
        return false;
    return CloseCopy(file);
}

bool CSafeFile::Rename()
{
    if (!m_bKeeps)
        return RenameFile(m_kPrivate.Path(), m_kPath);
    if (RenameToFree(m_kPrivate.Path(), m_kPath))
        return true;
    if (IsNameTaken(LastSystemError()))
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
