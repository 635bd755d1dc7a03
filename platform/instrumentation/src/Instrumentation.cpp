#include "Tavro/Instrumentation.h"

#include "FileNodeSource.h"

#include <cstddef>
#include <vector>

namespace Tavro {

struct Instrumentation::Implementation
{
    std::unique_ptr<const NodeSource> source = std::make_unique<FileNodeSource>();
    std::vector<Node> nodes = source->read();
    unsigned int kind = 0;
    std::size_t position = nodes.size(); ///< off the end: on no node

    /// Steps to the first node of the kind at or after `position`.
    void findNode()
    {
        while (position < nodes.size() && nodes[position].kind != kind)
            ++position;
    }

    /// Null while the cursor stands on none.
    [[nodiscard]] const Node* node() const { return position < nodes.size() ? &nodes[position] : nullptr; }
};

Instrumentation::Instrumentation() : implementation_(std::make_unique<Implementation>()) {}

Instrumentation::~Instrumentation() = default;

void Instrumentation::selectNode(NodeLexicon::NodeType kind)
{
    implementation_->kind = kind;
    implementation_->position = 0;
    implementation_->findNode();
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
    return implementation_->source->displayText(path);
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
