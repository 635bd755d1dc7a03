/// \file
/// Writing lines to an open file.
#ifndef MVLOG_LINEWRITER_H
#define MVLOG_LINEWRITER_H

#include <cstddef>
#include <limits>
#include <string_view>

namespace MVLog {

/// Writes each line with one call where the file takes it whole, so that lines stay whole even where several
/// processes append to one file. One thread at a time may use it.
class LineWriter
{
public:
    /// Writes the line, which has its newline. A pipe that nobody reads and a file that has reached the
    /// process's limit are errors as any other: no signal is raised, whatever the process does with signals. A
    /// reader that does not read is waited for a tenth of a second, and from then on not at all until a line is
    /// written whole again.
    /// \param descriptor  the same each time, or another of the same file; a socket may block, others should not
    /// \param mostAtOnce  bytes that a descriptor that blocks takes without waiting once it can be written to
    /// \return 0, or why some of the line is lost
    int write(int descriptor, std::string_view line,
              std::size_t mostAtOnce = std::numeric_limits<std::size_t>::max());

private:
    bool isTorn_ = false;  ///< the last line was written in part
    bool isStuck_ = false; ///< the last wait for the reader was in vain
};

} // namespace MVLog

#endif
