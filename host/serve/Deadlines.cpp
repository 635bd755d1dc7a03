#include "serve/Deadlines.h"

#include <algorithm>

#include <sys/socket.h>

namespace cimhost::serve {

Deadlines::Deadlines(std::chrono::milliseconds limit) : limit_(limit), watcher_([this] { watch(); }) {}

Deadlines::~Deadlines()
{
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        isEnding_ = true;
    }
    changed_.notify_one();
    watcher_.join();
}

void Deadlines::begin(int socket)
{
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        deadlines_[socket] = Clock::now() + limit_;
    }
    changed_.notify_one();
}

void Deadlines::end(int socket)
{
    const std::lock_guard<std::mutex> lock(mutex_);
    deadlines_.erase(socket);
}

void Deadlines::endAll()
{
    const std::lock_guard<std::mutex> lock(mutex_);
    for (const auto& [socket, due] : deadlines_)
        shutdown(socket, SHUT_RDWR);
}

void Deadlines::watch()
{
    std::unique_lock<std::mutex> lock(mutex_);
    while (!isEnding_) {
        const auto next = std::min_element(deadlines_.begin(), deadlines_.end(),
                                           [](const auto& a, const auto& b) { return a.second < b.second; });
        if (next == deadlines_.end())
            changed_.wait(lock);
        else if (const Clock::time_point due = next->second; due > Clock::now())
            changed_.wait_until(lock, due);
        else {
            // Under the lock: until end() has returned nobody closes the socket.
            shutdown(next->first, SHUT_RDWR);
            deadlines_.erase(next);
        }
    }
}

} // namespace cimhost::serve
