#include "FailingAllocations.h"

#include <cstdlib>
#include <new>

int g_iAllocationsLeft = -1;

void* operator new(size_t size)
{
    if (g_iAllocationsLeft == 0)
        throw std::bad_alloc();
    g_iAllocationsLeft -= g_iAllocationsLeft > 0 ? 1 : 0;
    if (void* const memory = std::malloc(size))
        return memory;
    throw std::bad_alloc();
}

// The sanitizer has its own operator, whose memory must not be freed by the one below.
void* operator new(size_t size, const std::nothrow_t&) noexcept
{
    return g_iAllocationsLeft == 0 ? nullptr : std::malloc(size);
}

void operator delete(void* memory) noexcept
{
    std::free(memory);
}

void operator delete(void* memory, size_t) noexcept
{
    std::free(memory);
}
