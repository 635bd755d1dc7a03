#include "broker/Call.h"
#include "broker/Tables.h"

namespace cimhost {

namespace {

constexpr const char* theResult = "the result";

ResultObject& open(Call& call, const CMPIResult* result)
{
    auto& content = call.use<ResultObject>(result, theResult);
    if (content.doneCount > 0)
        call.refuse(CMPI_RC_ERR_INVALID_HANDLE, "returnDone was called before");
    return content;
}

/// A result is its request's; it cannot go before it.
CMPIStatus release(CMPIResult* result)
{
    return perform("CMPIResultFT.release", [&](Call& call) {
        call.use<ResultObject>(result, theResult);
        Call::leave(CMPI_RC_ERR_NOT_SUPPORTED);
    });
}

CMPIResult* clone(const CMPIResult* result, CMPIStatus* rc)
{
    return serve("CMPIResultFT.clone", rc, static_cast<CMPIResult*>(nullptr), [&](Call& call) -> CMPIResult* {
        call.use<ResultObject>(result, theResult);
        Call::leave(CMPI_RC_ERR_NOT_SUPPORTED);
    });
}

/// Only methods return data, and there are none here.
CMPIStatus returnData(const CMPIResult* result, const CMPIValue* /*value*/, const CMPIType /*type*/)
{
    return perform("CMPIResultFT.returnData", [&](Call& call) {
        open(call, result);
        Call::leave(CMPI_RC_ERR_NOT_SUPPORTED);
    });
}

CMPIStatus returnInstance(const CMPIResult* result, const CMPIInstance* instance)
{
    return perform("CMPIResultFT.returnInstance", [&](Call& call) {
        ResultObject& content = open(call, result);
        content.instances.push_back(
            cim::CopyOnWrite(completed(call.use<InstanceObject>(instance, "the instance"))));
    });
}

CMPIStatus returnObjectPath(const CMPIResult* result, const CMPIObjectPath* path)
{
    return perform("CMPIResultFT.returnObjectPath", [&](Call& call) {
        ResultObject& content = open(call, result);
        content.paths.push_back(call.use<ObjectPathObject>(path, "the object path").path);
    });
}

CMPIStatus returnDone(const CMPIResult* result)
{
    return perform("CMPIResultFT.returnDone", [&](Call& call) {
        auto& content = call.use<ResultObject>(result, theResult);
        ++content.doneCount;
        if (content.doneCount > 1)
            call.refuse(CMPI_RC_ERR_INVALID_HANDLE, "returnDone was called before");
    });
}

/// An answer has one status, that of the operation.
CMPIStatus returnError(const CMPIResult* result, const CMPIError* error)
{
    return perform("CMPIResultFT.returnError", [&](Call& call) {
        open(call, result);
        call.use<ErrorObject>(error, "the error");
        Call::leave(CMPI_RC_ERR_NOT_SUPPORTED);
    });
}

} // namespace

CMPIResultFT resultServices()
{
    return {servedVersion,  release,          clone,      returnData,
            returnInstance, returnObjectPath, returnDone, returnError};
}

} // namespace cimhost
