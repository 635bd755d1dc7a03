/// \file
/// Waiting for signals.
#ifndef CIMHOST_CLI_SIGNALS_H
#define CIMHOST_CLI_SIGNALS_H

#include "cim/Descriptor.h"

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

    /// What a wait ended with; with neither, at its time.
    struct Wakeup
    {
        int signal = 0;       ///< that came
        bool isReady = false; ///< the descriptor can be read, or nobody is at its other end any more
    };

    /// \param descriptor  to wait for too; -1: none
    /// \param mayRead     whether it is waited for something to read
    [[nodiscard]] Wakeup waitUntil(std::chrono::steady_clock::time_point end, int descriptor,
                                   bool mayRead) const;

private:
    sigset_t signals_{};
    sigset_t before_{};
    cim::Descriptor arrivals_; ///< can be read once one came
};

} // namespace cimhost::cli

#endif
