/// \file
/// Lets allocations of the tests' process fail: operator new of this executable stands before that of the
/// run-time library, for the provider library too. All functions are about the calling thread alone.
#ifndef TESTS_SUPPORT_ALLOCATIONS_H
#define TESTS_SUPPORT_ALLOCATIONS_H

#include <cstddef>

namespace Allocations {

/// From now on, lets the nth allocation (from 1) throw std::bad_alloc; once.
void failNth(std::size_t nth);

/// From now on, lets the first allocation of at least so many bytes throw std::bad_alloc; once.
void failFrom(std::size_t bytes);

/// Lets none fail any more. \return whether one has failed
bool stop();

/// While it lives, allocations are neither counted nor do they fail: for what is not the library's.
class Pause
{
public:
    Pause();
    ~Pause();
    Pause(const Pause&) = delete;
    Pause& operator=(const Pause&) = delete;
};

} // namespace Allocations

#endif
