#include "MVLog/MVLogger.h"

#include "Log.h"

namespace MVLog {

void MVLogger::logLevelMessage(const char* function, const char* file, int line, const std::string& category,
                               int level, const char* /*reserved*/, int, int, const std::string& text)
{
    write(Channel::log, {function, file, line, category, level, text});
}

void MVLogger::traceLevelMessage(const char* function, const char* file, int line,
                                 const std::string& category, int level, const char* /*reserved*/, int, int,
                                 const std::string& text)
{
    write(Channel::trace, {function, file, line, category, level, text});
}

} // namespace MVLog
