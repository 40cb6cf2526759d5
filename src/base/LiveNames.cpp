// A signal handler must not allocate, lock, or walk objects that the program is changing. So paths are copied
// into fixed slots, and a slot's owner field marks it as readable. The owner is a process id, because a
// forked worker inherits the slots but not the files.

#include "LiveNames.h"

#include <atomic>
#include <csignal>
#include <cstring>

#include <unistd.h>

namespace gw {

namespace {

constexpr size_t kPathBytes = 4096; // the system's limit
constexpr int kEndSignals[] = {SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGPIPE, SIGXCPU};
constexpr pid_t kFree = 0;
constexpr pid_t kChanging = -1;

struct NameSlot
{
    std::atomic<pid_t> owner{kFree};
    char path[kPathBytes] = {};
};

NameSlot g_kSlots[16]; // a program writes only one or two files at a time

void EndBySignal(int signal)
{
    const pid_t self = getpid();
    for (const NameSlot& slot : g_kSlots)
    {
        if (slot.owner == self)
            unlink(slot.path);
    }
    raise(signal); // SA_RESETHAND has restored the default action, which runs when this handler returns
}

} // namespace

int AddLiveName(const std::string& path)
{
    if (path.size() >= kPathBytes)
        return -1;
    for (NameSlot& slot : g_kSlots)
    {
        pid_t expected = kFree;
        if (!slot.owner.compare_exchange_strong(expected, kChanging))
            continue;
        std::memcpy(slot.path, path.c_str(), path.size() + 1);
        slot.owner = getpid();
        return static_cast<int>(&slot - g_kSlots);
    }
    return -1;
}

void RemoveLiveName(int number)
{
    if (number >= 0)
        g_kSlots[number].owner = kFree;
}

void RemovePrivateFilesOnSignals()
{
    struct sigaction action = {};
    action.sa_handler = EndBySignal;
    action.sa_flags = SA_RESETHAND;
    for (const int signal : kEndSignals)
        sigaddset(&action.sa_mask, signal);
    for (const int signal : kEndSignals)
    {
        struct sigaction before = {};
        sigaction(signal, nullptr, &before);
        if (before.sa_handler != SIG_IGN)
            sigaction(signal, &action, nullptr);
    }
}

} // namespace gw
