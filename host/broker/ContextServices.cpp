#include "broker/Call.h"
#include "broker/NamedValues.h"
#include "broker/Tables.h"
#include "broker/Values.h"

namespace cimhost {

namespace {

constexpr const char* theContext = "the context";

CMPIStatus release(CMPIContext* context)
{
    return releaseObject<ContextObject>("CMPIContextFT.release", context);
}

CMPIContext* clone(const CMPIContext* context, CMPIStatus* rc)
{
    return cloneObject<ContextObject>("CMPIContextFT.clone", context, rc);
}

CMPIData getEntry(const CMPIContext* context, const char* name, CMPIStatus* rc)
{
    return serve("CMPIContextFT.getEntry", rc, noData(CMPI_badValue), [&](Call& call) {
        const auto& content = call.use<ContextObject>(context, theContext);
        return getNamed(call, content.entries, name, CMPI_RC_ERR_NOT_FOUND);
    });
}

CMPIData getEntryAt(const CMPIContext* context, CMPICount index, CMPIString** name, CMPIStatus* rc)
{
    return serve("CMPIContextFT.getEntryAt", rc, noData(CMPI_badValue), [&](Call& call) {
        const auto& content = call.use<ContextObject>(context, theContext);
        return getNamedAt(call, content.entries, index, name, CMPI_RC_ERR_NOT_FOUND);
    });
}

CMPICount getEntryCount(const CMPIContext* context, CMPIStatus* rc)
{
    return serve("CMPIContextFT.getEntryCount", rc, CMPICount{0}, [&](Call& call) {
        return static_cast<CMPICount>(call.use<ContextObject>(context, theContext).entries.size());
    });
}

CMPIStatus addEntry(const CMPIContext* context, const char* name, const CMPIValue* value, const CMPIType type)
{
    return perform("CMPIContextFT.addEntry", [&](Call& call) {
        auto& content = call.use<ContextObject>(context, theContext);
        setNamed(content.entries, call.text(name, "the name"), takeValue(call, value, type, "the value"));
    });
}

} // namespace

CMPIContextFT contextServices()
{
    return {servedVersion, release, clone, getEntry, getEntryAt, getEntryCount, addEntry};
}

} // namespace cimhost
