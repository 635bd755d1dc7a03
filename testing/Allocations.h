/// \file
/// Lets allocations of this process fail, and counts them: operator new of this executable stands before that
/// of the run-time library, for the provider library too. All functions are about the calling thread alone.
///
/// With AllocationsOfC.cpp instead of Allocations.cpp those of C fail too, by which the loader allocates the variables
/// that each thread has of its own; nothing is counted then.
#ifndef TESTING_ALLOCATIONS_H
#define TESTING_ALLOCATIONS_H

#include <cstddef>

namespace Allocations {

/// From now on, lets the nth allocation (from 1) throw std::bad_alloc; once.
void failNth(std::size_t nth);

/// From now on, lets the first allocation of at least so many bytes throw std::bad_alloc; once.
void failFrom(std::size_t bytes);

/// Lets none fail any more. \return whether one has failed
bool stop();

/// What was allocated and freed since startCounting().
struct Use
{
    std::size_t count = 0;   ///< allocations
    std::ptrdiff_t held = 0; ///< bytes in use, as the C library rounds them up
    std::ptrdiff_t peak = 0; ///< the most bytes in use at a time
};

/// From now on, counts.
void startCounting();

/// Counts no more. \return what was counted
Use stopCounting();

/// While it lives, allocations are not counted and do not fail, and what is freed is not counted either: for
/// what is not the library's.
class Pause
{
public:
    Pause();
    ~Pause(); // NOLINT(performance-trivially-destructible): what does not count has an empty one
    Pause(const Pause&) = delete;
    Pause& operator=(const Pause&) = delete;
};

} // namespace Allocations

#endif
