#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <functional>
#include <string>
#include <string_view>

namespace gw {

// The system's calls on files, each as thin as the systems allow. On all of them an open file is a descriptor
// of the C library, a path is UTF-8, and started programs inherit no file. A call that fails returns false or
// a negative number, and LastSystemError then has the reason.

/// How a file is opened.
enum class EOpen : uint8_t
{
    Read,        ///< does not wait for the other end of a pipe
    ReadStream,  ///< same, but waits
    Existing,    ///< for reading and writing; fails for a link
    New,         ///< for reading and writing; fails if anything has the name
    Overwrite,   ///< for writing, with its old content cut; fails for a link
    WriteStream, ///< for writing to a pipe or device; waits for its other end
    Append,      ///< for reading, and for writing at its end; created if it does not exist
    AppendAnew,  ///< same, with its old content cut
};

/// Opens a file. A new one gets the mode, minus the user's umask, where the system has modes. Returns a
/// descriptor, or a negative number.
int OpenFile(const std::string& path, EOpen how, unsigned mode = 0666);
/// Creates a file without a name in a folder that ends in a separator. It is gone once it is closed.
int OpenNameless(const std::string& folder);
/// Closes a file. Some file systems report write errors only here.
bool CloseFile(int file);
/// Makes a stream of the C library from a file, which closes it; null on failure. Line ends are not changed.
std::FILE* StreamOf(int file, const char* mode);

/// Opens a path as a stream of the C library with mode "r" or "w"; null on failure. Line ends are not
/// changed.
std::FILE* OpenStream(const std::string& path, const char* mode);
/// Return the standard streams, which no longer change line ends.
std::FILE* BinaryInput();
std::FILE* BinaryOutput();

/// Reads up to `size` bytes at the file's position. Returns their count, 0 at the end, or a negative number.
ptrdiff_t ReadSome(int file, void* bytes, size_t size);
/// Writes all bytes at the file's position or at an offset. If that fails, also keeps the reason
/// (KeepSystemError).
bool WriteAll(int file, std::string_view text);
bool WriteAllAt(int file, std::string_view text, uint64_t offset);
/// Cuts or extends a file to a size.
bool SetFileSize(int file, uint64_t byteCount);
/// Waits until the file is on disk.
bool SyncFile(int file);
/// Starts writing the file to disk without waiting for it. A hint only.
void StartSync(int file);

/// Returns the errors that some file systems report only when a file is closed, without closing it.
bool CloseCopy(int file);

enum class EFileKind : uint8_t
{
    Unknown, ///< only in a folder's listing, if the file system does not say
    Regular,
    Folder,
    Link,
    Other, ///< a device, pipe or socket
};

struct FileStatus
{
    EFileKind kind = EFileKind::Unknown;
    uint64_t device = 0;
    uint64_t inode = 0; ///< identifies the file, together with the device
    uint64_t linkCount = 0;
    uint64_t byteCount = 0;
    int64_t modified = 0; ///< nanoseconds since 1970
    int64_t changed = 0;  ///< same; also changes if `modified` is set back
    unsigned mode = 0;    ///< permissions
    unsigned group = 0;   ///< 0 where files have none
};

/// Gets the status of a path's file, following links; of the path itself, which can be a link; or of an open
/// file.
bool StatusOf(const std::string& path, FileStatus& status);
bool StatusOfLink(const std::string& path, FileStatus& status);
bool StatusOf(int file, FileStatus& status);

/// Gives a new file the permissions of the file that it replaces, whose mode and group are known. If it
/// cannot get the group, the new group gets no permissions of the old one.
bool CopyPermissions(int file, const std::string& replaced, unsigned mode, unsigned group);

/// Deletes a file or a link. Neither locks nor allocates, so signal handlers may call it.
bool RemoveFile(const char* path);
/// Deletes a folder if it is empty.
bool RemoveEmptyFolder(const std::string& path);
/// Renames a file, and replaces another in one step.
bool RenameFile(const std::string& from, const std::string& to);
/// Renames a file without replacing anything. If something has the name, fails with an error for which
/// IsNameTaken is true.
bool RenameToFree(const std::string& from, const std::string& to);

struct FolderEntry
{
    const char* name = nullptr;
    EFileKind kind = EFileKind::Unknown;
};

/// Calls a function for each entry of a folder, in the order of the file system, until it returns false.
/// Returns false if the folder cannot be read.
bool ListFolder(const std::string& folder, const std::function<bool(const FolderEntry&)>& visit);

/// Locks an open file for this descriptor until it is closed or its program ends.
enum class ELock : uint8_t
{
    Held,
    Taken, ///< another descriptor holds it
    None,  ///< the file system has no locks
};
ELock LockFile(int file);
/// Returns whether locks reach every program that can open the file: it is on a disk of this machine, or in
/// its memory.
bool IsOnLocalDisk(int file);

} // namespace gw
