#include "broker/ObjectText.h"

#include "broker/Objects.h"
#include "cim/Mof.h"
#include "cim/ObjectPathText.h"

namespace cimhost {

std::string objectText(const Handle& handle)
{
    switch (handle.kind) {
    case Kind::objectPath:
        return cim::toText(contentOf<ObjectPathObject>(handle).path.read());
    case Kind::instance:
        return cim::mof(*completed(contentOf<InstanceObject>(handle)));
    case Kind::string:
        return contentOf<StringObject>(handle).text;
    case Kind::dateTime:
        return contentOf<DateTimeObject>(handle).text;
    default:
        return typeName(handle.kind);
    }
}

} // namespace cimhost
