/// \file
/// The words of the hardware inventory: what nodes there are and what can be asked of them.
#ifndef TAVRO_NODELEXICON_H
#define TAVRO_NODELEXICON_H

namespace Tavro::NodeLexicon {

/// The kind of a node. An inventory may hold kinds that are not listed here.
enum NodeType : unsigned int
{
    Chassis = 1,
    SystemBoard = 2,
    Processor = 3,
    MemoryModule = 4,
    Drive = 5,
    Fan = 6,
    PowerSupply = 7,
    TemperatureSensor = 8,
    DiagnosticIndicator = 36,
};

/// What a node may have beside its description, path and status.
enum Properties : unsigned int
{
    AlarmState = 1,
};

} // namespace Tavro::NodeLexicon

#endif
