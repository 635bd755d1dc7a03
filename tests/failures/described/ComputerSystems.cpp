#include "ComputerSystems.h"

namespace described {

CMPIEnumeration* computerSystemNames(const Flow& operation, const CMPIContext* ctx, const Path* classPath,
                                     Status& rc)
{
    CMPIEnumeration* const names = broker()->bft->enumerateInstanceNames(broker(), ctx, classPath, &rc);
    if (rc.rc != CMPI_RC_OK)
        operation.enumerationFailed();
    return names;
}

CMPIEnumeration* computerSystemInstances(const CMPIContext* ctx, const Path* classPath, Status& rc)
{
    return broker()->bft->enumerateInstances(broker(), ctx, classPath, nullptr, &rc);
}

bool hasNext(const CMPIEnumeration* items)
{
    return items != nullptr && items->ft->hasNext(items, nullptr) != 0;
}

Path* nextPath(const CMPIEnumeration* items)
{
    const CMPIData item = items->ft->getNext(items, nullptr);
    return item.type == CMPI_ref ? item.value.ref : nullptr;
}

Instance* nextInstance(const CMPIEnumeration* items)
{
    const CMPIData item = items->ft->getNext(items, nullptr);
    return item.type == CMPI_instance ? item.value.inst : nullptr;
}

} // namespace described
