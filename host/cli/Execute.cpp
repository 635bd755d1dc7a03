#include "cli/Execute.h"

#include "cim/Nearest.h"
#include "cim/ObjectPathText.h"
#include "cim/Utf8.h"
#include "cim/Values.h"
#include "cli/ClassList.h"
#include "cli/Graph.h"
#include "cli/Output.h"
#include "cli/Serve.h"
#include "cli/Watch.h"

#include <algorithm>
#include <iterator>
#include <ostream>
#include <string>
#include <vector>

namespace cimhost::cli {

namespace {

/// A line of this program's own, behind a provider's error that a person may not understand.
std::string adviceAfter(const cim::Status& status, const OperationRequest& request,
                        const Registration& registration)
{
    if (status.code == CMPI_RC_ERR_INVALID_CLASS || status.code == CMPI_RC_ERR_INVALID_NAMESPACE)
        return "Try: cimhost classes";
    const Traversal& traversal = request.traversal;
    if (!isTraversal(request.operation) || traversal.assocClass ||
        (isReferenceTraversal(request.operation) && traversal.resultClass))
        return "";
    std::string options;
    for (const RegisteredClass& entry : registration.classes)
        if (entry.association && isRegisteredIn(entry, request.target.nameSpace))
            options += (options.empty() ? "-ac " : ", or -ac ") + cim::printable(entry.className);
    return options.empty() ? "" : "Every association was asked. For one of them add " + options;
}

/// What the status says, with the object that was not found where it does not say that itself.
cim::Status explained(cim::Status status, const OperationRequest& request)
{
    if (status.code == CMPI_RC_ERR_NOT_FOUND && !status.message)
        status.message = "there is no " + cim::toText(request.target);
    return status;
}

bool hasProperty(const cim::Instance& instance, const std::string& name)
{
    return cim::findProperty(instance, name) != nullptr || cim::findKey(instance.path, name) != nullptr;
}

/// Of the properties wanted, those that no instance has.
std::vector<std::string> missingProperties(const OperationRequest& request, const cim::Answer& answer)
{
    std::vector<std::string> missing;
    if (request.properties && !answer.instances.empty())
        std::copy_if(request.properties->begin(), request.properties->end(), std::back_inserter(missing),
                     [&](const std::string& name) {
                         return std::none_of(
                             answer.instances.begin(), answer.instances.end(),
                             [&](const cim::Instance& instance) { return hasProperty(instance, name); });
                     });
    return missing;
}

std::vector<std::string> propertyNames(const cim::Instances& instances)
{
    std::vector<std::string> names;
    for (const cim::Instance& instance : instances)
        for (const cim::Property& property : instance.properties)
            names.push_back(property.name);
    return names;
}

/// One function for each kind of command.
struct Execution
{
    Broker& broker;
    std::optional<std::size_t> columns;
    std::ostream& out;
    std::ostream& err;

    ExitStatus operator()(const Ask& ask) const
    {
        const Format format = formatOf(ask, columns.has_value());
        const cim::Answer answer = perform(ask.request, broker);
        if (answer.status.code == CMPI_RC_OK) {
            warnOfMissingProperties(ask.request, answer);
            out << answerText(answer, ask.request, format, ask.isWide ? anyWidth : width());
            return exitAnswered;
        }
        err << "cimhost: " << statusLine(explained(answer.status, ask.request)) << '\n';
        const std::string advice = adviceAfter(answer.status, ask.request, broker.registration());
        if (!advice.empty())
            err << advice << '\n';
        out << errorText(answer.status, format);
        return exitError;
    }

    /// Which names there are says the same question for all of them.
    void warnOfMissingProperties(const OperationRequest& request, const cim::Answer& answer) const
    {
        const std::vector<std::string> missing = missingProperties(request, answer);
        if (missing.empty())
            return;
        OperationRequest whole = request;
        whole.properties.reset();
        const std::vector<std::string> names = propertyNames(perform(whole, broker).instances);
        for (const std::string& name : missing)
            err << "cimhost: no instance has the property " << cim::excerpt(name)
                << cim::didYouMean(name, names) << '\n';
    }

    [[nodiscard]] std::size_t width() const { return columns.value_or(anyWidth); }

    ExitStatus operator()(const ListClasses& /*list*/) const
    {
        out << classTable(broker.registration(), width());
        return exitAnswered;
    }

    ExitStatus operator()(const DrawGraph& graph) const
    {
        return writeGraph(graph.nameSpace, broker, out, err);
    }

    ExitStatus operator()(const Serve& command) const { return serveUntilSignal(command, broker, err); }

    ExitStatus operator()(const Watch& command) const
    {
        return watchUntilSignal(command, broker, columns.has_value(), err);
    }
};

} // namespace

ExitStatus execute(const Command& command, Broker& broker, std::optional<std::size_t> columns,
                   std::ostream& out, std::ostream& err)
{
    return std::visit(Execution{broker, columns, out, err}, command);
}

} // namespace cimhost::cli
