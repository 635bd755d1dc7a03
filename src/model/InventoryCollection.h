/// \file
/// From the hardware inventory to records. Nothing is kept between calls: each walks the inventory.
#ifndef TAVRO_GLIMMARK_INVENTORYCOLLECTION_H
#define TAVRO_GLIMMARK_INVENTORYCOLLECTION_H

#include "Glimmark.h"
#include "GlimmarkCapabilities.h"

#include <vector>

namespace Tavro {
class Instrumentation;
}

namespace Tavro::GlimmarkProvider {

/// Appends a record for each diagnostic indicator of the inventory, in the inventory's order.
/// \return 0; 1 when there is no indicator, or when one of them had no name or the memory ran out: the
///     records of the indicators before it then stay in `out`
/// \throws only what the instrumentation library throws while the inventory is opened
int getGlimmarkInstances(std::vector<Glimmark>& out);

/// Appends a record for the node under the cursor and for each one after it.
/// \return 0
/// \throws ProviderException for a node without identifier or name; std::bad_alloc
int setVector(std::vector<Glimmark>& out, Instrumentation& cursor);

/// Appends the one capabilities record.
/// \return 0; 1 when that failed, with the reason on standard error
int getGlimmarkCapabilitiesInstances(std::vector<GlimmarkCapabilities>& out);

} // namespace Tavro::GlimmarkProvider

#endif
