#include "Trace.h"

#include <MVLog/MVLogger.h>

#include <utility>

namespace described {

namespace {

void log(const std::string& module, const std::string& function, int level, const std::string& text)
{
    const std::string file = module + ".cpp";
    for (const auto& write : {&MVLog::MVLogger::logLevelMessage, &MVLog::MVLogger::traceLevelMessage})
        write(function.c_str(), file.c_str(), 1, "Mavrel." + module, level, nullptr, 0, 0, text);
}

} // namespace

Flow::Flow(std::string inModule, std::string ofFunction)
    : module(std::move(inModule)),
      function(std::move(ofFunction))
{
    line("ENTERING");
}

void Flow::exiting() const
{
    line("EXITING");
}

void Flow::enumerationFailed() const
{
    log(module, function, 6000,
        "MESSAGE [File: " + module + ".cpp, Line: 1]: Call to CBEnumInstances of target Class Failed.");
}

void Flow::line(const std::string& kind) const
{
    log(module, function, 3000,
        kind + ": " + function + "() in " + module + ".cpp [Line: 1],Parameters List: ");
}

} // namespace described
