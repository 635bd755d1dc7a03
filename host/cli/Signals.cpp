#include "cli/Signals.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <ctime>

#include <poll.h>
#include <sys/signalfd.h>

namespace cimhost::cli {

namespace {

sigset_t setOf(std::initializer_list<int> signals)
{
    sigset_t set{};
    sigemptyset(&set);
    for (const int signal : signals)
        sigaddset(&set, signal);
    return set;
}

/// As poll() takes it: rounded up, so that the time has come when it ends.
int millisecondsUntil(std::chrono::steady_clock::time_point end)
{
    using std::chrono::milliseconds;
    constexpr milliseconds most = std::chrono::hours(24);
    const auto left = std::chrono::ceil<milliseconds>(end - std::chrono::steady_clock::now());
    return static_cast<int>(std::clamp(left, milliseconds(0), most).count());
}

} // namespace

HeldSignals::HeldSignals(std::initializer_list<int> signals)
    : signals_(setOf(signals)),
      arrivals_(signalfd(-1, &signals_, SFD_CLOEXEC | SFD_NONBLOCK))
{
    pthread_sigmask(SIG_BLOCK, &signals_, &before_);
}

HeldSignals::~HeldSignals()
{
    pthread_sigmask(SIG_SETMASK, &before_, nullptr);
}

int HeldSignals::wait() const
{
    int signal = 0;
    sigwait(&signals_, &signal);
    return signal;
}

HeldSignals::Wakeup HeldSignals::waitUntil(std::chrono::steady_clock::time_point end, int descriptor,
                                           bool mayRead) const
{
    const short wanted = mayRead ? POLLIN : 0;
    std::array<pollfd, 2> watched{pollfd{arrivals_.number(), POLLIN, 0}, pollfd{descriptor, wanted, 0}};
    while (poll(watched.data(), watched.size(), millisecondsUntil(end)) < 0 && errno == EINTR)
        continue;
    const timespec now{};
    return {std::max(sigtimedwait(&signals_, nullptr, &now), 0), watched[1].revents != 0};
}

} // namespace cimhost::cli
