// A file that another program truncates, or whose disk fails, loses pages of its mapping, and touching one
// raises SIGBUS in the thread that reads. The handler puts pages of zeros there, notes it and returns, so
// that the read continues; whoever reads asks at the end whether the file was whole. A signal that is about
// anything else goes to the handler that was there before.
//
// A handler may take no lock and allocate nothing, so the ranges stand in fixed slots of atomics.

#include "WatchedRange.h"

#include <cerrno>
#include <csignal>

#include <sys/mman.h>
#include <unistd.h>

namespace gw {

namespace {

WatchedRange g_kRanges[64];
struct sigaction g_kBefore;
uintptr_t g_uiPageSize;

bool PatchAt(uintptr_t address)
{
    for (WatchedRange& range : g_kRanges)
    {
        const uintptr_t begin = range.begin;
        const uintptr_t end = range.end;
        if (begin == 0 || address < begin || address >= end)
            continue;
        // What follows is missing too, so one signal is enough.
        const uintptr_t page = address / g_uiPageSize * g_uiPageSize;
        range.cut = true;
        return mmap(reinterpret_cast<void*>(page), end - page, PROT_READ,
                    MAP_PRIVATE | MAP_ANONYMOUS | MAP_FIXED | MAP_NORESERVE, -1, 0) != MAP_FAILED;
    }
    return false;
}

void OnBusError(int signal, siginfo_t* info, void* context)
{
    const int error = errno;
    if (PatchAt(reinterpret_cast<uintptr_t>(info->si_addr)))
    {
        errno = error;
        return;
    }
    if (g_kBefore.sa_flags & SA_SIGINFO)
        g_kBefore.sa_sigaction(signal, info, context);
    else if (g_kBefore.sa_handler != SIG_DFL && g_kBefore.sa_handler != SIG_IGN)
        g_kBefore.sa_handler(signal);
    else
        std::signal(signal, SIG_DFL); // and the access is made again, which ends the program
}

bool Install()
{
    g_uiPageSize = static_cast<uintptr_t>(sysconf(_SC_PAGESIZE));
    struct sigaction action = {};
    action.sa_sigaction = OnBusError;
    action.sa_flags = SA_SIGINFO | SA_ONSTACK;
    sigaction(SIGBUS, nullptr, &g_kBefore); // known before the handler can run
    return sigaction(SIGBUS, &action, nullptr) == 0;
}

} // namespace

WatchedRange* Watch(const void* begin, size_t byteCount)
{
    constexpr uintptr_t kClaimed = 1; // no mapping begins there
    static const bool installed = Install();
    for (WatchedRange& range : g_kRanges)
    {
        uintptr_t expected = 0;
        if (!installed || !range.begin.compare_exchange_strong(expected, kClaimed))
            continue;
        range.cut = false;
        range.end = reinterpret_cast<uintptr_t>(begin) + byteCount;
        range.begin = reinterpret_cast<uintptr_t>(begin);
        return &range;
    }
    return nullptr;
}

void Unwatch(WatchedRange* range)
{
    if (!range)
        return;
    range->end = 0;
    range->begin = 0;
}

} // namespace gw
