/// \file
/// What the environment says about the log.
#ifndef MVLOG_SETTINGS_H
#define MVLOG_SETTINGS_H

#include <string>
#include <vector>

namespace MVLog {

struct Settings
{
    int leastLevel = 6000;               ///< of the lines that are written
    std::string file;                    ///< appended to; empty: standard error
    std::vector<std::string> complaints; ///< one sentence for each variable that could not be used
};

/// Reads MVLOG_LEVEL and MVLOG_FILE.
Settings readSettings();

} // namespace MVLog

#endif
