/// \file
/// The logging library's functions, defined in the test program and so taking the place of the library's:
/// lines are kept in place of being written.
#ifndef PLATFORM_TESTING_RECORDINGLOG_H
#define PLATFORM_TESTING_RECORDINGLOG_H

#include <string>
#include <vector>

namespace RecordingLog {

struct Line
{
    std::string channel;
    std::string function;
    std::string file;
    int line;
    std::string category;
    int level;
    std::string text;
};

/// All lines since they were last taken. Any thread may log, one may take.
std::vector<Line> take();

} // namespace RecordingLog

#endif
