/// \file
/// The kinds of nodes by the names that an inventory file may call them; letter case matters.
#ifndef TAVRO_NODEKINDS_H
#define TAVRO_NODEKINDS_H

#include "Tavro/NodeLexicon.h"

#include <array>
#include <string_view>

namespace Tavro {

struct NamedKind
{
    std::string_view name;
    NodeLexicon::NodeType kind;
};

inline constexpr std::array namedKinds = {
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

} // namespace Tavro

#endif
