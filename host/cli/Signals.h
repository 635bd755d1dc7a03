/// \file
/// Waiting for signals.
#ifndef CIMHOST_CLI_SIGNALS_H
#define CIMHOST_CLI_SIGNALS_H

#include <chrono>
#include <csignal>
#include <initializer_list>

namespace cimhost::cli {

/// Keeps signals from this thread and those that it starts, to be waited for.
class HeldSignals
{
public:
    HeldSignals(std::initializer_list<int> signals);
    ~HeldSignals();
    HeldSignals(const HeldSignals&) = delete;
    HeldSignals& operator=(const HeldSignals&) = delete;

    /// \return the signal that came
    int wait() const; // NOLINT(modernize-use-nodiscard): often it does not matter which

    /// \return the signal that came, or 0 if none came by then
    [[nodiscard]] int waitUntil(std::chrono::steady_clock::time_point end) const;

private:
    sigset_t signals_{};
    sigset_t before_{};
};

} // namespace cimhost::cli

#endif
