#include "platform/memory.h"

#include <cstdlib>
#include <new>

void RequireMemory(std::uint64_t bytes)
{
    void* volatile block = std::malloc(static_cast<size_t>(bytes)); // volatile: not optimised away
    if (!block)
        throw std::bad_alloc();
    std::free(block);
}
