#include "cli/Reports.h"

#include "cim/Utf8.h"

#include <cstddef>
#include <ostream>
#include <set>
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

/// Lines that were said. A provider that makes a mistake makes it at each object, and at each request.
class SaidLines
{
public:
    /// Whether it is to be said: it was not, and not too many others were.
    bool add(const std::string& line) { return said_.size() < most && said_.insert(line).second; }
    [[nodiscard]] bool isFull() const { return said_.size() == most; }

private:
    static constexpr std::size_t most = 1000;

    std::set<std::string> said_;
};

} // namespace

Listeners reportTo(std::ostream& err, bool trace)
{
    Listeners listeners;
    listeners.misuse = [&err, said = SaidLines()](const std::string& text) mutable {
        if (!said.add(text))
            return;
        writeLine(err, "provider misuse", "", text);
        if (said.isFull())
            writeLine(err, "provider misuse", "", "no more is told of it");
    };
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
