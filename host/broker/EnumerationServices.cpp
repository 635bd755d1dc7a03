#include "broker/Call.h"
#include "broker/Tables.h"
#include "broker/Values.h"

namespace cimhost {

namespace {

CMPIStatus release(CMPIEnumeration* enumeration)
{
    return releaseObject<EnumerationObject>("CMPIEnumerationFT.release", enumeration);
}

CMPIEnumeration* clone(const CMPIEnumeration* enumeration, CMPIStatus* rc)
{
    return cloneObject<EnumerationObject>("CMPIEnumerationFT.clone", enumeration, rc);
}

CMPIData getNext(const CMPIEnumeration* enumeration, CMPIStatus* rc)
{
    return serve("CMPIEnumerationFT.getNext", rc, noData(CMPI_badValue), [&](Call& call) {
        auto& content = call.use<EnumerationObject>(enumeration, "the enumeration");
        if (content.position == content.elements.size()) {
            call.answerWith(CMPI_RC_ERR_NOT_FOUND);
            return noData();
        }
        const CMPIData data =
            giveScalar(call.core(), content.elements[content.position], content.elementType);
        ++content.position;
        return data;
    });
}

CMPIBoolean hasNext(const CMPIEnumeration* enumeration, CMPIStatus* rc)
{
    return serve("CMPIEnumerationFT.hasNext", rc, CMPIBoolean{0}, [&](Call& call) {
        const auto& content = call.use<EnumerationObject>(enumeration, "the enumeration");
        return static_cast<CMPIBoolean>(content.position < content.elements.size() ? 1 : 0);
    });
}

/// All elements, those that were read already included.
CMPIArray* toArray(const CMPIEnumeration* enumeration, CMPIStatus* rc)
{
    return serve("CMPIEnumerationFT.toArray", rc, static_cast<CMPIArray*>(nullptr), [&](Call& call) {
        const auto& content = call.use<EnumerationObject>(enumeration, "the enumeration");
        return call.make<ArrayObject>(content.elementType, content.elements);
    });
}

} // namespace

CMPIEnumerationFT enumerationServices()
{
    return {servedVersion, release, clone, getNext, hasNext, toArray};
}

} // namespace cimhost
