/// \file
#ifndef CIMHOST_SERVE_DEADLINES_H
#define CIMHOST_SERVE_DEADLINES_H

#include <chrono>
#include <condition_variable>
#include <map>
#include <mutex>
#include <thread>

namespace cimhost::serve {

/// Ends the connections that take too long over a step, however busy they look: a client that sends
/// one byte at a time is never idle. A thread of its own waits for the next one to be due.
class Deadlines
{
public:
    /// \param limit  for each step
    explicit Deadlines(std::chrono::milliseconds limit);
    ~Deadlines();
    Deadlines(const Deadlines&) = delete;
    Deadlines& operator=(const Deadlines&) = delete;

    /// A step of a connection begins now, and the one before is done. The socket is shut down if there is
    /// neither another step nor an end in time.
    void begin(int socket);
    /// The connection may take its time, or is about to be closed.
    void end(int socket);
    /// All steps that have begun are due: their sockets are shut down.
    void endAll();

private:
    using Clock = std::chrono::steady_clock;

    void watch();

    std::chrono::milliseconds limit_;
    std::mutex mutex_;
    std::condition_variable changed_;
    std::map<int, Clock::time_point> deadlines_; ///< by socket
    bool isEnding_ = false;
    std::thread watcher_;
};

} // namespace cimhost::serve

#endif
