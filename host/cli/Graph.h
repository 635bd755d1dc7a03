/// \file
/// The instances of a namespace as a picture.
#ifndef CIMHOST_CLI_GRAPH_H
#define CIMHOST_CLI_GRAPH_H

#include "broker/Broker.h"
#include "cli/Command.h"

#include <iosfwd>
#include <string>

namespace cimhost::cli {

/// Writes a Graphviz graph of what the providers registered for the namespace have: an instance that
/// refers to two objects is an edge between them, any other a node, coloured by its HealthState. A
/// reference to an object that no provider has gives a dashed node. A class that answers an error
/// is told on `err` and in a comment of the graph.
/// \return exitError if no class at all answered, and then writes no graph
ExitStatus writeGraph(const std::string& nameSpace, Broker& broker, std::ostream& out, std::ostream& err);

} // namespace cimhost::cli

#endif
