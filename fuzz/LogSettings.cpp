// The environment of the logging library, a variable a line: settings that can be used, and a complaint for
// each variable that cannot.

#include "FuzzTarget.h"

#include "Settings.h"

#include <map>
#include <sstream>

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    std::map<std::string, std::string> variables;
    std::istringstream lines(Fuzz::textOf(data, size));
    for (std::string line; std::getline(lines, line);)
        if (const std::string::size_type end = line.find('='); end != std::string::npos)
            variables[line.substr(0, end)] = line.substr(end + 1);

    const MVLog::Settings settings = MVLog::readSettings([&](const char* name) {
        const auto found = variables.find(name);
        return found == variables.end() ? nullptr : found->second.c_str();
    });
    for (const MVLog::ChannelSettings& channel : {settings.log, settings.trace}) {
        Fuzz::require(channel.leastLevel >= 0 && channel.leastLevel <= MVLog::off, "a level is one, or off");
        Fuzz::require(channel.output.path.empty() == (channel.output.kind == MVLog::Output::standardError),
                      "whatever is opened has a path");
    }
    for (const std::string& category : settings.categories)
        Fuzz::require(!category.empty(), "a category has a name");
    MVLog::isWanted(settings.categories, "Mavrel.Glimmark");
    Fuzz::require(settings.complaints.size() <= variables.size(),
                  "there is one complaint a variable at most");
    return 0;
}
