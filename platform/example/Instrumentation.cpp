// An instrumentation library to begin with: copy this folder, let readServer() ask your server, and keep the
// rest or not. Built, it is libtavro-instrumentation.so.1; the provider library takes it as soon as the
// loader finds it before another of that name. docs/maker.md tells how it is shipped.
//
// The comments say what the provider library relies on. For all of it:
//
// Place: it runs inside a broker, often as root, beside other providers. It changes nothing that is the whole
// process's: no signal handler, locale, working folder or environment variable.
//
// Time: a request waits for it, and every request makes a cursor of its own. What is slow to ask is best
// asked beforehand, by a daemon of yours.
//
// Threads: any number of requests run at once, each with a cursor of its own, in a thread of the broker's.
// One thread at a time uses a cursor. What cursors share, such as a connection, takes a lock.
//
// Lifetime: a cursor lives no longer than its request. What it answers is a copy: nobody keeps a pointer into
// it, and it keeps none to what it was handed. The broker may unload the library once no cursor is left: a
// thread of yours that still runs then ends the broker.
//
// Exceptions: std::bad_alloc, and nothing else. One from the constructor or selectNode() passes through the
// provider into the broker; one from another function ends the list of indicators, as does an indicator
// without a description, and the provider answers without indicators. What cannot be read is therefore an
// inventory with fewer nodes, or none; say why in the log, with MVLog/MVLogger.h.

#include <Tavro/Instrumentation.h>

#include <cstddef>
#include <optional>
#include <vector>

namespace Tavro {
namespace {

struct Node
{
    unsigned int kind; ///< 36 is a diagnostic indicator; the provider asks for no other
    std::string path;  ///< your own name for it, any text
    std::string displayText;
    std::string description;
    unsigned int status;
    std::optional<unsigned int> alarmState; ///< nothing: the indicator does not tell
};

/// Here the server is asked. This one always has the same two indicators and a fan.
std::vector<Node> readServer()
{
    return {{36, "fan-1/led", "fan tray, left", "Fan Tray Fault LED", 21, 3},
            {NodeLexicon::Fan, "fan-1", "fan tray", "Fan Tray", 21, std::nullopt},
            {36, "front/id", "front panel", "Identification LED", 1, std::nullopt}};
}

} // namespace

/// What a cursor holds is yours; the class itself is one pointer to it, in all libraries and for all time.
struct Instrumentation::Implementation
{
    std::vector<Node> nodes = readServer();
    unsigned int kind = 0;
    std::size_t position = nodes.size(); ///< off the end: on no node

    void findNode()
    {
        while (position < nodes.size() && nodes[position].kind != kind)
            ++position;
    }

    [[nodiscard]] const Node* node() const { return position < nodes.size() ? &nodes[position] : nullptr; }
};

/// Reads the inventory, and stands on no node. The cursor goes on seeing what it read here, whatever changes
/// meanwhile.
Instrumentation::Instrumentation() : implementation_(std::make_unique<Implementation>()) {}

/// Here, not in the header: only this library knows what a cursor holds.
Instrumentation::~Instrumentation() = default;

/// Stands on the first node of that kind, or on none. May be called again, with any number.
void Instrumentation::selectNode(NodeLexicon::NodeType kind)
{
    implementation_->kind = kind;
    implementation_->position = 0;
    implementation_->findNode();
}

/// Whether the cursor stands on a node. Changes nothing.
Instrumentation::operator bool() const
{
    return implementation_->node() != nullptr;
}

/// Steps to the next node of the kind, or off the end, and stays there. Every node comes once, in an order of
/// your choice: clients get the indicators ordered by DeviceID, and of several with the same one the last.
Instrumentation& Instrumentation::operator++()
{
    if (*this)
        ++implementation_->position;
    implementation_->findNode();
    return *this;
}

// On no node, texts are empty, the status is 0 and there is no property.

/// Your own name for the node. The provider only hands it to convertPathToString().
std::string Instrumentation::getPathToNode() const
{
    const Node* const node = implementation_->node();
    return node == nullptr ? std::string() : node->path;
}

/// What people are shown for a path: UTF-8, without null characters. The description, a colon and this are
/// the indicator's DeviceID, the key by which clients ask for it again: no other indicator has the same,
/// blanks at either end aside, and it stays the same from request to request. A path of no node is shown as
/// it is.
std::string Instrumentation::convertPathToString(const std::string& path) const
{
    for (const Node& node : implementation_->nodes)
        if (node.path == path)
            return node.displayText;
    return path;
}

/// The name that people know the indicator by, of which its Name, ElementName and Description are made:
/// UTF-8, without null characters. An indicator without one costs the provider all indicators.
std::string Instrumentation::getNodeDescription() const
{
    const Node* const node = implementation_->node();
    return node == nullptr ? std::string() : node->description;
}

/// 1 is well, 20 degraded with a failure predicted, 21 to 26 degraded. All else is unknown; with 0 there is
/// no OperationalStatus either.
unsigned int Instrumentation::getNodeStatus() const
{
    const Node* const node = implementation_->node();
    return node == nullptr ? 0 : node->status;
}

/// Property 1 is the alarm state: 0 unknown, 1 off, 2 steady, 3 alternating. Whatever the node does not have,
/// and any other property, is answered with false, and `value` stays as it was.
bool Instrumentation::getProperty(NodeLexicon::Properties property, unsigned int& value) const
{
    const Node* const node = implementation_->node();
    if (property != NodeLexicon::AlarmState || node == nullptr || !node->alarmState)
        return false;
    value = *node->alarmState;
    return true;
}

} // namespace Tavro
