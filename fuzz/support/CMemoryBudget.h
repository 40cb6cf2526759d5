#pragma once

#include <cstddef>

namespace gw {

/// Limits the memory that an input may use while it is processed: 64 MiB plus 16 times its size, in addition
/// to what was allocated before. An allocation beyond that ends the program. Works only with
/// AddressSanitizer; in other builds, counts nothing.
class CMemoryBudget
{
public:
    explicit CMemoryBudget(size_t inputBytes);
    ~CMemoryBudget();
    CMemoryBudget(const CMemoryBudget&) = delete;
    CMemoryBudget& operator=(const CMemoryBudget&) = delete;
};

} // namespace gw
