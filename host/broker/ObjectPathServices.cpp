#include "broker/Call.h"
#include "broker/NamedValues.h"
#include "broker/ObjectText.h"
#include "broker/Tables.h"
#include "broker/Values.h"
#include "cim/Values.h"

namespace cimhost {

namespace {

constexpr const char* thePath = "the object path";
constexpr const char* theSource = "the source path";

/// Sets one of the texts of a path; a null text takes it away.
CMPIStatus setText(const char* service, const CMPIObjectPath* path, std::string cim::ObjectPath::*member,
                   const char* text)
{
    return perform(service, [&](Call& call) {
        auto& content = call.use<ObjectPathObject>(path, thePath);
        content.path.edit().*member = text == nullptr ? "" : text;
    });
}

/// A text of a path; an empty one when it was not given.
CMPIString* getText(const char* service, const CMPIObjectPath* path, std::string cim::ObjectPath::*member,
                    CMPIStatus* rc)
{
    return serve(service, rc, static_cast<CMPIString*>(nullptr), [&](Call& call) {
        return call.makeString(call.use<ObjectPathObject>(path, thePath).path.read().*member);
    });
}

CMPIStatus release(CMPIObjectPath* path)
{
    return releaseObject<ObjectPathObject>("CMPIObjectPathFT.release", path);
}

CMPIObjectPath* clone(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return cloneObject<ObjectPathObject>("CMPIObjectPathFT.clone", path, rc);
}

CMPIStatus setNameSpace(const CMPIObjectPath* path, const char* nameSpace)
{
    return setText("CMPIObjectPathFT.setNameSpace", path, &cim::ObjectPath::nameSpace, nameSpace);
}

CMPIString* getNameSpace(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return getText("CMPIObjectPathFT.getNameSpace", path, &cim::ObjectPath::nameSpace, rc);
}

CMPIStatus setHostname(const CMPIObjectPath* path, const char* host)
{
    return setText("CMPIObjectPathFT.setHostname", path, &cim::ObjectPath::host, host);
}

CMPIString* getHostname(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return getText("CMPIObjectPathFT.getHostname", path, &cim::ObjectPath::host, rc);
}

CMPIStatus setClassName(const CMPIObjectPath* path, const char* className)
{
    return setText("CMPIObjectPathFT.setClassName", path, &cim::ObjectPath::className, className);
}

CMPIString* getClassName(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return getText("CMPIObjectPathFT.getClassName", path, &cim::ObjectPath::className, rc);
}

CMPIStatus addKey(const CMPIObjectPath* path, const char* name, const CMPIValue* value, const CMPIType type)
{
    return perform("CMPIObjectPathFT.addKey", [&](Call& call) {
        auto& content = call.use<ObjectPathObject>(path, thePath);
        call.text(name, "the name");
        const cim::Key* const present = findNamed(content.path.read().keys, name);
        if (present != nullptr && present->value.type != keptType(type))
            call.refuse(CMPI_RC_ERR_TYPE_MISMATCH, std::string("the key ") + name + " has the type " +
                                                       cim::typeName(present->value.type) + " already, not " +
                                                       cim::typeName(type));
        cim::Value taken = takeValue(call, value, type, "the value");
        setNamed(content.path.edit().keys, name, std::move(taken));
    });
}

CMPIData getKey(const CMPIObjectPath* path, const char* name, CMPIStatus* rc)
{
    return serve("CMPIObjectPathFT.getKey", rc, noData(CMPI_badValue), [&](Call& call) {
        const auto& content = call.use<ObjectPathObject>(path, thePath);
        return getNamed(call, content.path.read().keys, name, CMPI_RC_ERR_NOT_FOUND, CMPI_keyValue);
    });
}

CMPIData getKeyAt(const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus* rc)
{
    return serve("CMPIObjectPathFT.getKeyAt", rc, noData(CMPI_badValue), [&](Call& call) {
        const auto& content = call.use<ObjectPathObject>(path, thePath);
        return getNamedAt(call, content.path.read().keys, index, name, CMPI_RC_ERR_NOT_FOUND, CMPI_keyValue);
    });
}

CMPICount getKeyCount(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return serve("CMPIObjectPathFT.getKeyCount", rc, CMPICount{0}, [&](Call& call) {
        return static_cast<CMPICount>(call.use<ObjectPathObject>(path, thePath).path.read().keys.size());
    });
}

CMPIStatus setNameSpaceFromObjectPath(const CMPIObjectPath* path, const CMPIObjectPath* source)
{
    return perform("CMPIObjectPathFT.setNameSpaceFromObjectPath", [&](Call& call) {
        auto& content = call.use<ObjectPathObject>(path, thePath);
        const std::string nameSpace = call.use<ObjectPathObject>(source, theSource).path.read().nameSpace;
        content.path.edit().nameSpace = nameSpace;
    });
}

CMPIStatus setHostAndNameSpaceFromObjectPath(const CMPIObjectPath* path, const CMPIObjectPath* source)
{
    return perform("CMPIObjectPathFT.setHostAndNameSpaceFromObjectPath", [&](Call& call) {
        auto& content = call.use<ObjectPathObject>(path, thePath);
        const auto from = call.use<ObjectPathObject>(source, theSource).path.share();
        cim::ObjectPath& target = content.path.edit();
        target.host = from->host;
        target.nameSpace = from->nameSpace;
    });
}

// Qualifiers are known to clients only.

CMPIData noQualifier(const char* service, const CMPIObjectPath* path, CMPIStatus* rc)
{
    return serve(service, rc, noData(), [&](Call& call) {
        call.use<ObjectPathObject>(path, thePath);
        call.answerWith(CMPI_RC_ERR_NOT_SUPPORTED);
        return noData();
    });
}

CMPIData getClassQualifier(const CMPIObjectPath* path, const char* /*qualifier*/, CMPIStatus* rc)
{
    return noQualifier("CMPIObjectPathFT.getClassQualifier", path, rc);
}

CMPIData getPropertyQualifier(const CMPIObjectPath* path, const char* /*property*/, const char* /*qualifier*/,
                              CMPIStatus* rc)
{
    return noQualifier("CMPIObjectPathFT.getPropertyQualifier", path, rc);
}

CMPIData getMethodQualifier(const CMPIObjectPath* path, const char* /*method*/, const char* /*qualifier*/,
                            CMPIStatus* rc)
{
    return noQualifier("CMPIObjectPathFT.getMethodQualifier", path, rc);
}

CMPIData getParameterQualifier(const CMPIObjectPath* path, const char* /*method*/, const char* /*parameter*/,
                               const char* /*qualifier*/, CMPIStatus* rc)
{
    return noQualifier("CMPIObjectPathFT.getParameterQualifier", path, rc);
}

CMPIString* toString(const CMPIObjectPath* path, CMPIStatus* rc)
{
    return serve("CMPIObjectPathFT.toString", rc, static_cast<CMPIString*>(nullptr), [&](Call& call) {
        return call.makeString(objectText(call.resolve(path, thePath, Kind::objectPath)));
    });
}

} // namespace

CMPIObjectPathFT objectPathServices()
{
    return {servedVersion,
            release,
            clone,
            setNameSpace,
            getNameSpace,
            setHostname,
            getHostname,
            setClassName,
            getClassName,
            addKey,
            getKey,
            getKeyAt,
            getKeyCount,
            setNameSpaceFromObjectPath,
            setHostAndNameSpaceFromObjectPath,
            getClassQualifier,
            getPropertyQualifier,
            getMethodQualifier,
            getParameterQualifier,
            toString};
}

} // namespace cimhost
