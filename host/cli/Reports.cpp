#include "cli/Reports.h"

#include "cim/Utf8.h"

#include <ostream>
#include <string>

namespace cimhost::cli {

namespace {

std::string levelName(CMPILevel level)
{
    switch (level) {
    case CMPI_LEV_INFO:
        return "INFO";
    case CMPI_LEV_WARNING:
        return "WARNING";
    case CMPI_LEV_VERBOSE:
        return "VERBOSE";
    }
    return "level " + std::to_string(level);
}

std::string severityName(CMPISeverity severity)
{
    switch (severity) {
    case CMPI_SEV_ERROR:
        return "ERROR";
    case CMPI_SEV_INFO:
        return "INFO";
    case CMPI_SEV_WARNING:
        return "WARNING";
    case CMPI_DEV_DEBUG:
        return "DEBUG";
    }
    return "severity " + std::to_string(severity);
}

/// The parts that are not empty, printable.
void writeLine(std::ostream& err, const std::string& heading, const std::string& origin,
               const std::string& text)
{
    err << "cimhost: " << heading;
    if (!origin.empty())
        err << ' ' << cim::printable(origin);
    err << ": " << cim::printable(text) << '\n';
}

} // namespace

Listeners reportTo(std::ostream& err, bool trace)
{
    Listeners listeners;
    listeners.misuse = [&err](const std::string& text) { writeLine(err, "provider misuse", "", text); };
    if (trace) {
        listeners.trace = [&err](const TraceRecord& record) {
            writeLine(err, "trace " + levelName(record.level), record.component, record.text);
        };
        listeners.log = [&err](const LogRecord& record) {
            writeLine(err, "log " + severityName(record.severity), record.id, record.text);
        };
    }
    return listeners;
}

} // namespace cimhost::cli
