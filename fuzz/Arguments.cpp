// Command lines of cimhost, an argument a line: read, answered with a text, or refused with lines that may go
// to a terminal.

#include "FuzzTarget.h"

#include "cim/Utf8.h"
#include "cli/Arguments.h"

#include <sstream>
#include <variant>
#include <vector>

using namespace cimhost;

namespace {

std::vector<std::string> linesOf(const std::string& text)
{
    std::istringstream stream(text);
    std::vector<std::string> lines;
    for (std::string line; std::getline(stream, line);)
        lines.push_back(line.substr(0, line.find('\0'))); // where the system ends an argument
    return lines;
}

} // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    try {
        const auto read = cli::parseArguments(linesOf(Fuzz::textOf(data, size)));
        if (const auto* const notice = std::get_if<cli::Notice>(&read)) {
            Fuzz::require(!notice->text.empty(), "a notice has a text");
        } else if (const auto* const measurement = std::get_if<cli::Measurement>(&read)) {
            Fuzz::require(!measurement->metrics.target.className.empty(), "a measurement names a class");
        } else {
            const cli::Command& command = std::get<cli::Invocation>(read).command;
            const auto* const ask = std::get_if<cli::Ask>(&command);
            Fuzz::require(ask == nullptr || !ask->request.target.className.empty(),
                          "a request names a class");
        }
    } catch (const cli::UsageError& error) {
        for (const std::string& line : linesOf(error.what()))
            Fuzz::require(cim::printable(line) == line, "a refusal may go to a terminal");
    }
    return 0;
}
