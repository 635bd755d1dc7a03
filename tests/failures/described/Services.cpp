#include "Services.h"

#include <Tavro/Common.h>

namespace described {

namespace {

const CMPIBroker* servingBroker = nullptr;

const char* nameSpace(const Path* ref, Status& rc)
{
    return characters(ref->ft->getNameSpace(ref, &rc), rc);
}

const CMPIValue* chars(const std::string& text)
{
    return reinterpret_cast<const CMPIValue*>(text.c_str());
}

CMPIValue reference(const Path* path)
{
    CMPIValue value{};
    value.ref = const_cast<Path*>(path);
    return value;
}

} // namespace

void setBroker(const CMPIBroker* of)
{
    servingBroker = of;
}

const CMPIBroker* broker()
{
    return servingBroker;
}

void tell(CMPILevel level, const char* provider, const std::string& text)
{
    broker()->eft->trace(broker(), level, provider, text.c_str(), nullptr);
}

void report(const char* provider, Status& status, const std::string& message, const std::string& traceText)
{
    status = {CMPI_RC_ERR_FAILED, broker()->eft->newString(broker(), message.c_str(), nullptr)};
    tell(CMPI_LEV_WARNING, provider, traceText);
}

void report(const char* provider, Status& status, const std::string& text)
{
    report(provider, status, text, text);
}

const char* characters(const CMPIString* string, Status& rc)
{
    return string != nullptr ? string->ft->getCharPtr(string, &rc) : nullptr;
}

std::string className(const Path* path, Status& rc)
{
    const char* const name = characters(path->ft->getClassName(path, &rc), rc);
    return name != nullptr ? name : "";
}

Path* newPath(const Path* ref, const char* ofClass, Status& rc)
{
    return broker()->eft->newObjectPath(broker(), nameSpace(ref, rc), ofClass, &rc);
}

Path* newPathUnchecked(const Path* ref, const char* ofClass, Status& rc)
{
    return broker()->eft->newObjectPath(broker(), nameSpace(ref, rc), ofClass, nullptr);
}

void place(const Path* path, const Path* ref, Status& rc)
{
    if (path != nullptr)
        path->ft->setNameSpace(path, nameSpace(ref, rc));
}

void placeOnHost(const Path* path, const Path* ref, Status& rc)
{
    if (path == nullptr)
        return;
    place(path, ref, rc);
    path->ft->setHostname(path, Tavro::getSystemName().c_str());
}

void addKey(const Path* path, const char* name, const std::string& text)
{
    path->ft->addKey(path, name, chars(text), CMPI_chars);
}

void addKey(const Path* path, const char* name, const Path* value)
{
    const CMPIValue key = reference(value);
    path->ft->addKey(path, name, &key, CMPI_ref);
}

Instance* newInstance(const Path* path, Status* rc)
{
    return path != nullptr ? broker()->eft->newInstance(broker(), path, rc) : nullptr;
}

Path* pathOf(const Instance* instance, Status& rc)
{
    return instance != nullptr ? instance->ft->getObjectPath(instance, &rc) : nullptr;
}

void setFilter(const Instance* instance, std::vector<const char*> keys)
{
    keys.push_back(nullptr);
    instance->ft->setPropertyFilter(instance, nullptr, keys.data());
}

void setText(const Instance* instance, const char* name, const std::string& text)
{
    instance->ft->setProperty(instance, name, chars(text), CMPI_chars);
}

void setNumber(const Instance* instance, const char* name, unsigned int number)
{
    CMPIValue value{};
    value.uint16 = static_cast<CMPIUint16>(number);
    instance->ft->setProperty(instance, name, &value, CMPI_uint16);
}

void setFlag(const Instance* instance, const char* name, bool flag)
{
    CMPIValue value{};
    value.boolean = flag ? 1 : 0;
    instance->ft->setProperty(instance, name, &value, CMPI_boolean);
}

void setReference(const Instance* instance, const char* name, const Path* path)
{
    const CMPIValue value = reference(path);
    instance->ft->setProperty(instance, name, &value, CMPI_ref);
}

bool setNumbers(const Instance* instance, const char* name, const std::vector<std::uint16_t>& numbers,
                Status& rc)
{
    CMPIArray* const array =
        broker()->eft->newArray(broker(), static_cast<CMPICount>(numbers.size()), CMPI_uint16, &rc);
    if (array == nullptr)
        return false;
    CMPIValue value{};
    for (CMPICount i = 0; i < numbers.size(); ++i) {
        value.uint16 = numbers[i];
        array->ft->setElementAt(array, i, &value, CMPI_uint16);
    }
    value.array = array;
    instance->ft->setProperty(instance, name, &value, CMPI_uint16A);
    return true;
}

} // namespace described
