/// \file
/// The record of the capabilities that all diagnostic indicators share.
#ifndef TAVRO_GLIMMARK_GLIMMARKCAPABILITIES_H
#define TAVRO_GLIMMARK_GLIMMARKCAPABILITIES_H

#include <cstdint>
#include <string>
#include <vector>

namespace Tavro::GlimmarkProvider {

/// The capabilities of the indicators, a copyable value. It has no setters: its getters produce the
/// content, and write it into the record as they do.
class GlimmarkCapabilities
{
public:
    GlimmarkCapabilities() = default;

    /// "TAVRO:GlimmarkCapabilities1", stored in the record too. There is one capabilities object in a
    /// system, so every record answers the same.
    std::string getInstanceID();
    /// Always false: nobody can rename an indicator. Stored in the record too.
    bool getElementNameEditSupported();
    /// Appends 1 (Off), 2 (Steady) and 3 (Alternating) to the record's list and returns a copy of all
    /// of it. A second call on the same record therefore answers six values: callers ask a record once.
    std::vector<std::uint16_t> getAlarmStatesSupported();

private:
    std::string InstanceID;
    // No getter answers it before it was set; the initial value only keeps copies of a fresh record
    // well defined.
    bool ElementNameEditSupported = false;
    // CIM's list of supported states of an enabled element. No operation reads or writes it.
    std::vector<std::uint16_t> RequestedStatesSupported;
    std::vector<std::uint16_t> AlarmStatesSupported;
};

} // namespace Tavro::GlimmarkProvider

#endif
