/// \file
/// Help for tests of what a child does that was forked while other threads were at work.
#ifndef TESTING_FORKUNDERLOAD_H
#define TESTING_FORKUNDERLOAD_H

#include <algorithm>
#include <atomic>
#include <functional>
#include <thread>
#include <vector>

#include <sys/types.h>
#include <sys/wait.h>
#include <unistd.h>

namespace Testing {

/// Whether a child that is forked among threads may allocate memory. The sanitizers' allocator is not prepared for a
/// fork before version 18 of clang: a child may find its locks taken for good.
#ifdef GLIMMARK_SANITIZED
constexpr bool childrenMayAllocate = false;
#else
constexpr bool childrenMayAllocate = true;
#endif

/// Forks children while three threads do the work over and over; each child does it once. \return how many of
/// them ended well. One that hangs is ended after half a minute.
inline std::ptrdiff_t childrenThatReturn(int children, const std::function<void()>& work)
{
    constexpr unsigned int longestSeconds = 30;
    std::atomic<bool> isOver = false;
    std::vector<std::thread> threads(3);
    for (std::thread& thread : threads)
        thread = std::thread([&] {
            while (!isOver)
                work();
        });

    std::vector<pid_t> forked(static_cast<std::size_t>(children));
    for (pid_t& child : forked) {
        child = fork();
        if (child == 0) {
            alarm(longestSeconds);
            work();
            _exit(0);
        }
    }
    isOver = true;
    for (std::thread& thread : threads)
        thread.join();
    return std::count_if(forked.begin(), forked.end(), [](pid_t child) {
        int status = -1;
        return waitpid(child, &status, 0) == child && status == 0;
    });
}

} // namespace Testing

#endif
