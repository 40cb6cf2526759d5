// If another program truncates a file, or its disk fails, pages of its mapping disappear, and touching one
// raises SIGBUS in the reading thread. The handler maps pages of zeros there, records it and returns, so the
// read continues. The reader checks at the end whether the file was whole. Any other SIGBUS goes to the
// previous handler.
//
// A signal handler must not lock or allocate, so the ranges are kept in fixed slots of atomics.

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
        // Everything after this page is missing too, so one signal is enough.
        const uintptr_t page = address / g_uiPageSize * g_uiPageSize;
        range.cut = true;
        // NOLINTNEXTLINE(performance-no-int-to-ptr): the address was rounded to that of its page
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
        std::signal(signal, SIG_DFL); // the access is repeated, which ends the program
}

bool Install()
{
    g_uiPageSize = static_cast<uintptr_t>(sysconf(_SC_PAGESIZE));
    struct sigaction action = {};
    action.sa_sigaction = OnBusError;
    action.sa_flags = SA_SIGINFO | SA_ONSTACK;
    sigaction(SIGBUS, nullptr, &g_kBefore); // stored before our handler can run
    return sigaction(SIGBUS, &action, nullptr) == 0;
}

} // namespace

WatchedRange* Watch(const void* begin, size_t byteCount)
{
    constexpr uintptr_t kClaimed = 1; // no mapping starts there
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
