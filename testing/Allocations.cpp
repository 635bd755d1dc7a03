#include "testing/Allocations.h"

#include <algorithm>
#include <cstdlib>
#include <limits>
#include <new>

#include <malloc.h>

namespace Allocations {

namespace {

struct State
{
    std::size_t remaining = 0; ///< allocations until the one that fails; 0: none does
    std::size_t bytes = std::numeric_limits<std::size_t>::max();
    bool failed = false;
    int pauses = 0;
    bool counting = false;
    Use use;
};

thread_local State state;

bool failsNow(std::size_t size)
{
    if (state.pauses > 0)
        return false;
    const bool nth = state.remaining > 0 && --state.remaining == 0;
    if (!nth && size < state.bytes)
        return false;
    state = State();
    state.failed = true;
    return true;
}

bool countsNow()
{
    return state.counting && state.pauses == 0;
}

/// \return null when there is no memory
void* allocate(std::size_t size)
{
    void* const memory = failsNow(size) ? nullptr : std::malloc(size > 0 ? size : 1);
    if (memory != nullptr && countsNow()) {
        ++state.use.count;
        state.use.held += static_cast<std::ptrdiff_t>(malloc_usable_size(memory));
        state.use.peak = std::max(state.use.peak, state.use.held);
    }
    return memory;
}

void* allocateOrThrow(std::size_t size)
{
    void* const memory = allocate(size);
    if (memory == nullptr)
        throw std::bad_alloc();
    return memory;
}

void release(void* memory)
{
    if (countsNow())
        state.use.held -= static_cast<std::ptrdiff_t>(malloc_usable_size(memory));
    std::free(memory);
}

} // namespace

void failNth(std::size_t nth)
{
    state = State();
    state.remaining = nth;
}

void failFrom(std::size_t bytes)
{
    state = State();
    state.bytes = bytes;
}

bool stop()
{
    const bool failed = state.failed;
    state = State();
    return failed;
}

void startCounting()
{
    state.use = Use();
    state.counting = true;
}

Use stopCounting()
{
    state.counting = false;
    return state.use;
}

Pause::Pause()
{
    ++state.pauses;
}
Pause::~Pause()
{
    --state.pauses;
}

} // namespace Allocations

void* operator new(std::size_t size)
{
    return Allocations::allocateOrThrow(size);
}
void* operator new[](std::size_t size)
{
    return Allocations::allocateOrThrow(size);
}

void* operator new(std::size_t size, const std::nothrow_t& /*tag*/) noexcept
{
    return Allocations::allocate(size);
}

void* operator new[](std::size_t size, const std::nothrow_t& tag) noexcept
{
    return operator new(size, tag);
}

void operator delete(void* memory) noexcept
{
    Allocations::release(memory);
}
void operator delete[](void* memory) noexcept
{
    Allocations::release(memory);
}
void operator delete(void* memory, std::size_t) noexcept
{
    Allocations::release(memory);
}
void operator delete[](void* memory, std::size_t) noexcept
{
    Allocations::release(memory);
}
