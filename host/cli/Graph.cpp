#include "cli/Graph.h"

#include "cim/ObjectPathText.h"
#include "cim/Utf8.h"
#include "cim/Values.h"
#include "cli/Output.h"
#include "cli/ValueWords.h"

#include <algorithm>
#include <array>
#include <optional>
#include <ostream>
#include <string_view>
#include <utility>
#include <vector>

namespace cimhost::cli {

namespace {

/// A line that the reader of the graph should know of: an error, something left out.
using Remarks = std::vector<std::string>;

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

/// What the providers answered.
struct Picture
{
    std::vector<cim::Instance> nodes;
    std::vector<Edge> edges;
    Remarks remarks;
    bool anyAnswer = false;
};

// Asking the providers

std::vector<RegisteredClass> instanceClasses(const Registration& registration, const std::string& nameSpace)
{
    std::vector<RegisteredClass> classes;
    for (const RegisteredClass& entry : registration.classes) {
        const bool inNameSpace =
            std::any_of(entry.nameSpaces.begin(), entry.nameSpaces.end(),
                        [&](const std::string& name) { return cim::sameName(name, nameSpace); });
        const bool isNew = std::none_of(classes.begin(), classes.end(), [&](const RegisteredClass& other) {
            return cim::sameName(other.className, entry.className);
        });
        if (entry.instance && inNameSpace && isNew)
            classes.push_back(entry);
    }
    return classes;
}

template <typename Named>
std::vector<End> endsAmong(const std::vector<Named>& values)
{
    std::vector<End> ends;
    for (const Named& item : values) {
        if (item.value.type != CMPI_ref || item.value.isNull)
            continue;
        const auto& path = std::get<std::shared_ptr<const cim::ObjectPath>>(item.value.items.front());
        if (path)
            ends.push_back({item.name, *path});
    }
    return ends;
}

std::vector<End> endsOf(const cim::Instance& instance)
{
    std::vector<End> ends = endsAmong(instance.properties);
    return ends.empty() ? endsAmong(instance.path.keys) : ends;
}

void add(const cim::Instance& instance, const RegisteredClass& entry, Picture& picture)
{
    const std::vector<End> ends = endsOf(instance);
    if (ends.size() >= 2)
        picture.edges.push_back({instance.path.className, ends[0], ends[1]});
    else if (entry.association)
        picture.remarks.push_back(entry.className + ": an instance that does not refer to two objects");
    else
        picture.nodes.push_back(instance);
}

Picture askProviders(const std::string& nameSpace, Broker& broker)
{
    Picture picture;
    for (const RegisteredClass& entry : instanceClasses(broker.registration(), nameSpace)) {
        const cim::Answer answer = broker.enumerateInstances({"", nameSpace, entry.className, {}});
        if (answer.status.code != CMPI_RC_OK) {
            picture.remarks.push_back(entry.className + ": " + statusLine(answer.status));
            continue;
        }
        picture.anyAnswer = true;
        for (const cim::Instance& instance : answer.instances)
            add(instance, entry, picture);
    }
    return picture;
}

// Matching references and nodes

/// Whether the reference names the instance. Providers often give an instance a path without keys;
/// its properties then say which one it is.
bool names(const cim::ObjectPath& reference, const cim::Instance& instance)
{
    cim::ObjectPath path = instance.path;
    if (path.keys.empty())
        for (const cim::Key& key : reference.keys)
            if (const cim::Value* value = cim::findProperty(instance, key.name))
                path.keys.push_back({key.name, *value});
    return cim::sameObject(reference, path);
}

/// The nodes of the graph: the instances, then the objects that are only referred to.
class Nodes
{
public:
    explicit Nodes(const std::vector<cim::Instance>& instances) : instances_(instances) {}

    std::size_t indexOf(const cim::ObjectPath& reference)
    {
        const auto instance =
            std::find_if(instances_.begin(), instances_.end(),
                         [&](const cim::Instance& candidate) { return names(reference, candidate); });
        if (instance != instances_.end())
            return static_cast<std::size_t>(instance - instances_.begin());
        const auto missing =
            std::find_if(missing_.begin(), missing_.end(), [&](const cim::ObjectPath& candidate) {
                return cim::sameObject(reference, candidate);
            });
        const auto index = static_cast<std::size_t>(missing - missing_.begin());
        if (missing == missing_.end())
            missing_.push_back(reference);
        return instances_.size() + index;
    }

    [[nodiscard]] const std::vector<cim::Instance>& instances() const { return instances_; }
    [[nodiscard]] const std::vector<cim::ObjectPath>& missing() const { return missing_; }

private:
    const std::vector<cim::Instance>& instances_;
    std::vector<cim::ObjectPath> missing_;
};

// Writing DOT

/// A quoted text for a label. Graphviz has escapes and HTML's entities in labels.
std::string dotText(std::string_view text)
{
    std::string result;
    for (const char byte : cim::printable(text)) {
        if (byte == '"' || byte == '\\')
            result += '\\';
        result += byte;
        if (byte == '&')
            result += "amp;";
    }
    return result;
}

/// The lines of a label, centred.
std::string label(const std::vector<std::string>& lines)
{
    std::string text;
    for (const std::string& line : lines)
        text += (text.empty() ? "" : "\\n") + dotText(line);
    return '"' + text + '"';
}

std::optional<std::string> textOf(const cim::Instance& instance, std::string_view property)
{
    const cim::Value* value = cim::findProperty(instance, property);
    if (value == nullptr || value->isNull || value->type != CMPI_string)
        return std::nullopt;
    const auto& text = std::get<std::string>(value->items.front());
    return text.empty() ? std::nullopt : std::optional(text);
}

/// What a person calls the instance.
std::string nameOf(const cim::Instance& instance)
{
    for (const char* property : {"ElementName", "Name", "InstanceID"})
        if (const auto text = textOf(instance, property))
            return *text;
    return cim::toText(instance.path);
}

std::optional<std::uint64_t> healthOf(const cim::Instance& instance)
{
    const cim::Value* value = cim::findProperty(instance, "HealthState");
    if (value == nullptr || value->isNull || value->items.size() != 1)
        return std::nullopt;
    const auto* number = std::get_if<std::uint64_t>(&value->items.front());
    return number != nullptr ? std::optional(*number) : std::nullopt;
}

std::string_view colourOf(std::optional<std::uint64_t> health)
{
    if (!health)
        return "white";
    if (*health == 0)
        return "lightgrey";
    if (*health <= 5)
        return "palegreen";
    if (*health <= 10)
        return "khaki";
    return *health <= 20 ? "sandybrown" : "salmon";
}

bool endsWith(std::string_view text, std::string_view ending)
{
    return text.size() >= ending.size() && cim::sameName(text.substr(text.size() - ending.size()), ending);
}

/// By what the class's name says of its kind, as the schemas name classes.
std::string_view shapeOf(const std::string& className)
{
    if (endsWith(className, "System"))
        return "box3d";
    if (endsWith(className, "Capabilities"))
        return "note";
    return "box";
}

std::string nodeLine(std::size_t index, const std::vector<std::string>& lines, const std::string& attributes)
{
    return "    n" + std::to_string(index) + " [label=" + label(lines) + ", " + attributes + "];\n";
}

std::string nodeLine(std::size_t index, const cim::Instance& instance)
{
    const std::optional<std::uint64_t> health = healthOf(instance);
    const auto word = health ? valueWord("HealthState", *health) : std::nullopt;
    std::vector<std::string> lines{nameOf(instance), instance.path.className};
    if (word)
        lines.emplace_back(*word);
    return nodeLine(index, lines,
                    "shape=" + std::string(shapeOf(instance.path.className)) +
                        ", fillcolor=" + std::string(colourOf(health)));
}

std::string edgeLine(const Edge& edge, Nodes& nodes)
{
    return "    n" + std::to_string(nodes.indexOf(edge.from.path)) + " -> n" +
           std::to_string(nodes.indexOf(edge.to.path)) +
           " [label=" + label({edge.className, edge.from.role + " \u2192 " + edge.to.role}) + "];\n";
}

void writeDot(const std::string& nameSpace, const Picture& picture, std::ostream& out)
{
    Nodes nodes(picture.nodes);
    std::string edges;
    for (const Edge& edge : picture.edges)
        edges += edgeLine(edge, nodes);

    out << "digraph " << label({nameSpace}) << " {\n"
        << "    rankdir=LR;\n"
        << "    node [fontname=\"sans-serif\", style=filled];\n"
        << "    edge [fontname=\"sans-serif\", fontsize=9];\n";
    for (const std::string& remark : picture.remarks)
        out << "    // " << cim::printable(remark) << '\n';
    std::size_t index = 0;
    for (const cim::Instance& instance : nodes.instances())
        out << nodeLine(index++, instance);
    for (const cim::ObjectPath& path : nodes.missing())
        out << nodeLine(index++, {cim::toText(path)}, "shape=box, style=dashed");
    out << edges << "}\n";
}

} // namespace

ExitStatus writeGraph(const std::string& nameSpace, Broker& broker, std::ostream& out, std::ostream& err)
{
    const Picture picture = askProviders(nameSpace, broker);
    for (const std::string& remark : picture.remarks)
        err << "cimhost: " << cim::printable(remark) << '\n';
    if (!picture.anyAnswer) {
        err << "cimhost: no class of the namespace " << cim::printable(nameSpace) << " answered\n";
        return exitError;
    }
    writeDot(nameSpace, picture, out);
    return exitAnswered;
}

} // namespace cimhost::cli
