/// \file
/// Which computer systems the stand-in serves.
#ifndef TAVRO_COMPUTERSYSTEM_SYSTEMNAMES_H
#define TAVRO_COMPUTERSYSTEM_SYSTEMNAMES_H

#include <string>
#include <vector>

namespace Tavro::ComputerSystem {

/// The names of the systems, read anew by every call: those of the environment variable
/// TAVRO_COMPUTER_SYSTEMS, separated by commas, in its order, without blanks around them, empty ones and
/// repetitions. Without the variable, this host's name alone; where it is set and names nothing, no system.
std::vector<std::string> systemNames();

} // namespace Tavro::ComputerSystem

#endif
