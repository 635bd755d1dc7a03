#include "testing/Allocations.h"

#include <cerrno>
#include <cstdlib>

namespace Allocations {
namespace {

thread_local std::size_t remaining = 0; ///< allocations until the one that fails; 0: none does
thread_local bool failed = false;
thread_local int pauses = 0;

bool failsNow()
{
    if (pauses > 0 || remaining == 0 || --remaining > 0)
        return false;
    failed = true;
    errno = ENOMEM;
    return true;
}

} // namespace

void failNth(std::size_t nth)
{
    remaining = nth;
    failed = false;
}

bool stop()
{
    remaining = 0;
    return failed;
}

Pause::Pause()
{
    ++pauses;
}
Pause::~Pause()
{
    --pauses;
}

} // namespace Allocations

// The C library's own, by the names that it has for those who stand before it.
extern "C" {

void* __libc_malloc(std::size_t size);
void* __libc_calloc(std::size_t count, std::size_t size);
void* __libc_realloc(void* memory, std::size_t size);

// NOLINTBEGIN(readability-inconsistent-declaration-parameter-name): the C library's have names that are its own
void* malloc(std::size_t size)
{
    return Allocations::failsNow() ? nullptr : __libc_malloc(size);
}

void* calloc(std::size_t count, std::size_t size)
{
    return Allocations::failsNow() ? nullptr : __libc_calloc(count, size);
}

void* realloc(void* memory, std::size_t size)
{
    return Allocations::failsNow() ? nullptr : __libc_realloc(memory, size);
}
// NOLINTEND(readability-inconsistent-declaration-parameter-name)
}
