#include "testing/RecordedLog.h"

#include <MVLog/MVLogger.h>
#include <MVLog/MVMessageBuffer.h>

#include <mutex>
#include <sstream>
#include <utility>

namespace RecordedLog {

namespace {

std::mutex mutex;
bool keeping = true;
std::vector<Line> recordedLines;
std::vector<std::string> recordedInsertions;

void record(Line line)
{
    const std::lock_guard lock(mutex);
    if (keeping)
        recordedLines.push_back(std::move(line));
}

} // namespace

std::vector<Line> lines()
{
    const std::lock_guard lock(mutex);
    return recordedLines;
}

std::vector<Line> take()
{
    const std::lock_guard lock(mutex);
    return std::exchange(recordedLines, {});
}

std::size_t count()
{
    const std::lock_guard lock(mutex);
    return recordedLines.size();
}

std::vector<std::string> insertions()
{
    const std::lock_guard lock(mutex);
    return recordedInsertions;
}

void clear()
{
    const std::lock_guard lock(mutex);
    recordedLines.clear();
    recordedInsertions.clear();
}

void keep(bool on)
{
    const std::lock_guard lock(mutex);
    keeping = on;
}

/// Inserts into the stream and records what that added.
template <class Value>
void insert(std::ostringstream& stream, Value value)
{
    const auto before = stream.str().size();
    stream << value;
    const std::lock_guard lock(mutex);
    if (keeping)
        recordedInsertions.push_back(stream.str().substr(before));
}

void insertNull(std::ostringstream& stream)
{
    stream.setstate(std::ios_base::badbit);
    const std::lock_guard lock(mutex);
    if (keeping)
        recordedInsertions.emplace_back("<null>");
}

} // namespace RecordedLog

namespace MVLog {

void MVLogger::logLevelMessage(const char* function, const char* file, int line, const std::string& category,
                               int level, const char* reserved, int first, int second,
                               const std::string& text)
{
    RecordedLog::record({RecordedLog::Channel::log, function, file, line, category, level,
                         reserved == nullptr, first, second, text});
}

void MVLogger::traceLevelMessage(const char* function, const char* file, int line,
                                 const std::string& category, int level, const char* reserved, int first,
                                 int second, const std::string& text)
{
    RecordedLog::record({RecordedLog::Channel::trace, function, file, line, category, level,
                         reserved == nullptr, first, second, text});
}

struct MVMessageBuffer::Implementation
{
    std::ostringstream stream;
};

MVMessageBuffer::MVMessageBuffer() : implementation_(std::make_unique<Implementation>()) {}
MVMessageBuffer::~MVMessageBuffer() = default;

MVMessageBuffer& MVMessageBuffer::operator<<(const char* text)
{
    if (text == nullptr)
        RecordedLog::insertNull(implementation_->stream);
    else
        RecordedLog::insert(implementation_->stream, text);
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(const std::string& text)
{
    RecordedLog::insert(implementation_->stream, text);
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(const void* address)
{
    RecordedLog::insert(implementation_->stream, address);
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(bool flag)
{
    RecordedLog::insert(implementation_->stream, flag);
    return *this;
}

std::string MVMessageBuffer::str() const
{
    return implementation_->stream.str();
}

} // namespace MVLog
