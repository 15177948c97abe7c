#include "tests/interpose/Allocation.h"

#include <cstdlib>
#include <new>

namespace interpose
{

AnyCall& allocation()
{
    static AnyCall call("allocation");
    return call;
}

} // namespace interpose

namespace
{

void* allocate(std::size_t size)
{
    if (interpose::allocation().failsNow())
        throw std::bad_alloc();
    void* const memory = std::malloc(size == 0 ? 1 : size);
    if (!memory)
        throw std::bad_alloc();
    return memory;
}

} // namespace

void* operator new(std::size_t size)
{
    return allocate(size);
}

void* operator new[](std::size_t size)
{
    return allocate(size);
}

void operator delete(void* memory) noexcept
{
    std::free(memory);
}

void operator delete[](void* memory) noexcept
{
    std::free(memory);
}

void operator delete(void* memory, std::size_t) noexcept
{
    std::free(memory);
}

void operator delete[](void* memory, std::size_t) noexcept
{
    std::free(memory);
}
