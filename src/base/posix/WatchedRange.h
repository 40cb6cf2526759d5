#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>

namespace gw {

/// A mapped range of a file. Reading a page that the file has lost yields zeros and marks the range; without
/// it, SIGBUS would end the program.
struct WatchedRange
{
    std::atomic<uintptr_t> begin{0}; ///< 0: free
    std::atomic<uintptr_t> end{0};
    std::atomic<bool> cut{false}; ///< pages were missing
};

/// Watches a mapping. Call Unwatch before unmapping it. Returns null if too many ranges are watched.
WatchedRange* Watch(const void* begin, size_t byteCount);
void Unwatch(WatchedRange* range);

} // namespace gw
