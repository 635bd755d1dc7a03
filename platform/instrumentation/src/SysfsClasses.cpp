#include "SysfsClasses.h"

#include "QuotedNames.h"

#include <array>

namespace Tavro {
namespace {

struct NamedClass
{
    std::string_view name;
    SysfsClass sysfsClass;
};

constexpr std::array namedClasses = {NamedClass{"leds", SysfsClass::Leds},
                                     NamedClass{"enclosures", SysfsClass::Enclosures}};

} // namespace

std::vector<SysfsClass> allSysfsClasses()
{
    std::vector<SysfsClass> all;
    all.reserve(namedClasses.size());
    for (const NamedClass& named : namedClasses)
        all.push_back(named.sysfsClass);
    return all;
}

std::optional<SysfsClass> findSysfsClass(std::string_view name)
{
    for (const NamedClass& named : namedClasses)
        if (named.name == name)
            return named.sysfsClass;
    return std::nullopt;
}

const char* folderOf(SysfsClass sysfsClass)
{
    return sysfsClass == SysfsClass::Leds ? "class/leds" : "class/enclosure";
}

std::string listSysfsClasses()
{
    return quotedNames(namedClasses);
}

} // namespace Tavro
