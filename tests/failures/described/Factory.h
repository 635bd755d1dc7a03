/// \file
/// The factory: paths and instances of the indicators and the capabilities, and the far ends of associations.
#ifndef TESTS_FAILURES_DESCRIBED_FACTORY_H
#define TESTS_FAILURES_DESCRIBED_FACTORY_H

#include "Indicators.h"
#include "Services.h"

#include <string>

namespace described {

/// The module of its trace lines.
constexpr auto factory = "GlimmarkObjFactory";

/// The InstanceID of the one object of the capabilities.
constexpr auto capabilitiesIdentifier = "TAVRO:GlimmarkCapabilities1";

/// Adds paths of all indicators, or of the capabilities, to a list.
/// \return whether all paths could be made; if not, the operation that asked for them ends, in its own way
bool addIndicatorPaths(const Indicators& indicators, const Path* ref, Paths& paths, Status& rc);
bool addCapabilitiesPaths(const Path* ref, Paths& paths, Status& rc);

/// What the builder of an instance gets from the broker: null or without a handle where it could not be made.
Instance* indicatorInstance(const std::string& deviceID, const Indicator& indicator, const Path* ref,
                            Status& rc);
Instance* capabilitiesInstance(const Path* ref, Status& rc);

/// Instances that could not be made are among them.
Instances indicatorInstances(const Indicators& indicators, const Path* ref, Status& rc);
/// \param exist  false: the request has collected no capabilities
Instances capabilitiesInstances(const Path* ref, Status& rc, bool exist = true);

/// A path of the class at the far end of an association; null where none is described.
/// \param ref  of the class at the near end
Path* targetPath(const Path* ref, const char* assocClass, Status& rc);

} // namespace described

#endif
