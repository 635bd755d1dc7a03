/// \file
/// Writing lines to an open file.
#ifndef MVLOG_LINEWRITER_H
#define MVLOG_LINEWRITER_H

#include <string>
#include <string_view>

namespace MVLog {

/// Writes each line with one call, so that lines stay whole even where several processes append to one file.
/// One thread at a time may use it.
class LineWriter
{
public:
    /// \param descriptor  stays the caller's
    /// \param name        of the file, for errors
    LineWriter(int descriptor, std::string name) : descriptor_(descriptor), name_(std::move(name)) {}

    /// Writes the line, which has its newline. A pipe that nobody reads and a file that has reached the
    /// process's limit are errors as any other: no signal is raised, whatever the process does with signals.
    /// \throw spdlog::spdlog_ex when it cannot be written
    void write(std::string_view line);

private:
    int descriptor_;
    std::string name_;
    bool isTorn_ = false; ///< the last line was written in part
};

} // namespace MVLog

#endif
