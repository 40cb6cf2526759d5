// A signal handler must not allocate, lock, or walk objects that the program is changing. So paths are copied
// into fixed slots, and a slot's owner field marks it as readable. The owner is a process id, because a
// forked worker inherits the slots but not the files.

#include "LiveNames.h"

#include "Files.h"
#include "Processes.h"

#include <atomic>
#include <cstdint>
#include <cstring>

namespace gw {

namespace {

constexpr size_t kPathBytes = 4096; // the system's limit
constexpr uint32_t kFree = 0;
constexpr uint32_t kChanging = UINT32_MAX;

struct NameSlot
{
    std::atomic<uint32_t> owner{kFree};
    char path[kPathBytes] = {};
};

NameSlot g_kSlots[16]; // a program writes only one or two files at a time

} // namespace

int AddLiveName(const std::string& path)
{
    if (path.size() >= kPathBytes)
        return -1;
    for (NameSlot& slot : g_kSlots)
    {
        uint32_t expected = kFree;
        if (!slot.owner.compare_exchange_strong(expected, kChanging))
            continue;
        std::memcpy(slot.path, path.c_str(), path.size() + 1);
        slot.owner = ProcessNumber();
        return static_cast<int>(&slot - g_kSlots);
    }
    return -1;
}

void RemoveLiveName(int number)
{
    if (number >= 0)
        g_kSlots[number].owner = kFree;
}

void RemoveLiveFiles()
{
    const uint32_t self = ProcessNumber();
    for (const NameSlot& slot : g_kSlots)
    {
        if (slot.owner == self)
            RemoveFile(slot.path);
    }
}

} // namespace gw
