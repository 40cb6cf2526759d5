// Descriptors of the C library stand for handles of the system, which all calls are made on: the library
// would change line ends, and keeps fewer reasons of failures. All files are opened with every kind of
// sharing, so that they can be renamed and deleted while they are open, as on other systems.

#include "Files.h"

#include "CFolderFiles.h"
#include "Paths.h"
#include "Processes.h"
#include "SystemError.h"
#include "WindowsCalls.h"

#include <algorithm>
#include <cstring>
#include <memory>
#include <vector>

#include <fcntl.h>
#include <io.h>

namespace gw {

namespace {

// GENERIC_WRITE without the right to write elsewhere than at the end.
constexpr DWORD kAppend = FILE_GENERIC_WRITE & ~static_cast<DWORD>(FILE_WRITE_DATA);

struct OpenRow
{
    DWORD access;
    DWORD creation;
    DWORD flags;
};

// Without backup semantics, folders cannot be opened to find out that they are none.
constexpr OpenRow kOpen[] = {
    {GENERIC_READ,                             OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS  }, // Read
    {GENERIC_READ,                             OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS  }, // ReadStream
    {GENERIC_READ | GENERIC_WRITE,             OPEN_EXISTING, FILE_FLAG_OPEN_REPARSE_POINT}, // Existing
    {GENERIC_READ | GENERIC_WRITE | WRITE_DAC, CREATE_NEW,    0                           }, // New
    {GENERIC_WRITE,                            OPEN_ALWAYS,   FILE_FLAG_OPEN_REPARSE_POINT}, // Overwrite
    {GENERIC_WRITE,                            OPEN_EXISTING, 0                           }, // WriteStream
    {FILE_GENERIC_READ | kAppend,              OPEN_ALWAYS,   0                           }, // Append
    {FILE_GENERIC_READ | kAppend,              CREATE_ALWAYS, 0                           }, // AppendAnew
};

constexpr DWORD kLargestPiece = DWORD{1} << 30;
constexpr unsigned kModeOfReadOnly = 0444;
constexpr unsigned kModeOfOthers = 0666;

HANDLE HandleOf(int file)
{
    // NOLINTNEXTLINE(performance-no-int-to-ptr): the C library has handles as numbers
    return reinterpret_cast<HANDLE>(_get_osfhandle(file));
}

int DescriptorOf(HANDLE handle)
{
    if (handle == INVALID_HANDLE_VALUE)
        return -1;
    const int file = _open_osfhandle(reinterpret_cast<intptr_t>(handle), _O_BINARY | _O_NOINHERIT);
    if (file < 0)
    {
        CloseHandle(handle);
        SetLastError(ERROR_TOO_MANY_OPEN_FILES);
    }
    return file;
}

bool FailWrite()
{
    KeepSystemError();
    return false;
}

bool IsLinkItself(HANDLE file)
{
    FILE_ATTRIBUTE_TAG_INFO info;
    return GetFileInformationByHandleEx(file, FileAttributeTagInfo, &info, sizeof info) &&
           (info.FileAttributes & FILE_ATTRIBUTE_REPARSE_POINT) != 0 &&
           (info.ReparseTag == IO_REPARSE_TAG_SYMLINK || info.ReparseTag == IO_REPARSE_TAG_MOUNT_POINT);
}

int64_t Nanoseconds(uint64_t systemTime)
{
    constexpr uint64_t kFrom1601To1970 = 116'444'736'000'000'000;
    return static_cast<int64_t>((systemTime - kFrom1601To1970) * 100);
}

uint64_t Joined(DWORD high, DWORD low)
{
    return uint64_t{high} << 32 | low;
}

EFileKind KindOf(DWORD attributes)
{
    return (attributes & FILE_ATTRIBUTE_DIRECTORY) != 0 ? EFileKind::Folder : EFileKind::Regular;
}

bool StatusOfHandle(HANDLE file, FileStatus& status)
{
    const DWORD type = GetFileType(file);
    if (type != FILE_TYPE_DISK)
    {
        status = {.kind = EFileKind::Other};
        return type != FILE_TYPE_UNKNOWN || GetLastError() == ERROR_SUCCESS;
    }
    BY_HANDLE_FILE_INFORMATION from;
    if (!GetFileInformationByHandle(file, &from))
        return false;
    const uint64_t modified = Joined(from.ftLastWriteTime.dwHighDateTime, from.ftLastWriteTime.dwLowDateTime);
    FILE_BASIC_INFO basic;
    const bool hasBasic = GetFileInformationByHandleEx(file, FileBasicInfo, &basic, sizeof basic) != 0;
    FILE_STANDARD_INFO standard;
    const bool isDeleted = GetFileInformationByHandleEx(file, FileStandardInfo, &standard, sizeof standard) &&
                           standard.DeletePending;
    const bool isReadOnly = (from.dwFileAttributes & FILE_ATTRIBUTE_READONLY) != 0;
    status = {.kind = IsLinkItself(file) ? EFileKind::Link : KindOf(from.dwFileAttributes),
              .device = from.dwVolumeSerialNumber,
              .inode = Joined(from.nFileIndexHigh, from.nFileIndexLow),
              .linkCount = isDeleted ? 0 : from.nNumberOfLinks,
              .byteCount = Joined(from.nFileSizeHigh, from.nFileSizeLow),
              .modified = Nanoseconds(modified),
              .changed = Nanoseconds(hasBasic ? static_cast<uint64_t>(basic.ChangeTime.QuadPart) : modified),
              .mode = isReadOnly ? kModeOfReadOnly : kModeOfOthers};
    return true;
}

bool StatusOfPath(const std::string& path, DWORD flags, FileStatus& status)
{
    const CHandle file(CreateFileW(WidePath(path).c_str(), FILE_READ_ATTRIBUTES, kShareAll, nullptr,
                                   OPEN_EXISTING, flags | FILE_FLAG_BACKUP_SEMANTICS, nullptr));
    return file && StatusOfHandle(file.Get(), status);
}

// Another program, such as a virus scanner, can have a file open for a moment.
bool IsPassing(DWORD error)
{
    return error == ERROR_ACCESS_DENIED || error == ERROR_SHARING_VIOLATION;
}

// Replaces a file that others are reading, which one call cannot do on every version of the system: it is
// renamed first, and is gone when they close it. Not to a private name, which a sweep could delete if the
// program ended here.
bool ReplaceOpenFile(const std::wstring& from, const std::wstring& to)
{
    constexpr DWORD kKept = FILE_ATTRIBUTE_READONLY | FILE_ATTRIBUTE_DIRECTORY;
    const std::wstring aside = to + L".replaced-" + std::to_wstring(GetCurrentProcessId());
    if ((GetFileAttributesW(to.c_str()) & kKept) != 0 || !MoveFileExW(to.c_str(), aside.c_str(), 0))
    {
        SetLastError(ERROR_ACCESS_DENIED);
        return false;
    }
    const bool isReplaced = MoveFileExW(from.c_str(), to.c_str(), 0) != 0;
    const DWORD error = GetLastError();
    if (isReplaced)
        DeleteFileW(aside.c_str());
    else
        MoveFileExW(aside.c_str(), to.c_str(), 0);
    SetLastError(error);
    return isReplaced;
}

bool Replace(const std::wstring& from, const std::wstring& to)
{
    return MoveFileExW(from.c_str(), to.c_str(), MOVEFILE_REPLACE_EXISTING) ||
           (GetLastError() == ERROR_ACCESS_DENIED && ReplaceOpenFile(from, to));
}

// Writes at the file's position, or at the one in `place`.
bool WriteAt(HANDLE file, std::string_view text, OVERLAPPED* place)
{
    while (!text.empty())
    {
        DWORD written = 0;
        const auto size = static_cast<DWORD>(std::min<size_t>(text.size(), kLargestPiece));
        if (!WriteFile(file, text.data(), size, &written, place))
            return FailWrite();
        text.remove_prefix(written);
        if (place)
        {
            const uint64_t offset = Joined(place->OffsetHigh, place->Offset) + written;
            place->Offset = static_cast<DWORD>(offset);
            place->OffsetHigh = static_cast<DWORD>(offset >> 32);
        }
    }
    return true;
}

} // namespace

int OpenFile(const std::string& path, EOpen how, unsigned)
{
    const OpenRow& row = kOpen[static_cast<size_t>(how)];
    const int file = DescriptorOf(CreateFileW(WidePath(path).c_str(), row.access, kShareAll, nullptr,
                                              row.creation, row.flags, nullptr));
    if (how != EOpen::Overwrite || file < 0)
        return file;
    FileStatus status;
    if (StatusOf(file, status) && status.kind != EFileKind::Link && SetFileSize(file, 0))
        return file;
    CloseFile(file);
    SetLastError(ERROR_ACCESS_DENIED);
    return -1;
}

int OpenNameless(const std::string& folder)
{
    constexpr int kAttempts = 16;
    HANDLE file = INVALID_HANDLE_VALUE;
    for (int i = 0; i < kAttempts && file == INVALID_HANDLE_VALUE; ++i)
    {
        const std::string path = folder + "gaitwright-" + std::to_string(RandomNumber()) + ".tmp";
        file = CreateFileW(WidePath(path).c_str(), GENERIC_READ | GENERIC_WRITE, 0, nullptr, CREATE_NEW,
                           FILE_ATTRIBUTE_TEMPORARY | FILE_FLAG_DELETE_ON_CLOSE, nullptr);
        if (file == INVALID_HANDLE_VALUE && !IsNameTaken(LastSystemError()))
            break;
    }
    return DescriptorOf(file);
}

bool CloseFile(int file)
{
    const DWORD error = GetLastError();
    const bool isClosed = _close(file) == 0;
    if (isClosed)
        SetLastError(error);
    return isClosed;
}

std::FILE* StreamOf(int file, const char* mode)
{
    return _fdopen(file, (std::string(mode) + 'b').c_str());
}

std::FILE* OpenStream(const std::string& path, const char* mode)
{
    return _wfopen(WidePath(path).c_str(), WideText(std::string(mode) + "bN").c_str());
}

std::FILE* BinaryInput()
{
    _setmode(_fileno(stdin), _O_BINARY);
    return stdin;
}

std::FILE* BinaryOutput()
{
    _setmode(_fileno(stdout), _O_BINARY);
    return stdout;
}

ptrdiff_t ReadSome(int file, void* bytes, size_t size)
{
    DWORD count = 0;
    const auto piece = static_cast<DWORD>(std::min<size_t>(size, kLargestPiece));
    if (ReadFile(HandleOf(file), bytes, piece, &count, nullptr))
        return static_cast<ptrdiff_t>(count);
    const DWORD error = GetLastError();
    return error == ERROR_BROKEN_PIPE || error == ERROR_HANDLE_EOF ? 0 : -1;
}

bool WriteAll(int file, std::string_view text)
{
    return WriteAt(HandleOf(file), text, nullptr);
}

// The system also moves the file's position.
bool WriteAllAt(int file, std::string_view text, uint64_t offset)
{
    const HANDLE handle = HandleOf(file);
    LARGE_INTEGER position = {};
    if (!SetFilePointerEx(handle, position, &position, FILE_CURRENT))
        return FailWrite();
    OVERLAPPED place = {};
    place.Offset = static_cast<DWORD>(offset);
    place.OffsetHigh = static_cast<DWORD>(offset >> 32);
    const bool isWritten = WriteAt(handle, text, &place);
    return isWritten && (SetFilePointerEx(handle, position, nullptr, FILE_BEGIN) || FailWrite());
}

bool SetFileSize(int file, uint64_t byteCount)
{
    FILE_END_OF_FILE_INFO end;
    end.EndOfFile.QuadPart = static_cast<LONGLONG>(byteCount);
    return SetFileInformationByHandle(HandleOf(file), FileEndOfFileInfo, &end, sizeof end) != 0;
}

bool SyncFile(int file)
{
    return FlushFileBuffers(HandleOf(file)) != 0;
}

void StartSync(int) {}

bool CloseCopy(int)
{
    return true;
}

bool StatusOf(const std::string& path, FileStatus& status)
{
    return StatusOfPath(path, 0, status);
}

bool StatusOfLink(const std::string& path, FileStatus& status)
{
    return StatusOfPath(path, FILE_FLAG_OPEN_REPARSE_POINT, status);
}

bool StatusOf(int file, FileStatus& status)
{
    return StatusOfHandle(HandleOf(file), status);
}

// Copies the list of rights, where the file system has them.
bool CopyPermissions(int file, const std::string& replaced, unsigned, unsigned)
{
    const HANDLE handle = HandleOf(file);
    DWORD flags = 0;
    if (!GetVolumeInformationByHandleW(handle, nullptr, 0, nullptr, nullptr, &flags, nullptr, 0) ||
        (flags & FILE_PERSISTENT_ACLS) == 0)
        return true;
    const std::wstring path = WidePath(replaced);
    DWORD size = 0;
    GetFileSecurityW(path.c_str(), DACL_SECURITY_INFORMATION, nullptr, 0, &size);
    std::vector<std::byte> rights(size);
    return GetFileSecurityW(path.c_str(), DACL_SECURITY_INFORMATION, rights.data(), size, &size) &&
           SetKernelObjectSecurity(handle, DACL_SECURITY_INFORMATION, rights.data());
}

bool RemoveFile(const char* path)
{
    wchar_t wide[4096];
    return WidePath(path, wide) && DeleteFileW(wide);
}

bool RemoveEmptyFolder(const std::string& path)
{
    return RemoveDirectoryW(WidePath(path).c_str()) != 0;
}

bool RenameFile(const std::string& from, const std::string& to)
{
    constexpr int kAttempts = 6;
    constexpr DWORD kPauseMilliseconds = 20;
    const std::wstring wideFrom = WidePath(from);
    const std::wstring wideTo = WidePath(to);
    for (int i = 1; !Replace(wideFrom, wideTo); ++i)
    {
        if (i == kAttempts || !IsPassing(GetLastError()))
            return false;
        Sleep(kPauseMilliseconds);
    }
    return true;
}

bool RenameToFree(const std::string& from, const std::string& to)
{
    return MoveFileExW(WidePath(from).c_str(), WidePath(to).c_str(), 0) != 0;
}

bool ListFolder(const std::string& folder, const std::function<bool(const FolderEntry&)>& visit)
{
    if (folder.empty())
    {
        SetLastError(ERROR_PATH_NOT_FOUND);
        return false;
    }
    WIN32_FIND_DATAW found;
    const HANDLE search = FindFirstFileExW((WidePath(folder) + L"\\*").c_str(), FindExInfoBasic, &found,
                                           FindExSearchNameMatch, nullptr, FIND_FIRST_EX_LARGE_FETCH);
    if (search == INVALID_HANDLE_VALUE)
        return false;
    const std::unique_ptr<void, BOOL(WINAPI*)(HANDLE)> closer(search, FindClose);
    do
    {
        const bool isLink = (found.dwFileAttributes & FILE_ATTRIBUTE_REPARSE_POINT) != 0;
        const std::string name = NarrowText(found.cFileName);
        if (!visit({name.c_str(), isLink ? EFileKind::Unknown : KindOf(found.dwFileAttributes)}))
            break;
    } while (FindNextFileW(search, &found));
    return true;
}

CFolderFiles::CFolderFiles(const std::string& folder) : m_kFolder(WithSeparator(folder)) {}

CFolderFiles::~CFolderFiles() = default;

bool CFolderFiles::StatusOf(const char* name, FileStatus& status) const
{
    return gw::StatusOf(m_kFolder + name, status);
}

// A byte far behind the end, since nobody can read or write locked bytes.
ELock LockFile(int file)
{
    OVERLAPPED place = {};
    place.OffsetHigh = DWORD{1} << 30;
    if (LockFileEx(HandleOf(file), LOCKFILE_EXCLUSIVE_LOCK | LOCKFILE_FAIL_IMMEDIATELY, 0, 1, 0, &place))
        return ELock::Held;
    const DWORD error = GetLastError();
    return error == ERROR_LOCK_VIOLATION || error == ERROR_IO_PENDING ? ELock::Taken : ELock::None;
}

bool IsOnLocalDisk(int file)
{
    FILE_REMOTE_PROTOCOL_INFO info;
    return !GetFileInformationByHandleEx(HandleOf(file), FileRemoteProtocolInfo, &info, sizeof info);
}

} // namespace gw
