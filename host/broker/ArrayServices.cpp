#include "broker/Call.h"
#include "broker/Tables.h"
#include "broker/Values.h"
#include "cim/Values.h"

namespace cimhost {

namespace {

CMPIStatus release(CMPIArray* array)
{
    return releaseObject<ArrayObject>("CMPIArrayFT.release", array);
}

CMPIArray* clone(const CMPIArray* array, CMPIStatus* rc)
{
    return cloneObject<ArrayObject>("CMPIArrayFT.clone", array, rc);
}

CMPICount getSize(const CMPIArray* array, CMPIStatus* rc)
{
    return serve("CMPIArrayFT.getSize", rc, CMPICount{0}, [&](Call& call) {
        return static_cast<CMPICount>(call.use<ArrayObject>(array, "the array").elements.size());
    });
}

CMPIType getSimpleType(const CMPIArray* array, CMPIStatus* rc)
{
    return serve("CMPIArrayFT.getSimpleType", rc, CMPIType{CMPI_null},
                 [&](Call& call) { return call.use<ArrayObject>(array, "the array").elementType; });
}

CMPIData getElementAt(const CMPIArray* array, CMPICount index, CMPIStatus* rc)
{
    return serve("CMPIArrayFT.getElementAt", rc, noData(CMPI_badValue), [&](Call& call) {
        const ArrayObject& content = call.use<ArrayObject>(array, "the array");
        if (index >= content.elements.size()) {
            call.answerWith(CMPI_RC_ERR_NO_SUCH_PROPERTY);
            return noData();
        }
        return giveScalar(call.core(), content.elements[index], content.elementType);
    });
}

CMPIStatus setElementAt(const CMPIArray* array, CMPICount index, const CMPIValue* value, CMPIType type)
{
    return perform("CMPIArrayFT.setElementAt", [&](Call& call) {
        auto& content = call.use<ArrayObject>(array, "the array");
        if (index >= content.elements.size())
            Call::leave(CMPI_RC_ERR_NO_SUCH_PROPERTY);
        if (type != CMPI_null && keptType(type) != content.elementType)
            call.refuse(CMPI_RC_ERR_TYPE_MISMATCH, "an element of the type " + cim::typeName(type) +
                                                       " for an array of the type " +
                                                       cim::typeName(content.elementType));
        content.elements[index] = takeScalar(call, value, type, "the element");
    });
}

} // namespace

CMPIArrayFT arrayServices()
{
    return {servedVersion, release, clone, getSize, getSimpleType, getElementAt, setElementAt};
}

} // namespace cimhost
