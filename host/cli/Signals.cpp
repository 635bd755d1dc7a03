#include "cli/Signals.h"

#include <algorithm>
#include <cerrno>
#include <ctime>

namespace cimhost::cli {

HeldSignals::HeldSignals(std::initializer_list<int> signals)
{
    sigemptyset(&signals_);
    for (const int signal : signals)
        sigaddset(&signals_, signal);
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

int HeldSignals::waitUntil(std::chrono::steady_clock::time_point end) const
{
    using std::chrono::nanoseconds;
    constexpr nanoseconds::rep second = 1000000000;
    int signal = 0;
    do {
        const nanoseconds left =
            std::max<nanoseconds>(end - std::chrono::steady_clock::now(), nanoseconds(0));
        const timespec time{left.count() / second, left.count() % second};
        signal = sigtimedwait(&signals_, nullptr, &time);
    } while (signal < 0 && errno == EINTR);
    return std::max(signal, 0);
}

} // namespace cimhost::cli
