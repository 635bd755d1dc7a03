#include "ErrorLine.h"

#include <MVLog/MVLogger.h>

namespace Tavro {

void logError(const CodePlace& place, const std::string& text)
{
    constexpr int errorLevel = 6000;
    MVLog::MVLogger::logLevelMessage(place.function, place.file, place.line, "Mavrel.Instrumentation",
                                     errorLevel, nullptr, 0, 0, text);
}

} // namespace Tavro
