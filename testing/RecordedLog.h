/// \file
/// The logging library of the tests, which keeps every line it is given: as libmvlog.so.1, or compiled into a
/// program of tests, where its functions come before the library's.
#ifndef TESTING_RECORDEDLOG_H
#define TESTING_RECORDEDLOG_H

#include <cstddef>
#include <string>
#include <vector>

namespace RecordedLog {

enum class Channel
{
    log,
    trace
};

/// One call of MVLogger, with all of its arguments.
struct Line
{
    Channel channel;
    std::string function;
    std::string file;
    int line;
    std::string category;
    int level;
    bool reservedIsNull;
    int first;
    int second;
    std::string text;
};

/// All lines since the last clear(), of all threads, in the order of the calls.
std::vector<Line> lines();

/// lines(), and none are kept from then on but new ones.
std::vector<Line> take();

/// Number of lines().
std::size_t count();

/// One insertion into an MVMessageBuffer since the last clear(), as the text it added; a null text is
/// "<null>".
std::vector<std::string> insertions();

void clear();

/// Switched off, lines and insertions are dropped: for tests that make too many of them.
void keep(bool on);

} // namespace RecordedLog

#endif
