#include "broker/Call.h"
#include "broker/NamedValues.h"
#include "broker/Scope.h"
#include "broker/Tables.h"
#include "broker/Values.h"

#include <algorithm>
#include <iterator>

namespace cimhost {

namespace {

constexpr const char* theInstance = "the instance";

bool passesFilter(const InstanceObject& instance, const std::string& name)
{
    return !instance.wanted || instance.wanted->contains(name) || contains(instance.keyNames, name);
}

/// Keeps a property that does not pass the filter only as far as it identifies the instance.
void hide(InstanceObject& instance, const cim::Property& property)
{
    if (property.value.type == CMPI_ref)
        setNamed(instance.hiddenReferences, property.name.c_str(), property.value);
}

CMPIStatus release(CMPIInstance* instance)
{
    return releaseObject<InstanceObject>("CMPIInstanceFT.release", instance);
}

CMPIInstance* clone(const CMPIInstance* instance, CMPIStatus* rc)
{
    return cloneObject<InstanceObject>("CMPIInstanceFT.clone", instance, rc);
}

CMPIData getProperty(const CMPIInstance* instance, const char* name, CMPIStatus* rc)
{
    return serve("CMPIInstanceFT.getProperty", rc, noData(CMPI_badValue), [&](Call& call) {
        const auto& content = call.use<InstanceObject>(instance, theInstance);
        return getNamed(call, content.content.read().properties, name, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    });
}

CMPIData getPropertyAt(const CMPIInstance* instance, CMPICount index, CMPIString** name, CMPIStatus* rc)
{
    return serve("CMPIInstanceFT.getPropertyAt", rc, noData(CMPI_badValue), [&](Call& call) {
        const auto& content = call.use<InstanceObject>(instance, theInstance);
        return getNamedAt(call, content.content.read().properties, index, name, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    });
}

CMPICount getPropertyCount(const CMPIInstance* instance, CMPIStatus* rc)
{
    return serve("CMPIInstanceFT.getPropertyCount", rc, CMPICount{0}, [&](Call& call) {
        const auto& content = call.use<InstanceObject>(instance, theInstance);
        return static_cast<CMPICount>(content.content.read().properties.size());
    });
}

CMPIStatus set(const char* service, const CMPIInstance* instance, const char* name, const CMPIValue* value,
               CMPIType type)
{
    return perform(service, [&](Call& call) {
        auto& content = call.use<InstanceObject>(instance, theInstance);
        call.text(name, "the name");
        cim::Value taken = takeValue(call, value, type, "the value");
        if (passesFilter(content, name))
            setNamed(content.content.edit().properties, name, std::move(taken));
        else
            hide(content, {name, std::move(taken)});
    });
}

CMPIStatus setProperty(const CMPIInstance* instance, const char* name, const CMPIValue* value, CMPIType type)
{
    return set("CMPIInstanceFT.setProperty", instance, name, value, type);
}

CMPIObjectPath* getObjectPath(const CMPIInstance* instance, CMPIStatus* rc)
{
    return serve("CMPIInstanceFT.getObjectPath", rc, static_cast<CMPIObjectPath*>(nullptr), [&](Call& call) {
        const auto& content = call.use<InstanceObject>(instance, theInstance);
        return call.make<ObjectPathObject>(cim::CopyOnWrite<cim::ObjectPath>(completedPath(content)));
    });
}

CMPIStatus setPropertyFilter(const CMPIInstance* instance, const char** properties, const char** keyList)
{
    return perform("CMPIInstanceFT.setPropertyFilter", [&](Call& call) {
        auto& content = call.use<InstanceObject>(instance, theInstance);
        content.wanted.reset();
        content.keyNames.clear();
        if (keyList != nullptr)
            content.keyNames = takeNames(keyList);
        if (properties == nullptr)
            return;
        content.wanted = filterOf(call.core(), properties);

        auto& present = content.content.edit().properties;
        const auto dropped =
            std::stable_partition(present.begin(), present.end(), [&](const cim::Property& property) {
                return passesFilter(content, property.name);
            });
        std::for_each(dropped, present.end(),
                      [&](const cim::Property& property) { hide(content, property); });
        present.erase(dropped, present.end());
    });
}

CMPIStatus setObjectPath(const CMPIInstance* instance, const CMPIObjectPath* path)
{
    return perform("CMPIInstanceFT.setObjectPath", [&](Call& call) {
        auto& content = call.use<InstanceObject>(instance, theInstance);
        const auto given = call.use<ObjectPathObject>(path, "the object path").path.share();
        content.content.edit().path = *given;
    });
}

/// An origin says which class defines a property, which the declarations of classes do here.
CMPIStatus setPropertyWithOrigin(const CMPIInstance* instance, const char* name, const CMPIValue* value,
                                 const CMPIType type, const char* /*origin*/)
{
    return set("CMPIInstanceFT.setPropertyWithOrigin", instance, name, value, type);
}

} // namespace

CMPIInstanceFT instanceServices()
{
    return {servedVersion,        release,     clone,         getProperty,       getPropertyAt,
            getPropertyCount,     setProperty, getObjectPath, setPropertyFilter, setObjectPath,
            setPropertyWithOrigin};
}

} // namespace cimhost
