#include "platform/memory.h"

#include <new>

void RequireMemory(std::uint64_t bytes)
{
    void* volatile block = ::operator new(bytes); // volatile: not optimised away
    ::operator delete(block);
}
