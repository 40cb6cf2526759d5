#include "Files.h"

#include "CFolderFiles.h"
#include "SystemError.h"

#include <algorithm>
#include <cerrno>
#include <iterator>
#include <memory>

#include <dirent.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <sys/vfs.h>
#include <unistd.h>

namespace gw {

namespace {

// Without O_NONBLOCK, opening a named pipe would wait for its other end before it can be refused.
constexpr int kFlags[] = {
    O_RDONLY | O_NONBLOCK,                                  // Read
    O_RDONLY,                                               // ReadStream
    O_RDWR | O_NOFOLLOW | O_NONBLOCK,                       // Existing
    O_RDWR | O_CREAT | O_EXCL,                              // New
    O_WRONLY | O_CREAT | O_TRUNC | O_NOFOLLOW | O_NONBLOCK, // Overwrite
    O_WRONLY | O_CREAT | O_TRUNC,                           // WriteStream
    O_RDWR | O_CREAT | O_APPEND,                            // Append
    O_RDWR | O_CREAT | O_APPEND | O_TRUNC,                  // AppendAnew
};

// ext2 to ext4, XFS, Btrfs, F2FS, ZFS, bcachefs, tmpfs, ramfs, overlayfs.
constexpr uint32_t kLocalSystems[] = {0xEF53,     0x58465342, 0x9123683E, 0xF2F52010, 0x2FC12FC1,
                                      0xCA451A4E, 0x01021994, 0x858458F6, 0x794C7630};

constexpr unsigned kModeOfClaim = 0600;
constexpr unsigned kGroupBits = 070;

bool FailWrite()
{
    KeepSystemError();
    return false;
}

int64_t Nanoseconds(const timespec& time)
{
    return int64_t{time.tv_sec} * 1'000'000'000 + time.tv_nsec;
}

EFileKind KindOfMode(unsigned mode)
{
    if (S_ISREG(mode))
        return EFileKind::Regular;
    if (S_ISDIR(mode))
        return EFileKind::Folder;
    return S_ISLNK(mode) ? EFileKind::Link : EFileKind::Other;
}

// Most file systems list the type of each entry.
EFileKind KindOfEntry(const dirent& entry)
{
    return entry.d_type == DT_UNKNOWN ? EFileKind::Unknown : KindOfMode(DTTOIF(entry.d_type));
}

bool Take(int result, const struct stat& from, FileStatus& status)
{
    if (result != 0)
        return false;
    status = {.kind = KindOfMode(from.st_mode),
              .device = from.st_dev,
              .inode = from.st_ino,
              .linkCount = from.st_nlink,
              .byteCount = static_cast<uint64_t>(from.st_size),
              .modified = Nanoseconds(from.st_mtim),
              .changed = Nanoseconds(from.st_ctim),
              .mode = from.st_mode & 07777,
              .group = from.st_gid};
    return true;
}

// Claims a free name with an empty file, for file systems without hard links. A crash can leave that file
// behind.
bool RenameToClaimed(const char* from, const char* to)
{
    const int file = open(to, O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, kModeOfClaim);
    if (file < 0)
        return false;
    close(file);
    if (rename(from, to) == 0)
        return true;
    unlink(to);
    return false;
}

} // namespace

int OpenFile(const std::string& path, EOpen how, unsigned mode)
{
    return open(path.c_str(), kFlags[static_cast<size_t>(how)] | O_CLOEXEC, mode);
}

int OpenNameless(const std::string& folder)
{
    std::string path = folder + "gaitwright-XXXXXX";
    const int file = mkostemp(path.data(), O_CLOEXEC);
    if (file >= 0)
        unlink(path.c_str());
    return file;
}

bool CloseFile(int file)
{
    return close(file) == 0;
}

std::FILE* StreamOf(int file, const char* mode)
{
    return fdopen(file, mode);
}

std::FILE* OpenStream(const std::string& path, const char* mode)
{
    return std::fopen(path.c_str(), (std::string(mode) + 'e').c_str());
}

std::FILE* BinaryInput()
{
    return stdin;
}

std::FILE* BinaryOutput()
{
    return stdout;
}

ptrdiff_t ReadSome(int file, void* bytes, size_t size)
{
    ssize_t count = -1;
    do
        count = read(file, bytes, size);
    while (count < 0 && errno == EINTR);
    return count;
}

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

bool SetFileSize(int file, uint64_t byteCount)
{
    return ftruncate(file, static_cast<off_t>(byteCount)) == 0;
}

bool SyncFile(int file)
{
    return fsync(file) == 0;
}

void StartSync(int file)
{
    sync_file_range(file, 0, 0, SYNC_FILE_RANGE_WRITE);
}

// The lock, and with it the private name, stays with the other descriptor.
bool CloseCopy(int file)
{
    const int copy = fcntl(file, F_DUPFD_CLOEXEC, 0);
    return copy < 0 || close(copy) == 0;
}

bool StatusOf(const std::string& path, FileStatus& status)
{
    struct stat from;
    return Take(stat(path.c_str(), &from), from, status);
}

bool StatusOfLink(const std::string& path, FileStatus& status)
{
    struct stat from;
    return Take(lstat(path.c_str(), &from), from, status);
}

bool StatusOf(int file, FileStatus& status)
{
    struct stat from;
    return Take(fstat(file, &from), from, status);
}

bool CopyPermissions(int file, const std::string&, unsigned mode, unsigned group)
{
    struct stat status;
    if (fstat(file, &status) != 0)
        return false;
    if (status.st_gid != group && fchown(file, static_cast<uid_t>(-1), group) != 0)
        mode = (mode & ~kGroupBits) | (mode & (mode << 3) & kGroupBits);
    return fchmod(file, mode) == 0;
}

bool RemoveFile(const char* path)
{
    return unlink(path) == 0;
}

bool RemoveEmptyFolder(const std::string& path)
{
    return rmdir(path.c_str()) == 0;
}

bool RenameFile(const std::string& from, const std::string& to)
{
    return rename(from.c_str(), to.c_str()) == 0;
}

// NFS and some others lack the first call, FAT lacks the second.
bool RenameToFree(const std::string& from, const std::string& to)
{
    if (renameat2(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str(), RENAME_NOREPLACE) == 0)
        return true;
    if (errno != EINVAL && errno != ENOSYS && errno != ENOTSUP)
        return false;
    if (link(from.c_str(), to.c_str()) == 0)
    {
        unlink(from.c_str());
        return true;
    }
    return errno != EEXIST && RenameToClaimed(from.c_str(), to.c_str());
}

// Not with the standard library's iterator: it ends the program if there is not enough memory for a path.
bool ListFolder(const std::string& folder, const std::function<bool(const FolderEntry&)>& visit)
{
    const std::unique_ptr<DIR, int (*)(DIR*)> directory(opendir(folder.c_str()), closedir);
    while (const dirent* const entry = directory ? readdir(directory.get()) : nullptr)
    {
        if (!visit({entry->d_name, KindOfEntry(*entry)}))
            break;
    }
    return directory != nullptr;
}

CFolderFiles::CFolderFiles(const std::string& folder)
    : m_iFile(open(folder.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC))
{
}

CFolderFiles::~CFolderFiles()
{
    if (m_iFile >= 0)
        close(m_iFile);
}

bool CFolderFiles::StatusOf(const char* name, FileStatus& status) const
{
    struct stat from;
    return m_iFile >= 0 && Take(fstatat(m_iFile, name, &from, 0), from, status);
}

ELock LockFile(int file)
{
    if (flock(file, LOCK_EX | LOCK_NB) == 0)
        return ELock::Held;
    return errno == EWOULDBLOCK || errno == EINTR ? ELock::Taken : ELock::None;
}

bool IsOnLocalDisk(int file)
{
    struct statfs status;
    return fstatfs(file, &status) == 0 &&
           std::ranges::find(kLocalSystems, static_cast<uint32_t>(status.f_type)) != std::end(kLocalSystems);
}

} // namespace gw
