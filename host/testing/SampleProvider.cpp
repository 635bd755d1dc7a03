/// \file
/// Providers for the tests of the broker, each a class TEST_… of its own: one that behaves, and some
/// that break the interface in one way each. The first word of an entry point's name is the provider's.

#include "testing/ProviderParts.h"

#include <cstring>
#include <stdexcept>
#include <string>

#include <cmpift.h>

using namespace sample;

namespace {

CMPIObjectPath* thingPath(const CMPIObjectPath* request, const char* name)
{
    CMPIObjectPath* const path = newPath(request, "TEST_Thing");
    path->ft->addKey(path, "Name", chars(name), CMPI_chars);
    return path;
}

CMPIInstance* thing(const CMPIObjectPath* request, const char* name, const char** properties)
{
    CMPIInstance* const instance = broker->eft->newInstance(broker, thingPath(request, name), nullptr);
    const char* keys[] = {"Name", nullptr};
    instance->ft->setPropertyFilter(instance, properties, keys);
    instance->ft->setProperty(instance, "Name", chars(name), CMPI_chars);
    CMPIValue size;
    size.uint32 = static_cast<CMPIUint32>(std::strlen(name));
    instance->ft->setProperty(instance, "Size", &size, CMPI_uint32);
    return instance;
}

std::string shown(const char* text)
{
    return text == nullptr ? "null" : text;
}

std::string classNameOf(const CMPIObjectPath* path)
{
    return textOf(path->ft->getClassName(path, nullptr));
}

// TEST_Thing: two things, "one" and "three", of the sizes of their names.

namespace thing_provider {

CMPIStatus enumerateNames(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* result,
                          const CMPIObjectPath* path)
{
    for (const char* const name : {"one", "three"})
        result->ft->returnObjectPath(result, thingPath(path, name));
    result->ft->returnDone(result);
    return ok;
}

CMPIStatus enumerate(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* result,
                     const CMPIObjectPath* path, const char** properties)
{
    for (const char* const name : {"one", "three"})
        result->ft->returnInstance(result, thing(path, name, properties));
    result->ft->returnDone(result);
    return ok;
}

CMPIStatus get(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* result,
               const CMPIObjectPath* path, const char** properties)
{
    const CMPIData key = path->ft->getKey(path, "name", nullptr);
    const char* const wanted = key.type == CMPI_string && key.value.string != nullptr
                                   ? key.value.string->ft->getCharPtr(key.value.string, nullptr)
                                   : "";
    if (std::strcmp(wanted, "nothing") == 0)
        return ok;
    if (std::strcmp(wanted, "one") != 0 && std::strcmp(wanted, "three") != 0)
        return failure(CMPI_RC_ERR_NOT_FOUND, "no such thing");
    result->ft->returnInstance(result, thing(path, wanted, properties));
    result->ft->returnDone(result);
    return ok;
}

CMPIStatus create(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* result,
                  const CMPIObjectPath* /*path*/, const CMPIInstance* instance)
{
    result->ft->returnObjectPath(result, instance->ft->getObjectPath(instance, nullptr));
    return ok;
}

CMPIStatus modify(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* /*result*/,
                  const CMPIObjectPath* /*path*/, const CMPIInstance* instance, const char** properties)
{
    say("modify " + std::to_string(instance->ft->getPropertyCount(instance, nullptr)) + " " +
        shown(properties == nullptr ? nullptr : properties[0]));
    return ok;
}

CMPIStatus remove(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* /*result*/,
                  const CMPIObjectPath* /*path*/)
{
    return failure(CMPI_RC_ERR_ACCESS_DENIED, "things stay");
}

CMPIStatus query(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* result,
                 const CMPIObjectPath* path, const char* query, const char* language)
{
    say(shown(language) + " " + shown(query));
    result->ft->returnInstance(result, thing(path, "one", nullptr));
    return ok;
}

CMPIStatus cleanupAssociation(CMPIAssociationMI* /*mi*/, const CMPIContext* /*context*/,
                              CMPIBoolean /*terminating*/)
{
    say("cleanup association");
    return ok;
}

CMPIStatus associators(CMPIAssociationMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* result,
                       const CMPIObjectPath* path, const char* assocClass, const char* resultClass,
                       const char* role, const char* resultRole, const char** properties)
{
    say("associators " + shown(assocClass) + " " + shown(resultClass) + " " + shown(role) + " " +
        shown(resultRole) + " " + shown(properties == nullptr ? nullptr : properties[0]));
    result->ft->returnInstance(result, thing(path, "one", properties));
    return ok;
}

CMPIStatus associatorNames(CMPIAssociationMI* /*mi*/, const CMPIContext* /*context*/,
                           const CMPIResult* result, const CMPIObjectPath* path, const char* assocClass,
                           const char* resultClass, const char* role, const char* resultRole)
{
    say("associatorNames " + shown(assocClass) + " " + shown(resultClass) + " " + shown(role) + " " +
        shown(resultRole));
    result->ft->returnObjectPath(result, thingPath(path, "one"));
    return ok;
}

CMPIStatus references(CMPIAssociationMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* result,
                      const CMPIObjectPath* path, const char* resultClass, const char* role,
                      const char** properties)
{
    say("references " + shown(resultClass) + " " + shown(role));
    result->ft->returnInstance(result, thing(path, "three", properties));
    return ok;
}

CMPIStatus referenceNames(CMPIAssociationMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* result,
                          const CMPIObjectPath* path, const char* resultClass, const char* role)
{
    say("referenceNames " + shown(resultClass) + " " + shown(role));
    result->ft->returnObjectPath(result, thingPath(path, "three"));
    return ok;
}

} // namespace thing_provider

// TEST_Asking: answers with what the broker answers for TEST_Thing.

namespace asking_provider {

CMPIStatus enumerateNames(CMPIInstanceMI* /*mi*/, const CMPIContext* context, const CMPIResult* result,
                          const CMPIObjectPath* path)
{
    CMPIStatus status = ok;
    CMPIEnumeration* const found =
        broker->bft->enumerateInstanceNames(broker, context, newPath(path, "TEST_Thing"), &status);
    while (found != nullptr && found->ft->hasNext(found, nullptr) != 0)
        result->ft->returnObjectPath(result, found->ft->getNext(found, nullptr).value.ref);
    return status;
}

} // namespace asking_provider

// TEST_Recursing: asks itself, without an end.

namespace recursing_provider {

CMPIStatus enumerateNames(CMPIInstanceMI* /*mi*/, const CMPIContext* context, const CMPIResult* /*result*/,
                          const CMPIObjectPath* path)
{
    CMPIStatus status = ok;
    broker->bft->enumerateInstanceNames(broker, context, path, &status);
    return status;
}

} // namespace recursing_provider

// TEST_Throwing

namespace throwing_provider {

CMPIStatus enumerateNames(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/,
                          const CMPIResult* /*result*/, const CMPIObjectPath* /*path*/)
{
    throw std::runtime_error("too much");
}

CMPIStatus enumerate(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* /*result*/,
                     const CMPIObjectPath* /*path*/, const char** /*properties*/)
{
    throw 42; // NOLINT(hicpp-exception-baseclass): that it is none is the point
}

} // namespace throwing_provider

// TEST_Keeping: returns a path that it made in an earlier request.

namespace keeping_provider {

CMPIObjectPath* kept = nullptr;

CMPIStatus enumerateNames(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/, const CMPIResult* result,
                          const CMPIObjectPath* path)
{
    say("keeping " + classNameOf(path));
    if (kept == nullptr)
        kept = thingPath(path, "kept");
    return result->ft->returnObjectPath(result, kept);
}

} // namespace keeping_provider

// TEST_Setup: keeps what it makes in its factory function, and knows what came with it.

namespace setup_provider {

CMPIString* initialNameSpace = nullptr;

CMPIStatus enumerateNames(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/,
                          const CMPIResult* /*result*/, const CMPIObjectPath* /*path*/)
{
    say("set up for " + shown(initialNameSpace->ft->getCharPtr(initialNameSpace, nullptr)));
    return {CMPI_RC_ERR_FAILED, initialNameSpace};
}

} // namespace setup_provider

CMPIStatus neverUnload(CMPIInstanceMI* /*mi*/, const CMPIContext* /*context*/, CMPIBoolean /*terminating*/)
{
    return {CMPI_RC_NEVER_UNLOAD, nullptr};
}

} // namespace

extern "C" {

CMPIInstanceMI* Thing_Create_InstanceMI(const CMPIBroker* mb, const CMPIContext* /*context*/, CMPIStatus* rc)
{
    static CMPIInstanceMIFT table = notSupported("Thing");
    table.enumerateInstanceNames = thing_provider::enumerateNames;
    table.enumerateInstances = thing_provider::enumerate;
    table.getInstance = thing_provider::get;
    table.createInstance = thing_provider::create;
    table.modifyInstance = thing_provider::modify;
    table.deleteInstance = thing_provider::remove;
    table.execQuery = thing_provider::query;
    static CMPIInstanceMI mi{nullptr, &table};
    broker = mb;
    *rc = ok;
    say("create Thing");
    return &mi;
}

CMPIAssociationMI* Thing_Create_AssociationMI(const CMPIBroker* mb, const CMPIContext* /*context*/,
                                              CMPIStatus* /*rc*/)
{
    static const CMPIAssociationMIFT table{200,
                                           200,
                                           "Thing",
                                           thing_provider::cleanupAssociation,
                                           thing_provider::associators,
                                           thing_provider::associatorNames,
                                           thing_provider::references,
                                           thing_provider::referenceNames};
    static CMPIAssociationMI mi{nullptr, &table};
    broker = mb;
    return &mi;
}

CMPIInstanceMI* Asking_Create_InstanceMI(const CMPIBroker* mb, const CMPIContext* /*context*/,
                                         CMPIStatus* /*rc*/)
{
    static CMPIInstanceMIFT table = notSupported("Asking");
    table.enumerateInstanceNames = asking_provider::enumerateNames;
    static CMPIInstanceMI mi{nullptr, &table};
    broker = mb;
    return &mi;
}

CMPIInstanceMI* Recursing_Create_InstanceMI(const CMPIBroker* mb, const CMPIContext* /*context*/,
                                            CMPIStatus* /*rc*/)
{
    static CMPIInstanceMIFT table = notSupported("Recursing");
    table.enumerateInstanceNames = recursing_provider::enumerateNames;
    static CMPIInstanceMI mi{nullptr, &table};
    broker = mb;
    return &mi;
}

CMPIInstanceMI* Throwing_Create_InstanceMI(const CMPIBroker* mb, const CMPIContext* /*context*/,
                                           CMPIStatus* /*rc*/)
{
    static CMPIInstanceMIFT table = notSupported("Throwing");
    table.enumerateInstanceNames = throwing_provider::enumerateNames;
    table.enumerateInstances = throwing_provider::enumerate;
    static CMPIInstanceMI mi{nullptr, &table};
    broker = mb;
    return &mi;
}

CMPIInstanceMI* Keeping_Create_InstanceMI(const CMPIBroker* mb, const CMPIContext* /*context*/,
                                          CMPIStatus* /*rc*/)
{
    static CMPIInstanceMIFT table = notSupported("Keeping");
    table.enumerateInstanceNames = keeping_provider::enumerateNames;
    static CMPIInstanceMI mi{nullptr, &table};
    broker = mb;
    keeping_provider::kept = nullptr;
    return &mi;
}

CMPIInstanceMI* Setup_Create_InstanceMI(const CMPIBroker* mb, const CMPIContext* context, CMPIStatus* /*rc*/)
{
    static CMPIInstanceMIFT table = notSupported("Setup");
    table.enumerateInstanceNames = setup_provider::enumerateNames;
    table.cleanup = neverUnload;
    static CMPIInstanceMI mi{nullptr, &table};
    broker = mb;
    setup_provider::initialNameSpace =
        context->ft->getEntry(context, "CMPIInitNameSpace", nullptr).value.string;
    return &mi;
}

/// Asks, while it is being set up, for what it serves itself.
CMPIInstanceMI* Eager_Create_InstanceMI(const CMPIBroker* mb, const CMPIContext* context, CMPIStatus* /*rc*/)
{
    static CMPIInstanceMIFT table = notSupported("Eager");
    static CMPIInstanceMI mi{nullptr, &table};
    broker = mb;
    CMPIStatus status = ok;
    CMPIObjectPath* const path = mb->eft->newObjectPath(mb, "root/test", "TEST_Eager", nullptr);
    mb->bft->enumerateInstanceNames(mb, context, path, &status);
    say("eager: " + std::to_string(status.rc));
    return &mi;
}

CMPIInstanceMI* Refusing_Create_InstanceMI(const CMPIBroker* mb, const CMPIContext* /*context*/,
                                           CMPIStatus* rc)
{
    *rc = {CMPI_RC_ERR_ACCESS_DENIED, mb->eft->newString(mb, "not today", nullptr)};
    return nullptr;
}

CMPIInstanceMI* ThrowingFactory_Create_InstanceMI(const CMPIBroker* /*mb*/, const CMPIContext* /*context*/,
                                                  CMPIStatus* /*rc*/)
{
    throw std::runtime_error("no start");
}

CMPIInstanceMI* NoTable_Create_InstanceMI(const CMPIBroker* /*mb*/, const CMPIContext* /*context*/,
                                          CMPIStatus* /*rc*/)
{
    static CMPIInstanceMI mi{nullptr, nullptr};
    return &mi;
}

CMPIInstanceMI* OldTable_Create_InstanceMI(const CMPIBroker* /*mb*/, const CMPIContext* /*context*/,
                                           CMPIStatus* /*rc*/)
{
    static CMPIInstanceMIFT table = notSupported("OldTable");
    table.ftVersion = 99;
    static CMPIInstanceMI mi{nullptr, &table};
    return &mi;
}

CMPIInstanceMI* NullSlot_Create_InstanceMI(const CMPIBroker* /*mb*/, const CMPIContext* /*context*/,
                                           CMPIStatus* /*rc*/)
{
    static CMPIInstanceMIFT table = notSupported("NullSlot");
    table.getInstance = nullptr;
    static CMPIInstanceMI mi{nullptr, &table};
    return &mi;
}

CMPIAssociationMI* NullSlot_Create_AssociationMI(const CMPIBroker* /*mb*/, const CMPIContext* /*context*/,
                                                 CMPIStatus* /*rc*/)
{
    static const CMPIAssociationMIFT table{200,
                                           200,
                                           "NullSlot",
                                           thing_provider::cleanupAssociation,
                                           thing_provider::associators,
                                           thing_provider::associatorNames,
                                           nullptr,
                                           thing_provider::referenceNames};
    static CMPIAssociationMI mi{nullptr, &table};
    return &mi;
}

} // extern "C"
