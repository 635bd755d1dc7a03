#include "Tavro/Instrumentation.h"

#include "ErrorLine.h"
#include "sources/NodeSource.h"

#include <algorithm>
#include <cstddef>
#include <vector>

namespace Tavro {

struct Instrumentation::Implementation
{
    const std::vector<Node> nodes = readNodes();
    unsigned int kind = 0;
    std::size_t position = nodes.size(); ///< off the end: on no node

    /// Steps to the first node of the kind at or after `position`.
    void findNode()
    {
        while (position < nodes.size() && nodes[position].kind != kind)
            ++position;
    }

    /// Says which indicator has no description, the first of them. The provider takes none of an inventory
    /// with such a one, and says nothing.
    void complainOfNamelessIndicator() const
    {
        const auto nameless = std::find_if(nodes.begin(), nodes.end(), [](const Node& node) {
            return node.kind == NodeLexicon::DiagnosticIndicator && node.description.empty();
        });
        if (nameless != nodes.end())
            logError({static_cast<const char*>(__func__), "Instrumentation.cpp", __LINE__},
                     "the diagnostic indicator " + nameless->path +
                         " has no description: the provider answers without indicators");
    }

    /// Null while the cursor stands on none.
    [[nodiscard]] const Node* node() const { return position < nodes.size() ? &nodes[position] : nullptr; }

    /// The node of that path, the one the cursor stands on before any other; null: there is none.
    [[nodiscard]] const Node* nodeAt(const std::string& path) const
    {
        if (const Node* const current = node(); current != nullptr && current->path == path)
            return current;
        const auto found = std::find_if(nodes.begin(), nodes.end(),
                                        [&path](const Node& candidate) { return candidate.path == path; });
        return found == nodes.end() ? nullptr : &*found;
    }
};

Instrumentation::Instrumentation() : implementation_(std::make_unique<Implementation>()) {}

Instrumentation::~Instrumentation() = default;

void Instrumentation::selectNode(NodeLexicon::NodeType kind)
{
    implementation_->kind = kind;
    implementation_->position = 0;
    implementation_->findNode();
    if (kind == NodeLexicon::DiagnosticIndicator)
        implementation_->complainOfNamelessIndicator();
}

Instrumentation::operator bool() const
{
    return implementation_->node() != nullptr;
}

Instrumentation& Instrumentation::operator++()
{
    if (*this)
        ++implementation_->position;
    implementation_->findNode();
    return *this;
}

std::string Instrumentation::getPathToNode() const
{
    const Node* const node = implementation_->node();
    return node == nullptr ? std::string() : node->path;
}

std::string Instrumentation::convertPathToString(const std::string& path) const
{
    const Node* const node = implementation_->nodeAt(path);
    return node == nullptr || node->displayText == nullptr ? path : *node->displayText;
}

std::string Instrumentation::getNodeDescription() const
{
    const Node* const node = implementation_->node();
    return node == nullptr ? std::string() : node->description;
}

unsigned int Instrumentation::getNodeStatus() const
{
    const Node* const node = implementation_->node();
    return node == nullptr ? 0 : node->status;
}

bool Instrumentation::getProperty(NodeLexicon::Properties property, unsigned int& value) const
{
    const Node* const node = implementation_->node();
    if (property != NodeLexicon::AlarmState || node == nullptr || !node->alarmState)
        return false;
    value = *node->alarmState;
    return true;
}

} // namespace Tavro
