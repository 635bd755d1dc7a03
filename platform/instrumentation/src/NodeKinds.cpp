#include "NodeKinds.h"

#include "Tavro/NodeLexicon.h"

namespace Tavro {
namespace {

struct NamedKind
{
    std::string_view name;
    NodeLexicon::NodeType kind;
};

constexpr NamedKind namedKinds[] = {
    {"chassis", NodeLexicon::Chassis},
    {"system board", NodeLexicon::SystemBoard},
    {"processor", NodeLexicon::Processor},
    {"memory module", NodeLexicon::MemoryModule},
    {"drive", NodeLexicon::Drive},
    {"fan", NodeLexicon::Fan},
    {"power supply", NodeLexicon::PowerSupply},
    {"temperature sensor", NodeLexicon::TemperatureSensor},
    {"diagnostic indicator", NodeLexicon::DiagnosticIndicator},
};

} // namespace

std::optional<unsigned int> findNodeKind(std::string_view name)
{
    for (const NamedKind& candidate : namedKinds)
        if (candidate.name == name)
            return candidate.kind;
    return std::nullopt;
}

std::string listNodeKinds()
{
    std::string list;
    for (const NamedKind& named : namedKinds) {
        if (!list.empty())
            list += ", ";
        list.append(1, '"').append(named.name).append(1, '"');
    }
    return list;
}

} // namespace Tavro
