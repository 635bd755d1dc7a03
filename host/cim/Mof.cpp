#include "cim/Mof.h"

#include "cim/Literal.h"
#include "cim/ObjectPathText.h"
#include "cim/Utf8.h"

namespace cimhost::cim {

namespace {

template <typename Named>
std::string instanceText(const ObjectPath& path, const std::vector<Named>& values)
{
    std::string text = "// " + toText(path) + "\ninstance of " + printable(path.className) + "\n{\n";
    for (const Named& item : values)
        text += "    " + printable(item.name) + " = " + literal(item.value) + ";\n";
    return text + "};\n";
}

} // namespace

std::string mof(const Instance& instance)
{
    return instanceText(instance.path, instance.properties);
}

std::string mof(const ObjectPath& path)
{
    return instanceText(path, path.keys);
}

} // namespace cimhost::cim
