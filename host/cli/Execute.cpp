#include "cli/Execute.h"

#include "cli/Graph.h"
#include "cli/Output.h"
#include "cli/Serve.h"
#include "cli/Watch.h"

#include <ostream>

namespace cimhost::cli {

namespace {

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
            out << answerText(answer, ask.request, format,
                              ask.isWide ? anyWidth : columns.value_or(anyWidth));
            return exitAnswered;
        }
        err << "cimhost: " << statusLine(answer.status) << '\n';
        out << errorText(answer.status, format);
        return exitError;
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
