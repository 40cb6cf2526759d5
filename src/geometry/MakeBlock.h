#pragma once

#include <cstddef>
#include <cstdint>
#include <new>
#include <vector>

namespace gw {

/// Replaces a block by `count` zeros, or empties it if the count is 0 or below. Returns false and keeps the
/// old block if there is not enough memory.
template <class T>
bool MakeBlock(std::vector<T>& block, int64_t count)
{
    try
    {
        block = std::vector<T>(count > 0 ? static_cast<size_t>(count) : 0);
        return true;
    } catch (const std::bad_alloc&)
    {
        return false;
    }
}

} // namespace gw
