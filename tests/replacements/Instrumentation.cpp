// Another maker's instrumentation library: one indicator, and no file behind it.

#include <Tavro/Instrumentation.h>

namespace Tavro {

struct Instrumentation::Implementation
{
    bool onNode = false;
};

Instrumentation::Instrumentation() : implementation_(std::make_unique<Implementation>()) {}
Instrumentation::~Instrumentation() = default;

void Instrumentation::selectNode(NodeLexicon::NodeType kind)
{
    implementation_->onNode = kind == static_cast<NodeLexicon::NodeType>(36);
}

Instrumentation::operator bool() const
{
    return implementation_->onNode;
}

Instrumentation& Instrumentation::operator++()
{
    implementation_->onNode = false;
    return *this;
}

std::string Instrumentation::getPathToNode() const
{
    return "replaced path";
}
std::string Instrumentation::convertPathToString(const std::string& path) const
{
    return path;
}
std::string Instrumentation::getNodeDescription() const
{
    return "Replaced indicator";
}
unsigned int Instrumentation::getNodeStatus() const
{
    return 1;
}
bool Instrumentation::getProperty(NodeLexicon::Properties, unsigned int&) const
{
    return false;
}

} // namespace Tavro
