#include "cli/Execute.h"

#include "cli/Graph.h"
#include "cli/Output.h"

#include <ostream>

namespace cimhost::cli {

namespace {

cim::Answer getInstance(const Command& command, Broker& broker)
{
    cim::Answer answer = broker.getInstance(command.target, command.properties);
    if (answer.status.code == CMPI_RC_OK && answer.instances.empty())
        answer.status.code = CMPI_RC_ERR_NOT_FOUND;
    return answer;
}

cim::Answer ask(const Command& command, Broker& broker)
{
    switch (command.operation) {
    case Operation::enumerateInstanceNames:
        return broker.enumerateInstanceNames(command.target);
    case Operation::enumerateInstances:
        return broker.enumerateInstances(command.target, command.properties);
    case Operation::getInstance:
        return getInstance(command, broker);
    case Operation::associators:
        return broker.associators(command.target, command.traversal, command.properties);
    case Operation::associatorNames:
        return broker.associatorNames(command.target, command.traversal);
    case Operation::references:
        return broker.references(command.target, command.traversal, command.properties);
    case Operation::referenceNames:
        return broker.referenceNames(command.target, command.traversal);
    case Operation::graph:
        break; // many questions, not one
    }
    return {};
}

} // namespace

ExitStatus execute(const Command& command, Broker& broker, bool isTerminal, std::ostream& out,
                   std::ostream& err)
{
    if (command.operation == Operation::graph)
        return writeGraph(command.target.nameSpace, broker, out, err);

    const Format format = formatOf(command, isTerminal);
    const cim::Answer answer = ask(command, broker);
    if (answer.status.code == CMPI_RC_OK) {
        out << answerText(answer, command, format);
        return exitAnswered;
    }
    err << "cimhost: " << statusLine(answer.status) << '\n';
    out << errorText(answer.status, format);
    return exitError;
}

} // namespace cimhost::cli
