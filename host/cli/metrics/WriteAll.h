/// \file
#ifndef CIMHOST_CLI_METRICS_WRITEALL_H
#define CIMHOST_CLI_METRICS_WRITEALL_H

#include <string_view>

namespace cimhost::cli {

/// Writes the whole text to the descriptor.
/// \return whether it took all; if not, errno says why
bool writeAll(int descriptor, std::string_view text);

} // namespace cimhost::cli

#endif
