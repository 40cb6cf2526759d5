// Private files exist only while a program is working on the real one. They are hidden, their names are
// unpredictable, and a killed program leaves them behind. This file decides which of them are leftovers.
//
// A process id is not enough: a zombie still has one, and a container sees the ids of other containers as
// free. Therefore the writer of a private file holds a lock on it (flock). The kernel drops that lock however
// the program ends, and it works across the containers of one machine. A sweeper deletes only files that it
// has locked itself.
//
// Between creating and locking a file, its owner can lose it to a sweeper. Then either the lock fails or the
// file has lost its name. The owner notices both and tries another name. The sweeper, once it has the lock,
// checks that the name still refers to the locked file, since the owner may have renamed it, and only then
// deletes it.
//
// Locks are trusted only on local disks and in-memory file systems. Elsewhere (network, FUSE, unknown) they
// may be missing, or may not reach other machines. There, a file that can be locked, or that cannot have a
// lock at all, is deleted only if its program ran on this machine in this process namespace and is gone, or
// if nobody has written to it for a day.

#include "PrivateNames.h"

#include "Paths.h"

#include <algorithm>
#include <cerrno>
#include <charconv>
#include <cstdint>
#include <cstdio>
#include <ctime>
#include <iterator>
#include <limits>
#include <memory>
#include <mutex>
#include <random>
#include <set>

#include <csignal>
#include <dirent.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <sys/vfs.h>
#include <unistd.h>

namespace gw {

namespace {

constexpr std::string_view kPrefix = ".gaitwright-";
constexpr size_t kDigits = 8;
constexpr size_t kPartBytes = kDigits + 1; // with the dash or dot that follows
constexpr time_t kOldSeconds = 24 * 60 * 60;
constexpr size_t kQuickEntries = 1000; // takes less than a millisecond to read

// ext2 to ext4, XFS, Btrfs, F2FS, ZFS, bcachefs, tmpfs, ramfs, overlayfs.
constexpr uint32_t kLocalSystems[] = {0xEF53,     0x58465342, 0x9123683E, 0xF2F52010, 0x2FC12FC1,
                                      0xCA451A4E, 0x01021994, 0x858458F6, 0x794C7630};

enum class ELock : uint8_t
{
    Held,
    Taken, ///< another program holds it
    None,  ///< the file system has no locks
};

ELock Lock(int file)
{
    if (flock(file, LOCK_EX | LOCK_NB) == 0)
        return ELock::Held;
    return errno == EWOULDBLOCK || errno == EINTR ? ELock::Taken : ELock::None;
}

bool IsStillNamed(int file, const std::string& path)
{
    struct stat open, named;
    return fstat(file, &open) == 0 && lstat(path.c_str(), &named) == 0 && open.st_ino == named.st_ino &&
           open.st_dev == named.st_dev;
}

bool IsOnLocalDisk(int file)
{
    struct statfs status;
    return fstatfs(file, &status) == 0 &&
           std::ranges::find(kLocalSystems, static_cast<uint32_t>(status.f_type)) != std::end(kLocalSystems);
}

uint32_t AddText(uint32_t number, const char* text)
{
    for (; *text; ++text)
        number = (number ^ static_cast<unsigned char>(*text)) * 16777619u; // FNV-1a
    return number;
}

uint32_t ReadMachineNumber()
{
    char name[256] = {};
    gethostname(name, sizeof name - 1);
    char processes[64] = {};
    if (readlink("/proc/self/ns/pid", processes, sizeof processes - 1) < 0)
        processes[0] = '\0';
    return AddText(AddText(2166136261u, name), processes);
}

// Identifies the machine and its process namespace.
uint32_t MachineNumber()
{
    static const uint32_t number = ReadMachineNumber();
    return number;
}

// Reads one part of a private name: machine, program or random number.
bool ReadPart(std::string_view name, size_t part, uint32_t& number)
{
    const size_t begin = kPrefix.size() + part * kPartBytes;
    if (name.size() < begin + kDigits)
        return false;
    const char* const digits = name.data() + begin;
    const auto [end, error] = std::from_chars(digits, digits + kDigits, number, 16);
    return error == std::errc() && end == digits + kDigits;
}

struct NameParts
{
    uint32_t machine, program, random;
};

bool ReadParts(std::string_view name, NameParts& parts)
{
    return IsPrivateName(name) && ReadPart(name, 0, parts.machine) && ReadPart(name, 1, parts.program) &&
           ReadPart(name, 2, parts.random);
}

bool IsGone(const NameParts& parts)
{
    return parts.machine == MachineNumber() && parts.program != 0 &&
           kill(static_cast<pid_t>(parts.program), 0) != 0 && errno == ESRCH;
}

bool IsDead(int file, const NameParts& parts, const struct stat& status)
{
    const ELock lock = Lock(file);
    if (lock == ELock::Taken)
        return false;
    return (lock == ELock::Held && IsOnLocalDisk(file)) || IsGone(parts) ||
           time(nullptr) - status.st_mtime > kOldSeconds;
}

void RemoveIfDead(const std::string& path, const NameParts& parts)
{
    struct stat status;
    if (lstat(path.c_str(), &status) != 0 || !S_ISREG(status.st_mode))
        return;
    // On network file systems, only a writable descriptor can hold such a lock.
    const int file = open(path.c_str(), O_RDWR | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC);
    if (file < 0)
        return;
    if (IsDead(file, parts, status) && IsStillNamed(file, path))
        unlink(path.c_str());
    close(file);
}

void Sweep(const std::string& folder, size_t entryLimit)
{
    const std::string place = folder.empty() ? "." : folder;
    const std::unique_ptr<DIR, int (*)(DIR*)> directory(opendir(place.c_str()), closedir);
    for (size_t i = 0; directory && i < entryLimit; ++i)
    {
        const dirent* const entry = readdir(directory.get());
        if (!entry)
            return;
        NameParts parts;
        if (ReadParts(entry->d_name, parts))
            RemoveIfDead(WithSeparator(folder) + entry->d_name, parts);
    }
}

// Returns whether neither this process nor its parent before the fork has swept the folder.
bool IsFirstSweep(const std::string& folder)
{
    static std::mutex mutex;
    static std::set<std::string> swept;
    const std::lock_guard lock(mutex);
    return swept.insert(folder).second;
}

} // namespace

std::string PrivateName(const std::string& folder, std::string_view extension)
{
    std::random_device random(
        "getentropy"); // the default asks the processor, which is slow in virtual machines
    char parts[3 * kPartBytes + 1];
    std::snprintf(parts, sizeof parts, "%08x-%08x-%08x", MachineNumber(), static_cast<uint32_t>(getpid()),
                  random());
    return folder + std::string(kPrefix) + parts + std::string(extension);
}

bool IsPrivateName(std::string_view name)
{
    return name.starts_with(kPrefix);
}

bool LockNewFile(int file)
{
    struct stat status;
    return Lock(file) != ELock::Taken && fstat(file, &status) == 0 && status.st_nlink > 0;
}

void RemoveLeftovers(const std::string& folder)
{
    IsFirstSweep(folder);
    Sweep(folder, std::numeric_limits<size_t>::max());
}

void SweepOnce(const std::string& folder)
{
    if (IsFirstSweep(folder))
        Sweep(folder, kQuickEntries);
}

} // namespace gw
