#include "CMemoryBudget.h"

#include <atomic>
#include <cstdint>
#include <cstdlib>
#include <limits>

#include <unistd.h>

#if defined(__SANITIZE_ADDRESS__)
#define GW_COUNTS_MEMORY
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
#define GW_COUNTS_MEMORY
#endif
#endif

#ifdef GW_COUNTS_MEMORY
// The sanitizer's functions. Only one of the two compilers provides their header.
extern "C" int __sanitizer_install_malloc_and_free_hooks(void (*onAllocated)(const volatile void*, size_t),
                                                         void (*onFreed)(const volatile void*));
extern "C" size_t __sanitizer_get_allocated_size(const volatile void* block);
#endif

namespace gw {

namespace {

constexpr size_t kFixedBytes = size_t{64} << 20;
constexpr size_t kBytesPerInputByte = 16;
constexpr int64_t kUnlimited = std::numeric_limits<int64_t>::max();

// The sanitizer's hooks have no context, so these are global. Negative when older memory is freed.
std::atomic<int64_t> g_iTaken = 0;
std::atomic<int64_t> g_iLimit = kUnlimited;

} // namespace

#ifdef GW_COUNTS_MEMORY

namespace {

// Called inside malloc: must not allocate.
void OnAllocated(const volatile void*, size_t byteCount)
{
    if (g_iTaken.fetch_add(static_cast<int64_t>(byteCount)) + static_cast<int64_t>(byteCount) <= g_iLimit)
        return;
    constexpr char kWords[] = "broken: 64 MiB and 16 times the input are memory enough\n";
    g_iLimit = kUnlimited; // reporting it allocates too
    [[maybe_unused]] const ssize_t written = write(STDERR_FILENO, kWords, sizeof kWords - 1);
    std::abort();
}

void OnFreed(const volatile void* block)
{
    if (block)
        g_iTaken -= static_cast<int64_t>(__sanitizer_get_allocated_size(block));
}

[[maybe_unused]] const int kInstalled = __sanitizer_install_malloc_and_free_hooks(OnAllocated, OnFreed);

} // namespace

#endif

CMemoryBudget::CMemoryBudget(size_t inputBytes)
{
    g_iTaken = 0;
    g_iLimit = static_cast<int64_t>(kFixedBytes + kBytesPerInputByte * inputBytes);
}

CMemoryBudget::~CMemoryBudget()
{
    g_iLimit = kUnlimited;
}

} // namespace gw
