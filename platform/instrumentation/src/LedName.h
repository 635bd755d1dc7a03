/// \file
/// Names of LEDs, by the kernel's convention: device:colour:function, of which any part may be missing.
#ifndef TAVRO_LEDNAME_H
#define TAVRO_LEDNAME_H

#include <string>
#include <string_view>

namespace Tavro {

/// What people are shown for a LED of that name: its parts in words and "LED", such as
/// "Chassis Blue Identify LED" for chassis:blue:identify and "Green Status 2 LED" for green:status-2.
/// Printable UTF-8 and never empty, whatever the name.
std::string describeLed(std::string_view name);

} // namespace Tavro

#endif
