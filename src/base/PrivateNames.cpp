// Private files exist only while a program is working on the real one. They are hidden, their names are
// unpredictable, and a killed program leaves them behind. This file decides which of them are leftovers.
//
// A process id is not enough: a zombie still has one, and a container sees the ids of other containers as
// free. Therefore the writer of a private file holds a lock on it (LockFile). The kernel drops that lock
// however the program ends, and it works across the containers of one machine. A sweeper deletes only files
// that it has locked itself.
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

#include "Files.h"
#include "Paths.h"
#include "Processes.h"

#include <charconv>
#include <cstdint>
#include <cstdio>
#include <ctime>
#include <limits>
#include <mutex>
#include <set>

namespace gw {

namespace {

constexpr std::string_view kPrefix = ".gaitwright-";
constexpr size_t kDigits = 8;
constexpr size_t kPartBytes = kDigits + 1; // with the dash or dot that follows
constexpr int64_t kOldSeconds = int64_t{24} * 60 * 60;
constexpr int64_t kNanoseconds = 1'000'000'000;
constexpr size_t kQuickEntries = 1000; // takes less than a millisecond to read

bool IsStillNamed(int file, const std::string& path)
{
    FileStatus open, named;
    return StatusOf(file, open) && StatusOfLink(path, named) && open.inode == named.inode &&
           open.device == named.device;
}

uint32_t NumberOf(std::string_view text)
{
    uint32_t number = 2166136261u;
    for (const char character : text)
        number = (number ^ static_cast<unsigned char>(character)) * 16777619u; // FNV-1a
    return number;
}

// Identifies the machine and its process namespace.
uint32_t MachineNumber()
{
    static const uint32_t number = NumberOf(MachineName());
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
    return parts.machine == MachineNumber() && IsProcessGone(parts.program);
}

bool IsDead(int file, const NameParts& parts, const FileStatus& status)
{
    const ELock lock = LockFile(file);
    if (lock == ELock::Taken)
        return false;
    return (lock == ELock::Held && IsOnLocalDisk(file)) || IsGone(parts) ||
           std::time(nullptr) - status.modified / kNanoseconds > kOldSeconds;
}

void RemoveIfDead(const std::string& path, const NameParts& parts)
{
    FileStatus status;
    if (!StatusOfLink(path, status) || status.kind != EFileKind::Regular)
        return;
    const int file = OpenFile(path, EOpen::Existing);
    if (file < 0)
        return;
    if (IsDead(file, parts, status) && IsStillNamed(file, path))
        RemoveFile(path.c_str());
    CloseFile(file);
}

void Sweep(const std::string& folder, size_t entryLimit)
{
    size_t count = 0;
    ListFolder(folder.empty() ? "." : folder, [&](const FolderEntry& entry) {
        NameParts parts;
        if (count < entryLimit && ReadParts(entry.name, parts))
            RemoveIfDead(WithSeparator(folder) + entry.name, parts);
        return ++count < entryLimit;
    });
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
    char parts[3 * kPartBytes + 1];
    std::snprintf(parts, sizeof parts, "%08x-%08x-%08x", MachineNumber(), ProcessNumber(), RandomNumber());
    return folder + std::string(kPrefix) + parts + std::string(extension);
}

bool IsPrivateName(std::string_view name)
{
    return name.starts_with(kPrefix);
}

bool LockNewFile(int file)
{
    FileStatus status;
    return LockFile(file) != ELock::Taken && StatusOf(file, status) && status.linkCount > 0;
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
