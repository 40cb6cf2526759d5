#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>

namespace gw {

/// A mapped range of a file. Reading a page that the file has lost since gives zeros and marks the range,
/// where it would otherwise end the program with SIGBUS.
struct WatchedRange
{
    std::atomic<uintptr_t> begin{0}; ///< 0: free
    std::atomic<uintptr_t> end{0};
    std::atomic<bool> cut{false}; ///< pages were missing
};

/// Watches a mapping until Unwatch, which must come before it is unmapped. Null when too many are watched.
WatchedRange* Watch(const void* begin, size_t byteCount);
void Unwatch(WatchedRange* range);

} // namespace gw
