#include "NodeKinds.h"

#include "QuotedNames.h"
#include "Tavro/NodeLexicon.h"

#include <array>

namespace Tavro {
namespace {

struct NamedKind
{
    std::string_view name;
    NodeLexicon::NodeType kind;
};

constexpr std::array namedKinds = {
    NamedKind{"chassis", NodeLexicon::Chassis},
    NamedKind{"system board", NodeLexicon::SystemBoard},
    NamedKind{"processor", NodeLexicon::Processor},
    NamedKind{"memory module", NodeLexicon::MemoryModule},
    NamedKind{"drive", NodeLexicon::Drive},
    NamedKind{"fan", NodeLexicon::Fan},
    NamedKind{"power supply", NodeLexicon::PowerSupply},
    NamedKind{"temperature sensor", NodeLexicon::TemperatureSensor},
    NamedKind{"diagnostic indicator", NodeLexicon::DiagnosticIndicator},
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
    return quotedNames(namedKinds);
}

} // namespace Tavro
