#include "broker/Broker.h"

#include "broker/BrokerImplementation.h"
#include "broker/Names.h"
#include "broker/ProviderCall.h"
#include "broker/Scope.h"

#include <iterator>
#include <utility>

namespace cimhost {

namespace {

/// How many requests may be nested in each other by up-calls: enough for any provider, and few enough
/// to end one that asks itself before the stack does.
constexpr int deepestNesting = 64;

cim::Answer errorAnswer(CMPIrc code, std::string message)
{
    return {{code, std::move(message)}, {}, {}};
}

/// Asks a provider in a request of its own.
/// \param operation  called with the request; calls into the provider
template <class Operation>
cim::Answer ask(Core& core, const char* name, const Operation& operation)
{
    Request request(core.broker);
    const CMPIStatus status = callProvider(
        core, name, [&] { return operation(request); },
        [&](const std::string& message) {
            return CMPIStatus{CMPI_RC_ERR_FAILED, make<StringObject>(core, message)};
        });
    return request.answer(status);
}

/// Answers a request; what keeps it from its provider becomes an error status.
template <class Body>
cim::Answer answer(Core& core, const Body& body)
{
    const Scope* const scope = Scope::innermost(core);
    if (scope != nullptr && scope->depth() >= deepestNesting) {
        core.tellMisuse("up-calls are nested too deep");
        return errorAnswer(CMPI_RC_ERR_FAILED, "up-calls are nested too deep");
    }
    try {
        return body();
    } catch (const RoutingError& error) {
        return errorAnswer(error.code(), error.what());
    } catch (const ProviderError& error) {
        return errorAnswer(CMPI_RC_ERR_FAILED, error.what());
    }
}

/// Asks the instance provider of a path's class.
/// \param operation  called with the management interface, the request and the path
template <class Operation>
cim::Answer askInstanceProvider(Core& core, Router& router, const char* name, const cim::ObjectPath& path,
                                const Operation& operation)
{
    return answer(core, [&] {
        CMPIInstanceMI& mi =
            router.instanceProvider(path.className, path.nameSpace).instanceMI(path.nameSpace);
        return ask(core, name, [&](Request& request) { return operation(mi, request, request.path(path)); });
    });
}

void append(cim::Answer& all, cim::Answer more)
{
    if (all.status.code == CMPI_RC_OK)
        all.status = std::move(more.status);
    all.paths.insert(all.paths.end(), std::make_move_iterator(more.paths.begin()),
                     std::make_move_iterator(more.paths.end()));
    all.instances.insert(all.instances.end(), std::make_move_iterator(more.instances.begin()),
                         std::make_move_iterator(more.instances.end()));
}

/// Asks the provider of an association class, or all association providers when there is none.
/// \param operation  called with the management interface, the request and the path
template <class Operation>
cim::Answer askAssociationProviders(Core& core, Router& router, const char* name, const cim::ObjectPath& path,
                                    const std::optional<std::string>& associationClass,
                                    const Operation& operation)
{
    const auto askOne = [&](Provider& provider) {
        return answer(core, [&] {
            CMPIAssociationMI& mi = provider.associationMI(path.nameSpace);
            return ask(core, name,
                       [&](Request& request) { return operation(mi, request, request.path(path)); });
        });
    };
    return answer(core, [&] {
        if (associationClass)
            return askOne(router.associationProvider(*associationClass, path.nameSpace));
        cim::Answer all;
        for (Provider* const provider : router.associationProviders(path.nameSpace))
            append(all, askOne(*provider));
        return all;
    });
}

const char* textOf(const std::optional<std::string>& text)
{
    return text ? text->c_str() : nullptr;
}

} // namespace

Broker::Broker(Registration registration, std::vector<std::string> providerDirectories, Listeners listeners)
    : implementation_(std::make_unique<Implementation>(*this, std::move(registration),
                                                       std::move(providerDirectories), std::move(listeners)))
{}

Broker::~Broker()
{
    implementation_->router.cleanUp();
}

cim::Answer Broker::enumerateInstanceNames(const cim::ObjectPath& classPath)
{
    return askInstanceProvider(
        implementation_->core, implementation_->router, "enumerateInstanceNames", classPath,
        [](CMPIInstanceMI& mi, Request& request, const CMPIObjectPath* path) {
            return mi.ft->enumerateInstanceNames(&mi, request.context(), request.result(), path);
        });
}

cim::Answer Broker::enumerateInstances(const cim::ObjectPath& classPath, const cim::PropertyList& properties)
{
    return askInstanceProvider(implementation_->core, implementation_->router, "enumerateInstances",
                               classPath,
                               [&](CMPIInstanceMI& mi, Request& request, const CMPIObjectPath* path) {
                                   return mi.ft->enumerateInstances(&mi, request.context(), request.result(),
                                                                    path, NameArray(properties).get());
                               });
}

cim::Answer Broker::getInstance(const cim::ObjectPath& path, const cim::PropertyList& properties)
{
    return askInstanceProvider(implementation_->core, implementation_->router, "getInstance", path,
                               [&](CMPIInstanceMI& mi, Request& request, const CMPIObjectPath* instPath) {
                                   return mi.ft->getInstance(&mi, request.context(), request.result(),
                                                             instPath, NameArray(properties).get());
                               });
}

cim::Answer Broker::createInstance(const cim::ObjectPath& classPath, const cim::Instance& instance)
{
    return askInstanceProvider(implementation_->core, implementation_->router, "createInstance", classPath,
                               [&](CMPIInstanceMI& mi, Request& request, const CMPIObjectPath* path) {
                                   return mi.ft->createInstance(&mi, request.context(), request.result(),
                                                                path, request.instance(instance));
                               });
}

cim::Answer Broker::modifyInstance(const cim::ObjectPath& path, const cim::Instance& instance,
                                   const cim::PropertyList& properties)
{
    return askInstanceProvider(implementation_->core, implementation_->router, "modifyInstance", path,
                               [&](CMPIInstanceMI& mi, Request& request, const CMPIObjectPath* instPath) {
                                   return mi.ft->modifyInstance(&mi, request.context(), request.result(),
                                                                instPath, request.instance(instance),
                                                                NameArray(properties).get());
                               });
}

cim::Answer Broker::deleteInstance(const cim::ObjectPath& path)
{
    return askInstanceProvider(implementation_->core, implementation_->router, "deleteInstance", path,
                               [](CMPIInstanceMI& mi, Request& request, const CMPIObjectPath* instPath) {
                                   return mi.ft->deleteInstance(&mi, request.context(), request.result(),
                                                                instPath);
                               });
}

cim::Answer Broker::execQuery(const cim::ObjectPath& classPath, const std::string& query,
                              const std::string& language)
{
    return askInstanceProvider(implementation_->core, implementation_->router, "execQuery", classPath,
                               [&](CMPIInstanceMI& mi, Request& request, const CMPIObjectPath* path) {
                                   return mi.ft->execQuery(&mi, request.context(), request.result(), path,
                                                           query.c_str(), language.c_str());
                               });
}

cim::Answer Broker::associators(const cim::ObjectPath& path, const Traversal& traversal,
                                const cim::PropertyList& properties)
{
    return askAssociationProviders(
        implementation_->core, implementation_->router, "associators", path, traversal.assocClass,
        [&](CMPIAssociationMI& mi, Request& request, const CMPIObjectPath* from) {
            return mi.ft->associators(&mi, request.context(), request.result(), from,
                                      textOf(traversal.assocClass), textOf(traversal.resultClass),
                                      textOf(traversal.role), textOf(traversal.resultRole),
                                      NameArray(properties).get());
        });
}

cim::Answer Broker::associatorNames(const cim::ObjectPath& path, const Traversal& traversal)
{
    return askAssociationProviders(
        implementation_->core, implementation_->router, "associatorNames", path, traversal.assocClass,
        [&](CMPIAssociationMI& mi, Request& request, const CMPIObjectPath* from) {
            return mi.ft->associatorNames(&mi, request.context(), request.result(), from,
                                          textOf(traversal.assocClass), textOf(traversal.resultClass),
                                          textOf(traversal.role), textOf(traversal.resultRole));
        });
}

cim::Answer Broker::references(const cim::ObjectPath& path, const Traversal& traversal,
                               const cim::PropertyList& properties)
{
    return askAssociationProviders(
        implementation_->core, implementation_->router, "references", path, traversal.resultClass,
        [&](CMPIAssociationMI& mi, Request& request, const CMPIObjectPath* from) {
            return mi.ft->references(&mi, request.context(), request.result(), from,
                                     textOf(traversal.resultClass), textOf(traversal.role),
                                     NameArray(properties).get());
        });
}

cim::Answer Broker::referenceNames(const cim::ObjectPath& path, const Traversal& traversal)
{
    return askAssociationProviders(
        implementation_->core, implementation_->router, "referenceNames", path, traversal.resultClass,
        [&](CMPIAssociationMI& mi, Request& request, const CMPIObjectPath* from) {
            return mi.ft->referenceNames(&mi, request.context(), request.result(), from,
                                         textOf(traversal.resultClass), textOf(traversal.role));
        });
}

const Registration& Broker::registration() const
{
    return implementation_->router.registration();
}

const CMPIBroker* Broker::cmpiBroker() const
{
    return &implementation_->core.cmpi;
}

FunctionTables& Broker::tables()
{
    return implementation_->core.tables;
}

} // namespace cimhost
