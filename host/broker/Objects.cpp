#include "broker/Objects.h"

#include "broker/Names.h"

#include <cstdlib>

namespace cimhost {

namespace {

bool isReference(const cim::Property& property)
{
    return property.value.type == CMPI_ref && !property.value.isNull;
}

/// Adds the keys that the path lacks; false when there was none.
bool addKeys(cim::ObjectPath& path, const InstanceObject& instance)
{
    const cim::Instance& content = instance.content.read();
    const std::size_t before = path.keys.size();
    const bool keyless = content.path.keys.empty();

    for (const std::string& name : instance.keyNames) {
        const cim::Property* const property = findNamed(content.properties, name);
        if (property != nullptr && !property->value.isNull && findNamed(path.keys, name) == nullptr)
            path.keys.push_back({property->name, property->value});
    }
    const auto addReferences = [&](const std::vector<cim::Property>& properties) {
        for (const cim::Property& property : properties)
            if (isReference(property) && findNamed(path.keys, property.name) == nullptr)
                path.keys.push_back({property.name, property.value});
    };
    if (keyless) {
        addReferences(content.properties);
        addReferences(instance.hiddenReferences);
    }
    return path.keys.size() != before;
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
    cim::ObjectPath path = instance.content.read().path;
    addKeys(path, instance);
    return path;
}

std::shared_ptr<const cim::Instance> completed(const InstanceObject& instance)
{
    cim::ObjectPath path = instance.content.read().path;
    if (!addKeys(path, instance))
        return instance.content.share();
    return std::make_shared<const cim::Instance>(
        cim::Instance{std::move(path), instance.content.read().properties});
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
