/// \file
/// Standard error while a screen is up.
#ifndef CIMHOST_CLI_WATCH_CAPTUREDERRORS_H
#define CIMHOST_CLI_WATCH_CAPTUREDERRORS_H

#include "cim/Descriptor.h"

#include <string>
#include <vector>

#include <sys/types.h>

namespace cimhost::cli {

/// While the object lives, what is written to standard error is kept, where that is a terminal: there it
/// would stand on the screen until the next look. What nobody took is written when the object goes.
class CapturedErrors
{
public:
    CapturedErrors();
    ~CapturedErrors();
    CapturedErrors(const CapturedErrors&) = delete;
    CapturedErrors& operator=(const CapturedErrors&) = delete;

    /// The lines that came since the last time.
    std::vector<std::string> take();

private:
    std::string read();

    cim::Descriptor kept_;   ///< a file in memory; none: nothing is kept
    cim::Descriptor before_; ///< what standard error was
    off_t taken_ = 0;        ///< bytes
};

} // namespace cimhost::cli

#endif
