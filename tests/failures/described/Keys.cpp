#include "Keys.h"

namespace described {

bool hasKeys(const char* provider, const Path* cop, Status& status)
{
    if (cop->ft->getKeyCount(cop, &status) != 0)
        return true;
    report(provider, status, "At least one key should be passed");
    return false;
}

CMPIString* textKey(const Path* cop, const char* name, Status& status)
{
    const CMPIData key = cop->ft->getKey(cop, name, &status);
    return key.type == CMPI_string && !missing(key.value.string) ? key.value.string : nullptr;
}

} // namespace described
