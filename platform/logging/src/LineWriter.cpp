#include "LineWriter.h"

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <csignal>
#include <ctime>
#include <string>

#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

namespace MVLog {
namespace {

/// Keeps the signals of a failed write from this thread. What the process does with these signals stays as it
/// is: a library has no say in that.
class WriteSignalsHeldBack
{
public:
    WriteSignalsHeldBack()
    {
        sigemptyset(&signals_);
        sigset_t pending;
        sigpending(&pending);
        for (const int signal : {SIGPIPE, SIGXFSZ})
            if (sigismember(&pending, signal) == 0) // one that waits already is somebody else's
                sigaddset(&signals_, signal);
        pthread_sigmask(SIG_BLOCK, &signals_, &before_);
    }

    ~WriteSignalsHeldBack()
    {
        const timespec noTime{};
        while (sigtimedwait(&signals_, nullptr, &noTime) > 0 || errno == EINTR)
            ;
        pthread_sigmask(SIG_SETMASK, &before_, nullptr);
    }

    WriteSignalsHeldBack(const WriteSignalsHeldBack&) = delete;
    WriteSignalsHeldBack& operator=(const WriteSignalsHeldBack&) = delete;

private:
    sigset_t signals_{};
    sigset_t before_{};
};

using Clock = std::chrono::steady_clock;
constexpr std::chrono::milliseconds longestWaitForAReader{100};

/// \return 0 once the descriptor can be written to or has failed, which writing then tells
int waitUntilWritable(int descriptor, Clock::time_point deadline)
{
    const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - Clock::now()).count();
    pollfd wanted{descriptor, POLLOUT, 0};
    return poll(&wanted, 1, static_cast<int>(std::max(left, decltype(left){0}))) != 0 ? 0 : EAGAIN;
}

/// A socket is not waited for, whatever it does for others.
ssize_t writeSome(int descriptor, std::string_view text)
{
    const ssize_t sent = send(descriptor, text.data(), text.size(), MSG_DONTWAIT | MSG_NOSIGNAL);
    return sent < 0 && errno == ENOTSOCK ? ::write(descriptor, text.data(), text.size()) : sent;
}

/// Writes until all is written or an error ends it. \return 0, or why the rest was not; `text` is then the rest
int writeAll(int descriptor, std::string_view& text, std::size_t mostAtOnce, Clock::time_point deadline)
{
    const WriteSignalsHeldBack guard;
    while (!text.empty()) {
        if (const int error = waitUntilWritable(descriptor, deadline); error != 0)
            return error;
        const ssize_t written = writeSome(descriptor, text.substr(0, mostAtOnce));
        if (written >= 0)
            text.remove_prefix(static_cast<std::size_t>(written));
        else if (errno != EINTR && (errno != EAGAIN || Clock::now() >= deadline))
            return errno;
    }
    return 0;
}

} // namespace

int LineWriter::write(int descriptor, std::string_view line, std::size_t mostAtOnce)
{
    const std::string text = (isTorn_ ? "\n" : "") + std::string(line);
    std::string_view rest = text;
    const Clock::time_point deadline =
        Clock::now() + (isStuck_ ? std::chrono::milliseconds::zero() : longestWaitForAReader);
    const int error = writeAll(descriptor, rest, mostAtOnce, deadline);
    if (rest.size() < text.size())
        isTorn_ = text[text.size() - rest.size() - 1] != '\n';
    isStuck_ = error == EAGAIN;
    return error;
}

} // namespace MVLog
