/// \file
#ifndef TAVRO_HELDOVERFORK_H
#define TAVRO_HELDOVERFORK_H

#include <pthread.h>

namespace Tavro {

/// From now on, until the library is unloaded, fork() waits for the mutex and sets it free in both processes. Without
/// that a child has whatever lock another thread held, and nobody to give it back. What is not set up for lack of memory
/// is not held over a fork.
template <auto& mutex>
void holdOverFork()
{
    pthread_atfork([] { mutex.lock(); }, [] { mutex.unlock(); }, [] { mutex.unlock(); });
}

} // namespace Tavro

#endif
