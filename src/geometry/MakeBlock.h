#pragma once

#include <cstddef>
#include <cstdint>
#include <new>
#include <vector>

namespace gw {

/// Replaces a block by `count` zeros. False, with the old block kept, if there is not enough memory; a count
/// of 0 or below leaves an empty block.
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
