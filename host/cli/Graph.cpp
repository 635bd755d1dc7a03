#include "cli/Graph.h"

#include "cim/ObjectPathText.h"
#include "cim/Utf8.h"
#include "cim/Values.h"
#include "cli/Output.h"
#include "cli/ValueWords.h"

#include <algorithm>
#include <array>
#include <map>
#include <optional>
#include <ostream>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace cimhost::cli {

namespace {

using End = Picture::End;
using Edge = Picture::Edge;

// Asking the providers

std::vector<RegisteredClass> instanceClasses(const Registration& registration, const std::string& nameSpace)
{
    std::vector<RegisteredClass> classes;
    for (const RegisteredClass& entry : registration.classes) {
        const bool isNew = std::none_of(classes.begin(), classes.end(), [&](const RegisteredClass& other) {
            return cim::sameName(other.className, entry.className);
        });
        if (entry.instance && isRegisteredIn(entry, nameSpace) && isNew)
            classes.push_back(entry);
    }
    return classes;
}

/// The one item of a scalar that holds such an item; null: it does not.
template <typename Item>
const Item* soleItem(const cim::Value& value)
{
    return value.items.size() == 1 && !cim::isArray(value) ? std::get_if<Item>(&value.items.front())
                                                           : nullptr;
}

template <typename Named>
std::vector<End> endsAmong(const std::vector<Named>& values)
{
    std::vector<End> ends;
    for (const Named& item : values) {
        const auto* path = soleItem<std::shared_ptr<const cim::ObjectPath>>(item.value);
        if (path != nullptr && *path)
            ends.push_back({item.name, **path});
    }
    return ends;
}

std::vector<End> endsOf(const cim::Instance& instance)
{
    std::vector<End> ends = endsAmong(instance.properties);
    return ends.empty() ? endsAmong(instance.path.keys) : ends;
}

// Matching references and nodes

/// Whether the reference names the instance, whose path has no keys, as providers often give it: its
/// properties then say which one it is.
bool namesByProperties(const cim::ObjectPath& reference, const cim::Instance& instance)
{
    if (!cim::sameName(reference.className, instance.path.className))
        return false;
    cim::ObjectPath path = instance.path;
    for (const cim::Key& key : reference.keys)
        if (const cim::Value* value = cim::findProperty(instance, key.name))
            path.keys.push_back({key.name, *value});
    return cim::sameObject(reference, path);
}

/// The nodes of the graph: the instances, then the objects that are only referred to.
class Nodes
{
public:
    explicit Nodes(const cim::Instances& instances) : instances_(instances)
    {
        for (std::size_t index = 0; index < instances.size(); ++index)
            if (instances[index].path.keys.empty())
                withoutKeys_.push_back(index);
            else
                byText_[cim::lookupText(instances[index].path)].push_back(index);
    }

    /// The first node that the reference names; a new one, if there is none.
    std::size_t indexOf(const cim::ObjectPath& reference)
    {
        const std::size_t next = instances_.size() + missing_.size();
        std::vector<std::size_t>& sameText = byText_[cim::lookupText(reference)];
        const auto byPath = std::find_if(sameText.begin(), sameText.end(), [&](std::size_t index) {
            return cim::sameObject(reference, pathOf(index));
        });
        const auto byProperties =
            std::find_if(withoutKeys_.begin(), withoutKeys_.end(),
                         [&](std::size_t index) { return namesByProperties(reference, instances_[index]); });
        const std::size_t found = std::min(byPath == sameText.end() ? next : *byPath,
                                           byProperties == withoutKeys_.end() ? next : *byProperties);
        if (found == next) {
            sameText.push_back(next);
            missing_.push_back(reference);
        }
        return found;
    }

    [[nodiscard]] const cim::Instances& instances() const { return instances_; }
    [[nodiscard]] const cim::ObjectPaths& missing() const { return missing_; }

private:
    [[nodiscard]] const cim::ObjectPath& pathOf(std::size_t index) const
    {
        return index < instances_.size() ? instances_[index].path : missing_[index - instances_.size()];
    }

    const cim::Instances& instances_;
    cim::ObjectPaths missing_;
    std::unordered_map<std::string, std::vector<std::size_t>> byText_; ///< by cim::lookupText(), ascending
    std::vector<std::size_t> withoutKeys_;
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

template <typename Item>
std::optional<Item> propertyOf(const cim::Instance& instance, std::string_view property)
{
    const cim::Value* value = cim::findProperty(instance, property);
    const Item* item = value != nullptr ? soleItem<Item>(*value) : nullptr;
    return item != nullptr ? std::optional(*item) : std::nullopt;
}

/// What a person calls the instance.
std::string nameOf(const cim::Instance& instance)
{
    for (const char* property : {"ElementName", "Name", "InstanceID"}) {
        const auto text = propertyOf<std::string>(instance, property);
        if (text && !text->empty())
            return *text;
    }
    return cim::toText(instance.path);
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

std::optional<std::string_view> wordOf(const cim::Instance& instance, std::string_view property)
{
    const auto number = propertyOf<std::uint64_t>(instance, property);
    return number ? valueWord(property, *number) : std::nullopt;
}

/// Health and alarm state in a line; empty: it has neither.
std::string statesOf(const cim::Instance& instance)
{
    const auto health = wordOf(instance, "HealthState");
    const auto alarm = wordOf(instance, "AlarmState");
    std::string alarmText = alarm ? "alarm " + std::string(*alarm) : "";
    if (!health)
        return alarmText;
    return std::string(*health) + (alarm ? ", " : "") + alarmText;
}

std::string nodeLine(std::size_t index, const cim::Instance& instance)
{
    std::vector<std::string> lines{nameOf(instance), instance.path.className};
    if (std::string states = statesOf(instance); !states.empty())
        lines.push_back(std::move(states));
    return nodeLine(index, lines,
                    "shape=" + std::string(shapeOf(instance.path.className)) + ", fillcolor=" +
                        std::string(colourOf(propertyOf<std::uint64_t>(instance, "HealthState"))));
}

/// Text for a label in Graphviz's HTML.
std::string htmlText(std::string_view text)
{
    std::string result;
    for (const char byte : cim::printable(text))
        result += byte == '<' ? "&lt;" : byte == '>' ? "&gt;" : byte == '&' ? "&amp;" : std::string(1, byte);
    return result;
}

/// Says once for all edges of an association what they are, in their colour.
class Legend
{
public:
    const char* colourOf(const Edge& edge)
    {
        constexpr std::array colours{"steelblue", "darkorange", "seagreen", "purple", "brown", "deeppink"};
        const auto [entry, isNew] =
            colours_.try_emplace(edge.className + ": " + edge.from.role + " \u2192 " + edge.to.role,
                                 colours[colours_.size() % colours.size()]);
        if (isNew)
            text_ += "<font color=\"" + std::string(entry->second) + "\">" + htmlText(entry->first) +
                     "</font><br/>";
        return entry->second;
    }

    /// As attributes of the graph; empty: there was no edge.
    [[nodiscard]] std::string attributes() const
    {
        return text_.empty() ? ""
                             : "    labelloc=t;\n    fontname=\"sans-serif\";\n    label=<" + text_ + ">;\n";
    }

private:
    std::map<std::string, const char*> colours_; ///< by what is said
    std::string text_;
};

std::string edgeLine(const Edge& edge, Nodes& nodes, Legend& legend)
{
    return "    n" + std::to_string(nodes.indexOf(edge.from.path)) + " -> n" +
           std::to_string(nodes.indexOf(edge.to.path)) + " [color=" + legend.colourOf(edge) + "];\n";
}

} // namespace

void addInstance(const cim::Instance& instance, bool isAssociation, Picture& picture)
{
    const std::vector<End> ends = endsOf(instance);
    const std::string& className = instance.path.className;
    if (ends.size() >= 2)
        picture.edges.push_back({className, ends[0], ends[1]});
    else if (isAssociation)
        picture.remarks.push_back(className + ": an instance that does not refer to two objects");
    else
        picture.nodes.push_back(instance);
}

std::string dot(const std::string& nameSpace, const Picture& picture)
{
    Nodes nodes(picture.nodes);
    Legend legend;
    std::string edges;
    for (const Edge& edge : picture.edges)
        edges += edgeLine(edge, nodes, legend);

    std::string text = "digraph " + label({nameSpace}) +
                       " {\n"
                       "    rankdir=LR;\n"
                       "    ranksep=2;\n"
                       "    nodesep=0.1;\n" +
                       legend.attributes() +
                       "    node [fontname=\"sans-serif\", style=filled, margin=\"0.1,0.03\"];\n";
    for (const std::string& remark : picture.remarks)
        text += "    // " + cim::printable(remark) + '\n';
    std::size_t index = 0;
    for (const cim::Instance& instance : nodes.instances())
        text += nodeLine(index++, instance);
    for (const cim::ObjectPath& path : nodes.missing())
        text += nodeLine(index++, {cim::toText(path)}, "shape=box, style=dashed");
    return text + edges + "}\n";
}

ExitStatus writeGraph(const std::string& nameSpace, Broker& broker, std::ostream& out, std::ostream& err)
{
    Picture picture;
    bool anyAnswer = false;
    for (const RegisteredClass& entry : instanceClasses(broker.registration(), nameSpace)) {
        const cim::Answer answer = broker.enumerateInstances({"", nameSpace, entry.className, {}});
        if (answer.status.code != CMPI_RC_OK) {
            picture.remarks.push_back(entry.className + ": " + statusLine(answer.status));
            continue;
        }
        anyAnswer = true;
        for (const cim::Instance& instance : answer.instances)
            addInstance(instance, entry.association, picture);
    }

    for (const std::string& remark : picture.remarks)
        err << "cimhost: " << cim::printable(remark) << '\n';
    if (anyAnswer)
        out << dot(nameSpace, picture);
    else
        err << "cimhost: no class of the namespace " << cim::printable(nameSpace) << " answered\n";
    return anyAnswer ? exitAnswered : exitError;
}

} // namespace cimhost::cli
