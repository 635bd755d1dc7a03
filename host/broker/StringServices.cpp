#include "broker/Call.h"
#include "broker/Tables.h"

namespace cimhost {

namespace {

CMPIStatus release(CMPIString* string)
{
    return releaseObject<StringObject>("CMPIStringFT.release", string);
}

CMPIString* clone(const CMPIString* string, CMPIStatus* rc)
{
    return cloneObject<StringObject>("CMPIStringFT.clone", string, rc);
}

const char* getCharPtr(const CMPIString* string, CMPIStatus* rc)
{
    return serve("CMPIStringFT.getCharPtr", rc, static_cast<const char*>(nullptr),
                 [&](Call& call) { return call.use<StringObject>(string, "the string").text.c_str(); });
}

} // namespace

CMPIStringFT stringServices()
{
    return {servedVersion, release, clone, getCharPtr};
}

} // namespace cimhost
