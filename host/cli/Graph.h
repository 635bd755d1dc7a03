/// \file
/// The instances of a namespace as a picture.
#ifndef CIMHOST_CLI_GRAPH_H
#define CIMHOST_CLI_GRAPH_H

#include "broker/Broker.h"
#include "cim/Model.h"
#include "cli/Command.h"

#include <iosfwd>
#include <string>
#include <vector>

namespace cimhost::cli {

/// What a graph shows.
struct Picture
{
    struct End
    {
        std::string role;
        cim::ObjectPath path;
    };

    struct Edge
    {
        std::string className;
        End from;
        End to;
    };

    cim::Instances nodes;
    std::vector<Edge> edges;
    std::vector<std::string> remarks; ///< what could not be shown, and why
};

/// Takes an instance in: as an edge if it refers to two objects, in its properties or in the keys of its
/// path; else as a node, or with a remark if its class is an association.
void addInstance(const cim::Instance& instance, bool isAssociation, Picture& picture);

/// The picture in Graphviz's language: nodes coloured by their HealthState, edges by their class
/// and roles, which a legend names once. A reference to an object that is no node gives a dashed node.
std::string dot(const std::string& nameSpace, const Picture& picture);

/// Writes the graph of what the providers registered for the namespace have. A class that answers an
/// error is told on `err` and in a comment of the graph.
/// \return exitError if no class at all answered, and then writes no graph
ExitStatus writeGraph(const std::string& nameSpace, Broker& broker, std::ostream& out, std::ostream& err);

} // namespace cimhost::cli

#endif
