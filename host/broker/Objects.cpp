#include "broker/Objects.h"

#include "broker/Names.h"

#include <cstdlib>
#include <iterator>
#include <utility>

namespace cimhost {

namespace {

bool isReference(const cim::Property& property)
{
    return property.value.type == CMPI_ref && !property.value.isNull;
}

/// The keys that the instance's path lacks.
std::vector<cim::Key> missingKeys(const InstanceObject& instance)
{
    const cim::Instance& content = instance.content.read();
    std::vector<cim::Key> missing;
    const auto add = [&](const cim::Property& property) {
        if (!property.value.isNull && findNamed(content.path.keys, property.name) == nullptr &&
            findNamed(missing, property.name) == nullptr)
            missing.push_back({property.name, property.value});
    };
    const auto addNamed = [&](const std::vector<std::string>& names) {
        for (const std::string& name : names)
            for (const auto* const properties : {&content.properties, &instance.hiddenReferences})
                if (const cim::Property* const property = findNamed(*properties, name))
                    add(*property);
    };

    addNamed(instance.keyNames);
    if (instance.classKeys != nullptr)
        addNamed(*instance.classKeys);
    if (instance.classKeys != nullptr || !content.path.keys.empty())
        return missing;
    for (const auto* const properties : {&content.properties, &instance.hiddenReferences})
        for (const cim::Property& property : *properties)
            if (isReference(property))
                add(property);
    return missing;
}

cim::ObjectPath withKeys(cim::ObjectPath path, std::vector<cim::Key> keys)
{
    path.keys.insert(path.keys.end(), std::make_move_iterator(keys.begin()),
                     std::make_move_iterator(keys.end()));
    return path;
}

template <class Object>
void destroy(void* payload) noexcept
{
    delete static_cast<Object*>(payload);
}

void destroy(Kind kind, void* payload) noexcept
{
    switch (kind) {
    case Kind::objectPath:
        return destroy<ObjectPathObject>(payload);
    case Kind::instance:
        return destroy<InstanceObject>(payload);
    case Kind::string:
        return destroy<StringObject>(payload);
    case Kind::array:
        return destroy<ArrayObject>(payload);
    case Kind::enumeration:
        return destroy<EnumerationObject>(payload);
    case Kind::context:
        return destroy<ContextObject>(payload);
    case Kind::result:
        return destroy<ResultObject>(payload);
    case Kind::args:
        return destroy<ArgsObject>(payload);
    case Kind::dateTime:
        return destroy<DateTimeObject>(payload);
    case Kind::error:
        return destroy<ErrorObject>(payload);
    case Kind::mark:
        return destroy<MarkObject>(payload);
    case Kind::memory:
        return destroy<MemoryObject>(payload);
    }
}

} // namespace

cim::ObjectPath completedPath(const InstanceObject& instance)
{
    return withKeys(instance.content.read().path, missingKeys(instance));
}

std::shared_ptr<const cim::Instance> completed(const InstanceObject& instance)
{
    std::vector<cim::Key> missing = missingKeys(instance);
    if (missing.empty())
        return instance.content.share();
    const cim::Instance& content = instance.content.read();
    return std::make_shared<const cim::Instance>(
        cim::Instance{withKeys(content.path, std::move(missing)), content.properties});
}

MemoryObject::~MemoryObject()
{
    std::free(block);
}

const char* typeName(Kind kind)
{
    switch (kind) {
    case Kind::objectPath:
        return "CMPIObjectPath";
    case Kind::instance:
        return "CMPIInstance";
    case Kind::string:
        return "CMPIString";
    case Kind::array:
        return "CMPIArray";
    case Kind::enumeration:
        return "CMPIEnumeration";
    case Kind::context:
        return "CMPIContext";
    case Kind::result:
        return "CMPIResult";
    case Kind::args:
        return "CMPIArgs";
    case Kind::dateTime:
        return "CMPIDateTime";
    case Kind::error:
        return "CMPIError";
    case Kind::mark:
        return "CMPIGcStat";
    case Kind::memory:
        return "block of memory";
    }
    return "";
}

bool end(Handle& handle, State to) noexcept
{
    State expected = State::live;
    if (!handle.state.compare_exchange_strong(expected, to))
        return false;
    destroy(handle.kind, std::exchange(handle.payload, nullptr));
    return true;
}

} // namespace cimhost
