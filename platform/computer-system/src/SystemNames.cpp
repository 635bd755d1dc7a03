#include "SystemNames.h"

#include <algorithm>
#include <cstdlib>
#include <sstream>

#include <Tavro/Common.h>

namespace Tavro::ComputerSystem {
namespace {

std::vector<std::string> namesIn(const std::string& list)
{
    std::vector<std::string> names;
    std::istringstream items(list);
    for (std::string item; std::getline(items, item, ',');) {
        const std::string name = stripSpaces(item);
        if (!name.empty() && std::find(names.begin(), names.end(), name) == names.end())
            names.push_back(name);
    }
    return names;
}

} // namespace

std::vector<std::string> systemNames()
{
    if (const char* const list = secure_getenv("TAVRO_COMPUTER_SYSTEMS"))
        return namesIn(list);
    return {getSystemName()};
}

} // namespace Tavro::ComputerSystem
