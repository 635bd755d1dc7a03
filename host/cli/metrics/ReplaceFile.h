/// \file
#ifndef CIMHOST_CLI_METRICS_REPLACEFILE_H
#define CIMHOST_CLI_METRICS_REPLACEFILE_H

#include <stdexcept>
#include <string>
#include <string_view>

namespace cimhost::cli {

/// A file could not be written; what() names it and says why.
class ReplaceError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// Gives the file this content in one step, and the mode 0644: whoever reads it has the whole of the old one or the
/// whole of the new one, whatever fails on the way. The new one is made beside it, as `FILE.` and six letters.
/// \throws ReplaceError  the old one is as it was
void replaceFile(const std::string& file, std::string_view content);

} // namespace cimhost::cli

#endif
