#include "broker/Broker.h"

#include "broker/BrokerImplementation.h"
#include "broker/Habits.h"
#include "broker/Names.h"
#include "broker/ProviderCall.h"
#include "broker/Scope.h"
#include "cim/Values.h"

#include <algorithm>
#include <iterator>
#include <tuple>
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

/// Asks one provider in the way of the broker whose habits this one has.
/// \param served     the class that the provider is asked as the one of
/// \param operation  called with the request, the question as that broker would ask it and its path
template <class Operation>
cim::Answer askHabitually(Core& core, const char* name, OperationRequest question,
                          const RegisteredClass& served, const Operation& operation)
{
    shape(core.habits, question, served);
    cim::Answer answer = ask(core, name, [&](Request& request) {
        return operation(request, std::as_const(question), request.path(question.target));
    });
    shape(core.habits, answer, question);
    return answer;
}

void append(cim::Answer& all, cim::Answer more)
{
    if (all.status.code == CMPI_RC_OK)
        all.status = std::move(more.status);
    all.paths.append(more.paths);
    all.instances.append(more.instances);
}

/// The question as one for a class that derives from the one asked for.
OperationRequest asOneFor(const RegisteredClass& served, OperationRequest question)
{
    if (!cim::sameName(question.target.className, served.className))
        question.target.className = served.className;
    return question;
}

/// Asks the instance providers of the class in question and, when it is enumerated, of those that derive from
/// it.
/// \param operation  called with the management interface, the request, the question and its path
template <class Operation>
cim::Answer askInstanceProviders(Core& core, Router& router, const char* name,
                                 const OperationRequest& question, const Operation& operation)
{
    const std::string& nameSpace = question.target.nameSpace;
    const std::string& className = question.target.className;
    const auto askOne = [&](const RegisteredClass& served) {
        return answer(core, [&] {
            CMPIInstanceMI& mi = router.providerOf(served).instanceMI(nameSpace);
            return askHabitually(core, name, asOneFor(served, question), served,
                                 [&](Request& request, const OperationRequest& asked, CMPIObjectPath* path) {
                                     return operation(mi, request, asked, path);
                                 });
        });
    };
    return answer(core, [&] {
        if (!isEnumeration(question.operation))
            return askOne(router.instanceClass(className, nameSpace));
        cim::Answer all;
        for (const RegisteredClass* const served : router.instanceClasses(className, nameSpace))
            append(all, askOne(*served));
        return all;
    });
}

/// A traversal's association class.
std::optional<std::string>& associationClassOf(OperationRequest& question)
{
    return isReferenceTraversal(question.operation) ? question.traversal.resultClass
                                                    : question.traversal.assocClass;
}

/// The traversal as the provider of that association is asked it.
OperationRequest asTraversalOf(const Core& core, const RegisteredClass& served, OperationRequest question)
{
    std::optional<std::string>& asked = associationClassOf(question);
    if (core.habits == nullptr && asked && !cim::sameName(*asked, served.className))
        asked = served.className;
    return question;
}

/// Which classes to ask the providers of: those that an association class stands for, or all. A provider of
/// several is not asked the same twice.
std::vector<const RegisteredClass*> associationsToAsk(const Core& core, Router& router,
                                                      OperationRequest question)
{
    const std::optional<std::string> given = associationClassOf(question);
    const std::string& nameSpace = question.target.nameSpace;
    std::vector<const RegisteredClass*> classes;
    std::vector<std::pair<const Provider*, Traversal>> asked;
    for (const RegisteredClass* const served :
         given ? router.associationClasses(*given, nameSpace) : router.associationClasses(nameSpace)) {
        OperationRequest asOfThisClass = asTraversalOf(core, *served, question);
        shape(core.habits, asOfThisClass, *served);
        std::pair<const Provider*, Traversal> asking{&router.providerOf(*served), asOfThisClass.traversal};
        if (std::find(asked.begin(), asked.end(), asking) != asked.end())
            continue;
        asked.push_back(std::move(asking));
        classes.push_back(served);
    }
    return classes;
}

/// A class that only classes deriving from it are served of, when it is asked for as the result; the question
/// is then for results of any class.
std::optional<std::string> takeResultSuperclass(const Core& core, const Router& router,
                                                OperationRequest& question)
{
    std::optional<std::string>& wanted = question.traversal.resultClass;
    if (core.habits != nullptr || isReferenceTraversal(question.operation) || !wanted ||
        router.isRegistered(*wanted, question.target.nameSpace) || core.classes.find(*wanted) == nullptr)
        return std::nullopt;
    return std::exchange(wanted, std::nullopt);
}

void keepThoseOf(const std::string& superclass, const schema::Classes& classes, cim::Answer& answer)
{
    const auto isOther = [&](const std::string& name) {
        return classes.find(name) != nullptr && !classes.isA(name, superclass);
    };
    answer.paths.removeIf([&](const cim::ObjectPath& path) { return isOther(path.className); });
    answer.instances.removeIf(
        [&](const cim::Instance& instance) { return isOther(instance.path.className); });
}

/// Asks the providers of an association class, or all association providers when there is none.
/// \param operation  called with the management interface, the request, the question and its path
template <class Operation>
cim::Answer askAssociationProviders(Core& core, Router& router, const char* name, OperationRequest question,
                                    const Operation& operation)
{
    const std::optional<std::string> superclass = takeResultSuperclass(core, router, question);
    const auto askOne = [&](const RegisteredClass& served) {
        return answer(core, [&] {
            CMPIAssociationMI& mi = router.providerOf(served).associationMI(question.target.nameSpace);
            return askHabitually(core, name, asTraversalOf(core, served, question), served,
                                 [&](Request& request, const OperationRequest& asked, CMPIObjectPath* path) {
                                     return operation(mi, request, asked, path);
                                 });
        });
    };
    cim::Answer found = answer(core, [&] {
        cim::Answer all;
        for (const RegisteredClass* const served : associationsToAsk(core, router, question))
            append(all, askOne(*served));
        return all;
    });
    if (superclass)
        keepThoseOf(*superclass, core.classes, found);
    return found;
}

const char* textOf(const std::optional<std::string>& text)
{
    return text ? text->c_str() : nullptr;
}

} // namespace

bool operator==(const Traversal& a, const Traversal& b)
{
    return std::tie(a.assocClass, a.resultClass, a.role, a.resultRole) ==
           std::tie(b.assocClass, b.resultClass, b.role, b.resultRole);
}

Broker::Broker(Registration registration, std::vector<std::string> providerDirectories, Listeners listeners,
               const Habits* habits, schema::Classes classes)
    : implementation_(std::make_unique<Implementation>(*this, std::move(registration),
                                                       std::move(providerDirectories), std::move(listeners),
                                                       habits, std::move(classes)))
{}

Broker::~Broker()
{
    implementation_->router.cleanUp();
}

cim::Answer Broker::enumerateInstanceNames(const cim::ObjectPath& classPath)
{
    return askInstanceProviders(implementation_->core, implementation_->router, "enumerateInstanceNames",
                                {Operation::enumerateInstanceNames, classPath},
                                [](CMPIInstanceMI& mi, Request& request, const OperationRequest& /*asked*/,
                                   const CMPIObjectPath* path) {
                                    return mi.ft->enumerateInstanceNames(&mi, request.context(),
                                                                         request.result(), path);
                                });
}

cim::Answer Broker::enumerateInstances(const cim::ObjectPath& classPath, const cim::PropertyList& properties)
{
    return askInstanceProviders(
        implementation_->core, implementation_->router, "enumerateInstances",
        {Operation::enumerateInstances, classPath, {}, properties},
        [](CMPIInstanceMI& mi, Request& request, const OperationRequest& asked, const CMPIObjectPath* path) {
            return mi.ft->enumerateInstances(&mi, request.context(), request.result(), path,
                                             NameArray(asked.properties).get());
        });
}

cim::Answer Broker::getInstance(const cim::ObjectPath& path, const cim::PropertyList& properties)
{
    cim::Answer answer =
        askInstanceProviders(implementation_->core, implementation_->router, "getInstance",
                             {Operation::getInstance, path, {}, properties},
                             [](CMPIInstanceMI& mi, Request& request, const OperationRequest& asked,
                                const CMPIObjectPath* instPath) {
                                 return mi.ft->getInstance(&mi, request.context(), request.result(), instPath,
                                                           NameArray(asked.properties).get());
                             });
    if (answer.status.code == CMPI_RC_OK && answer.instances.empty())
        answer.status.code = CMPI_RC_ERR_NOT_FOUND;
    return answer;
}

cim::Answer Broker::createInstance(const cim::ObjectPath& classPath, const cim::Instance& instance)
{
    return askInstanceProviders(implementation_->core, implementation_->router, "createInstance",
                                {Operation::createInstance, classPath},
                                [&](CMPIInstanceMI& mi, Request& request, const OperationRequest& /*asked*/,
                                    const CMPIObjectPath* path) {
                                    return mi.ft->createInstance(&mi, request.context(), request.result(),
                                                                 path, request.instance(instance));
                                });
}

cim::Answer Broker::modifyInstance(const cim::ObjectPath& path, const cim::Instance& instance,
                                   const cim::PropertyList& properties)
{
    return askInstanceProviders(implementation_->core, implementation_->router, "modifyInstance",
                                {Operation::modifyInstance, path, {}, properties},
                                [&](CMPIInstanceMI& mi, Request& request, const OperationRequest& asked,
                                    const CMPIObjectPath* instPath) {
                                    return mi.ft->modifyInstance(&mi, request.context(), request.result(),
                                                                 instPath, request.instance(instance),
                                                                 NameArray(asked.properties).get());
                                });
}

cim::Answer Broker::deleteInstance(const cim::ObjectPath& path)
{
    return askInstanceProviders(
        implementation_->core, implementation_->router, "deleteInstance", {Operation::deleteInstance, path},
        [](CMPIInstanceMI& mi, Request& request, const OperationRequest& /*asked*/,
           const CMPIObjectPath* instPath) {
            return mi.ft->deleteInstance(&mi, request.context(), request.result(), instPath);
        });
}

cim::Answer Broker::execQuery(const cim::ObjectPath& classPath, const std::string& query,
                              const std::string& language)
{
    return askInstanceProviders(implementation_->core, implementation_->router, "execQuery",
                                {Operation::execQuery, classPath},
                                [&](CMPIInstanceMI& mi, Request& request, const OperationRequest& /*asked*/,
                                    const CMPIObjectPath* path) {
                                    return mi.ft->execQuery(&mi, request.context(), request.result(), path,
                                                            query.c_str(), language.c_str());
                                });
}

cim::Answer Broker::associators(const cim::ObjectPath& path, const Traversal& traversal,
                                const cim::PropertyList& properties)
{
    return askAssociationProviders(implementation_->core, implementation_->router, "associators",
                                   {Operation::associators, path, traversal, properties},
                                   [](CMPIAssociationMI& mi, Request& request, const OperationRequest& asked,
                                      const CMPIObjectPath* from) {
                                       const Traversal& by = asked.traversal;
                                       return mi.ft->associators(
                                           &mi, request.context(), request.result(), from,
                                           textOf(by.assocClass), textOf(by.resultClass), textOf(by.role),
                                           textOf(by.resultRole), NameArray(asked.properties).get());
                                   });
}

cim::Answer Broker::associatorNames(const cim::ObjectPath& path, const Traversal& traversal)
{
    return askAssociationProviders(implementation_->core, implementation_->router, "associatorNames",
                                   {Operation::associatorNames, path, traversal},
                                   [](CMPIAssociationMI& mi, Request& request, const OperationRequest& asked,
                                      const CMPIObjectPath* from) {
                                       const Traversal& by = asked.traversal;
                                       return mi.ft->associatorNames(&mi, request.context(), request.result(),
                                                                     from, textOf(by.assocClass),
                                                                     textOf(by.resultClass), textOf(by.role),
                                                                     textOf(by.resultRole));
                                   });
}

cim::Answer Broker::references(const cim::ObjectPath& path, const Traversal& traversal,
                               const cim::PropertyList& properties)
{
    return askAssociationProviders(implementation_->core, implementation_->router, "references",
                                   {Operation::references, path, traversal, properties},
                                   [](CMPIAssociationMI& mi, Request& request, const OperationRequest& asked,
                                      const CMPIObjectPath* from) {
                                       const Traversal& by = asked.traversal;
                                       return mi.ft->references(&mi, request.context(), request.result(),
                                                                from, textOf(by.resultClass), textOf(by.role),
                                                                NameArray(asked.properties).get());
                                   });
}

cim::Answer Broker::referenceNames(const cim::ObjectPath& path, const Traversal& traversal)
{
    return askAssociationProviders(implementation_->core, implementation_->router, "referenceNames",
                                   {Operation::referenceNames, path, traversal},
                                   [](CMPIAssociationMI& mi, Request& request, const OperationRequest& asked,
                                      const CMPIObjectPath* from) {
                                       const Traversal& by = asked.traversal;
                                       return mi.ft->referenceNames(&mi, request.context(), request.result(),
                                                                    from, textOf(by.resultClass),
                                                                    textOf(by.role));
                                   });
}

const Registration& Broker::registration() const
{
    return implementation_->router.registration();
}

const schema::Classes& Broker::classes() const
{
    return implementation_->core.classes;
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
