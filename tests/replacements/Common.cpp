// Another maker's common support library, on a host with a name of its own.

#include <Tavro/Common.h>

namespace Tavro {

std::string getSystemName()
{
    return "replaced-system";
}
bool isObjPathsEqual(const CMPIObjectPath*, const CMPIObjectPath*, bool)
{
    return false;
}
std::string stripSpaces(const std::string& text)
{
    return text;
}

} // namespace Tavro
