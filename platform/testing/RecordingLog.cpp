#include "testing/RecordingLog.h"

#include <MVLog/MVLogger.h>

#include <mutex>
#include <utility>

namespace {

std::mutex guarded;
std::vector<RecordingLog::Line> lines;

void record(RecordingLog::Line line)
{
    const std::lock_guard<std::mutex> guard(guarded);
    lines.push_back(std::move(line));
}

} // namespace

std::vector<RecordingLog::Line> RecordingLog::take()
{
    const std::lock_guard<std::mutex> guard(guarded);
    return std::exchange(lines, {});
}

void MVLog::MVLogger::logLevelMessage(const char* function, const char* file, int line,
                                      const std::string& category, int level, const char*, int, int,
                                      const std::string& text)
{
    record({"log", function, file, line, category, level, text});
}

void MVLog::MVLogger::traceLevelMessage(const char* function, const char* file, int line,
                                        const std::string& category, int level, const char*, int, int,
                                        const std::string& text)
{
    record({"trace", function, file, line, category, level, text});
}
