#include "broker/Call.h"
#include "broker/NamedValues.h"
#include "broker/Tables.h"
#include "broker/Values.h"

namespace cimhost {

namespace {

using Scalars = std::vector<cim::Value::Scalar>;

constexpr unsigned int capabilities = CMPI_MB_BasicRead | CMPI_MB_InstanceManipulation |
                                      CMPI_MB_AssociationTraversal | CMPI_MB_OSEncapsulationSupport |
                                      CMPI_MB_Logging | CMPI_MB_Tracing | CMPI_MB_PropertyFiltering;

/// A provider asks the broker for something: what every such call must come with.
Broker& called(Call& call, const CMPIBroker* broker, const CMPIContext* context)
{
    Core& core = call.broker(broker);
    call.use<ContextObject>(context, "the context");
    return core.broker;
}

/// A copy: the request that is to come must not change what the caller holds.
cim::ObjectPath pathOf(Call& call, const CMPIObjectPath* path)
{
    return call.use<ObjectPathObject>(path, "the object path").path.read();
}

cim::PropertyList listOf(const char* const* names)
{
    return names == nullptr ? cim::PropertyList() : takeNames(names);
}

std::optional<std::string> given(const char* text)
{
    return text == nullptr ? std::nullopt : std::make_optional<std::string>(text);
}

/// Hands an answer's status on to the caller of an up-call. False when it is an error.
bool passStatus(Call& call, const cim::Status& status)
{
    CMPIString* const message = status.message ? call.makeString(*status.message) : nullptr;
    call.answerWith(CMPIStatus{status.code, message});
    return status.code == CMPI_RC_OK;
}

/// The objects of an answer as an enumeration of the caller's; null when the answer is an error.
template <class Content>
CMPIEnumeration* enumerate(Call& call, const cim::Status& status, const cim::SharedList<Content>& objects,
                           CMPIType type)
{
    if (!passStatus(call, status))
        return nullptr;
    Scalars elements;
    elements.reserve(objects.size());
    for (const auto& object : objects.shared())
        elements.emplace_back(object.share());
    return call.make<EnumerationObject>(type, std::move(elements));
}

/// Runs an up-call that brings paths.
/// \param ask  makes the request of the broker
template <class Ask>
CMPIEnumeration* enumeratePaths(const char* service, const CMPIBroker* broker, const CMPIContext* context,
                                const CMPIObjectPath* path, CMPIStatus* rc, const Ask& ask)
{
    return serve(service, rc, static_cast<CMPIEnumeration*>(nullptr), [&](Call& call) {
        Broker& asked = called(call, broker, context);
        const cim::Answer answer = ask(asked, pathOf(call, path));
        return enumerate(call, answer.status, answer.paths, CMPI_ref);
    });
}

/// The same for one that brings instances.
template <class Ask>
CMPIEnumeration* enumerateObjects(const char* service, const CMPIBroker* broker, const CMPIContext* context,
                                  const CMPIObjectPath* path, CMPIStatus* rc, const Ask& ask)
{
    return serve(service, rc, static_cast<CMPIEnumeration*>(nullptr), [&](Call& call) {
        Broker& asked = called(call, broker, context);
        const cim::Answer answer = ask(asked, pathOf(call, path));
        return enumerate(call, answer.status, answer.instances, CMPI_instance);
    });
}

/// The one instance of an answer; null when the answer is an error.
const cim::Instance* single(Call& call, const cim::Answer& answer)
{
    return passStatus(call, answer.status) ? &answer.instances.front() : nullptr;
}

// Threads of a provider's own. The objects that such a thread makes between attachThread and
// detachThread belong to a request of its own.

/// At most one; the thread's end detaches it, too.
std::unique_ptr<Scope>& attachment()
{
    thread_local std::unique_ptr<Scope> scope;
    return scope;
}

CMPIContext* prepareAttachThread(const CMPIBroker* broker, const CMPIContext* context)
{
    return serve(
        "CMPIBrokerFT.prepareAttachThread", nullptr, static_cast<CMPIContext*>(nullptr), [&](Call& call) {
            Core& core = call.broker(broker);
            const auto& content = call.use<ContextObject>(context, "the context");
            return envelopeOf<ContextObject>(makeLasting(core, std::make_unique<ContextObject>(content)));
        });
}

CMPIStatus attachThread(const CMPIBroker* broker, const CMPIContext* context)
{
    return perform("CMPIBrokerFT.attachThread", [&](Call& call) {
        called(call, broker, context);
        if (Scope::currentCore() != nullptr)
            call.refuse(CMPI_RC_ERR_FAILED, "the thread is in a request already");
        attachment() = std::make_unique<Scope>(call.core());
    });
}

CMPIStatus detachThread(const CMPIBroker* broker, const CMPIContext* context)
{
    return perform("CMPIBrokerFT.detachThread", [&](Call& call) {
        called(call, broker, context);
        if (attachment() == nullptr || attachment().get() != Scope::innermost(call.core()))
            call.refuse(CMPI_RC_ERR_FAILED, "the thread is not attached");
        attachment().reset();
    });
}

CMPIStatus deliverIndication(const CMPIBroker* broker, const CMPIContext* context, const char* /*nameSpace*/,
                             const CMPIInstance* indication)
{
    return perform("CMPIBrokerFT.deliverIndication", [&](Call& call) {
        called(call, broker, context);
        call.use<InstanceObject>(indication, "the indication");
        Call::leave(CMPI_RC_ERR_NOT_SUPPORTED);
    });
}

CMPIEnumeration* enumerateInstanceNames(const CMPIBroker* broker, const CMPIContext* context,
                                        const CMPIObjectPath* classPath, CMPIStatus* rc)
{
    return enumeratePaths(
        "CMPIBrokerFT.enumerateInstanceNames", broker, context, classPath, rc,
        [](Broker& asked, const cim::ObjectPath& path) { return asked.enumerateInstanceNames(path); });
}

CMPIInstance* getInstance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                          const char** properties, CMPIStatus* rc)
{
    return serve("CMPIBrokerFT.getInstance", rc, static_cast<CMPIInstance*>(nullptr), [&](Call& call) {
        Broker& asked = called(call, broker, context);
        const cim::Answer answer = asked.getInstance(pathOf(call, path), listOf(properties));
        const cim::Instance* const instance = single(call, answer);
        return instance == nullptr
                   ? nullptr
                   : call.make<InstanceObject>(std::make_shared<const cim::Instance>(*instance));
    });
}

CMPIObjectPath* createInstance(const CMPIBroker* broker, const CMPIContext* context,
                               const CMPIObjectPath* classPath, const CMPIInstance* instance, CMPIStatus* rc)
{
    return serve("CMPIBrokerFT.createInstance", rc, static_cast<CMPIObjectPath*>(nullptr), [&](Call& call) {
        Broker& asked = called(call, broker, context);
        const auto given = completed(call.use<InstanceObject>(instance, "the instance"));
        const cim::Answer answer = asked.createInstance(pathOf(call, classPath), *given);
        return passStatus(call, answer.status) && !answer.paths.empty()
                   ? call.make<ObjectPathObject>(answer.paths.shared().front())
                   : nullptr;
    });
}

CMPIStatus modifyInstance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                          const CMPIInstance* instance, const char** properties)
{
    return perform("CMPIBrokerFT.modifyInstance", [&](Call& call) {
        Broker& asked = called(call, broker, context);
        const auto given = completed(call.use<InstanceObject>(instance, "the instance"));
        passStatus(call, asked.modifyInstance(pathOf(call, path), *given, listOf(properties)).status);
    });
}

CMPIStatus deleteInstance(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path)
{
    return perform("CMPIBrokerFT.deleteInstance", [&](Call& call) {
        Broker& asked = called(call, broker, context);
        passStatus(call, asked.deleteInstance(pathOf(call, path)).status);
    });
}

CMPIEnumeration* execQuery(const CMPIBroker* broker, const CMPIContext* context,
                           const CMPIObjectPath* classPath, const char* query, const char* language,
                           CMPIStatus* rc)
{
    return serve("CMPIBrokerFT.execQuery", rc, static_cast<CMPIEnumeration*>(nullptr), [&](Call& call) {
        Broker& asked = called(call, broker, context);
        cim::Answer answer = asked.execQuery(pathOf(call, classPath), call.text(query, "the query"),
                                             call.text(language, "the query language"));
        return enumerate(call, answer.status, answer.instances, CMPI_instance);
    });
}

CMPIEnumeration* enumerateInstances(const CMPIBroker* broker, const CMPIContext* context,
                                    const CMPIObjectPath* classPath, const char** properties, CMPIStatus* rc)
{
    return enumerateObjects("CMPIBrokerFT.enumerateInstances", broker, context, classPath, rc,
                            [&](Broker& asked, const cim::ObjectPath& path) {
                                return asked.enumerateInstances(path, listOf(properties));
                            });
}

CMPIEnumeration* associators(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                             const char* assocClass, const char* resultClass, const char* role,
                             const char* resultRole, const char** properties, CMPIStatus* rc)
{
    const Traversal traversal{given(assocClass), given(resultClass), given(role), given(resultRole)};
    return enumerateObjects("CMPIBrokerFT.associators", broker, context, path, rc,
                            [&](Broker& asked, const cim::ObjectPath& from) {
                                return asked.associators(from, traversal, listOf(properties));
                            });
}

CMPIEnumeration* associatorNames(const CMPIBroker* broker, const CMPIContext* context,
                                 const CMPIObjectPath* path, const char* assocClass, const char* resultClass,
                                 const char* role, const char* resultRole, CMPIStatus* rc)
{
    const Traversal traversal{given(assocClass), given(resultClass), given(role), given(resultRole)};
    return enumeratePaths(
        "CMPIBrokerFT.associatorNames", broker, context, path, rc,
        [&](Broker& asked, const cim::ObjectPath& from) { return asked.associatorNames(from, traversal); });
}

CMPIEnumeration* references(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                            const char* resultClass, const char* role, const char** properties,
                            CMPIStatus* rc)
{
    const Traversal traversal{{}, given(resultClass), given(role), {}};
    return enumerateObjects("CMPIBrokerFT.references", broker, context, path, rc,
                            [&](Broker& asked, const cim::ObjectPath& from) {
                                return asked.references(from, traversal, listOf(properties));
                            });
}

CMPIEnumeration* referenceNames(const CMPIBroker* broker, const CMPIContext* context,
                                const CMPIObjectPath* path, const char* resultClass, const char* role,
                                CMPIStatus* rc)
{
    const Traversal traversal{{}, given(resultClass), given(role), {}};
    return enumeratePaths(
        "CMPIBrokerFT.referenceNames", broker, context, path, rc,
        [&](Broker& asked, const cim::ObjectPath& from) { return asked.referenceNames(from, traversal); });
}

/// No registration names a provider of methods.
CMPIData invokeMethod(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                      const char* /*method*/, const CMPIArgs* /*in*/, CMPIArgs* /*out*/, CMPIStatus* rc)
{
    return serve("CMPIBrokerFT.invokeMethod", rc, noData(), [&](Call& call) {
        called(call, broker, context);
        pathOf(call, path);
        call.answerWith(CMPI_RC_ERR_NOT_SUPPORTED);
        return noData();
    });
}

CMPIStatus setProperty(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                       const char* /*name*/, const CMPIValue* /*value*/, CMPIType /*type*/)
{
    return perform("CMPIBrokerFT.setProperty", [&](Call& call) {
        called(call, broker, context);
        pathOf(call, path);
        Call::leave(CMPI_RC_ERR_NOT_SUPPORTED);
    });
}

/// Served by getting the instance.
CMPIData getProperty(const CMPIBroker* broker, const CMPIContext* context, const CMPIObjectPath* path,
                     const char* name, CMPIStatus* rc)
{
    return serve("CMPIBrokerFT.getProperty", rc, noData(CMPI_badValue), [&](Call& call) {
        Broker& asked = called(call, broker, context);
        const cim::PropertyList wanted{{call.text(name, "the name")}};
        const cim::Answer answer = asked.getInstance(pathOf(call, path), wanted);
        const cim::Instance* const instance = single(call, answer);
        return instance == nullptr ? noData()
                                   : getNamed(call, instance->properties, name, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    });
}

} // namespace

CMPIBrokerFT brokerServices()
{
    return {capabilities, servedVersion,      "cimhost",         prepareAttachThread,
            attachThread, detachThread,       deliverIndication, enumerateInstanceNames,
            getInstance,  createInstance,     modifyInstance,    deleteInstance,
            execQuery,    enumerateInstances, associators,       associatorNames,
            references,   referenceNames,     invokeMethod,      setProperty,
            getProperty};
}

} // namespace cimhost
