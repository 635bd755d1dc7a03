#include "LineWriter.h"

#include <cerrno>
#include <csignal>
#include <cstddef>
#include <ctime>

#include <spdlog/common.h>

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

/// Writes until all is written or an error ends it. \return how much was written; `error` is 0 if all
std::size_t writeAll(int descriptor, std::string_view text, int& error)
{
    const WriteSignalsHeldBack guard;
    std::size_t done = 0;
    error = 0;
    while (done < text.size() && error == 0) {
        const ssize_t written = ::write(descriptor, text.data() + done, text.size() - done);
        if (written >= 0)
            done += static_cast<std::size_t>(written);
        else if (errno != EINTR)
            error = errno;
    }
    return done;
}

} // namespace

void LineWriter::write(std::string_view line)
{
    const std::string text = (isTorn_ ? "\n" : "") + std::string(line);
    int error = 0;
    const std::size_t done = writeAll(descriptor_, text, error);
    if (done > 0)
        isTorn_ = text[done - 1] != '\n';
    if (error != 0)
        throw spdlog::spdlog_ex("a log line is lost: cannot write to " + name_, error);
}

} // namespace MVLog
