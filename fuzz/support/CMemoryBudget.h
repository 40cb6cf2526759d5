#pragma once

#include <cstddef>

namespace gw {

/// What an input may take of memory while it is worked on: 64 MiB and 16 times its size, beside what was
/// there before. Whoever takes more ends the program at that very allocation. Only programs with
/// AddressSanitizer can look; in others it counts nothing.
class CMemoryBudget
{
public:
    explicit CMemoryBudget(size_t inputBytes);
    ~CMemoryBudget();
    CMemoryBudget(const CMemoryBudget&) = delete;
    CMemoryBudget& operator=(const CMemoryBudget&) = delete;
};

} // namespace gw
