#include "broker/Call.h"
#include "broker/DateTime.h"
#include "broker/Tables.h"

namespace cimhost {

namespace {

constexpr const char* theDateTime = "the datetime";

CMPIStatus release(CMPIDateTime* dateTime)
{
    return releaseObject<DateTimeObject>("CMPIDateTimeFT.release", dateTime);
}

CMPIDateTime* clone(const CMPIDateTime* dateTime, CMPIStatus* rc)
{
    return cloneObject<DateTimeObject>("CMPIDateTimeFT.clone", dateTime, rc);
}

/// A datetime that came with a request is text of anybody's.
const std::string& checked(Call& call, const CMPIDateTime* dateTime)
{
    const std::string& text = call.use<DateTimeObject>(dateTime, theDateTime).text;
    if (!isDateTime(text))
        Call::leave(CMPI_RC_ERR_FAILED);
    return text;
}

CMPIUint64 getBinaryFormat(const CMPIDateTime* dateTime, CMPIStatus* rc)
{
    return serve("CMPIDateTimeFT.getBinaryFormat", rc, CMPIUint64{0},
                 [&](Call& call) { return CMPIUint64{toMicroseconds(checked(call, dateTime))}; });
}

CMPIString* getStringFormat(const CMPIDateTime* dateTime, CMPIStatus* rc)
{
    return serve("CMPIDateTimeFT.getStringFormat", rc, static_cast<CMPIString*>(nullptr), [&](Call& call) {
        const std::string& text = call.use<DateTimeObject>(dateTime, theDateTime).text;
        return call.makeString(text);
    });
}

CMPIBoolean isIntervalService(const CMPIDateTime* dateTime, CMPIStatus* rc)
{
    return serve("CMPIDateTimeFT.isInterval", rc, CMPIBoolean{0}, [&](Call& call) {
        return static_cast<CMPIBoolean>(isInterval(checked(call, dateTime)) ? 1 : 0);
    });
}

} // namespace

CMPIDateTimeFT dateTimeServices()
{
    return {servedVersion, release, clone, getBinaryFormat, getStringFormat, isIntervalService};
}

} // namespace cimhost
