/// \file
/// What somebody may have meant.
#ifndef CIMHOST_CIM_NEAREST_H
#define CIMHOST_CIM_NEAREST_H

#include <string>
#include <vector>

namespace cimhost::cim {

/// The name that is the fewest changed, added or left out letters away, letter case ignored; empty: none is
/// near enough to have been meant.
std::string nearestName(const std::string& name, const std::vector<std::string>& names);

/// `; did you mean NAME?` with the nearest name; empty: there is none.
std::string didYouMean(const std::string& name, const std::vector<std::string>& names);

} // namespace cimhost::cim

#endif
