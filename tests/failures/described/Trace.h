/// \file
/// The trace lines of the operations and of the functions that they pass through.
#ifndef TESTS_FAILURES_DESCRIBED_TRACE_H
#define TESTS_FAILURES_DESCRIBED_TRACE_H

#include <string>

namespace described {

/// The trace of one function: its ENTERING line when it begins; its EXITING line only where it says so.
class Flow
{
public:
    /// \param inModule  as the logger's category names it, without "Mavrel."
    Flow(std::string inModule, std::string ofFunction);

    void exiting() const;

    /// The error line of an up-call that failed.
    void enumerationFailed() const;

private:
    void line(const std::string& kind) const;

    std::string module;
    std::string function;
};

} // namespace described

#endif
