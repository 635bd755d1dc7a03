#include "broker/Call.h"
#include "broker/NamedValues.h"
#include "broker/Tables.h"
#include "broker/Values.h"

namespace cimhost {

namespace {

constexpr const char* theArguments = "the argument list";

CMPIStatus release(CMPIArgs* args)
{
    return releaseObject<ArgsObject>("CMPIArgsFT.release", args);
}

CMPIArgs* clone(const CMPIArgs* args, CMPIStatus* rc)
{
    return cloneObject<ArgsObject>("CMPIArgsFT.clone", args, rc);
}

CMPIStatus addArg(const CMPIArgs* args, const char* name, const CMPIValue* value, const CMPIType type)
{
    return perform("CMPIArgsFT.addArg", [&](Call& call) {
        auto& content = call.use<ArgsObject>(args, theArguments);
        setNamed(content.arguments, call.text(name, "the name"), takeValue(call, value, type, "the value"));
    });
}

CMPIData getArg(const CMPIArgs* args, const char* name, CMPIStatus* rc)
{
    return serve("CMPIArgsFT.getArg", rc, noData(CMPI_badValue), [&](Call& call) {
        const auto& content = call.use<ArgsObject>(args, theArguments);
        return getNamed(call, content.arguments, name, CMPI_RC_ERR_NOT_FOUND);
    });
}

CMPIData getArgAt(const CMPIArgs* args, CMPICount index, CMPIString** name, CMPIStatus* rc)
{
    return serve("CMPIArgsFT.getArgAt", rc, noData(CMPI_badValue), [&](Call& call) {
        const auto& content = call.use<ArgsObject>(args, theArguments);
        return getNamedAt(call, content.arguments, index, name, CMPI_RC_ERR_NOT_FOUND);
    });
}

CMPICount getArgCount(const CMPIArgs* args, CMPIStatus* rc)
{
    return serve("CMPIArgsFT.getArgCount", rc, CMPICount{0}, [&](Call& call) {
        return static_cast<CMPICount>(call.use<ArgsObject>(args, theArguments).arguments.size());
    });
}

} // namespace

CMPIArgsFT argsServices()
{
    return {servedVersion, release, clone, addArg, getArg, getArgAt, getArgCount};
}

} // namespace cimhost
