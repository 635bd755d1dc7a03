/// \file
/// Inventories and texts of the nasty kind, for tests of what holds for all of them.
#ifndef TESTS_PROPERTIES_GENERATORS_H
#define TESTS_PROPERTIES_GENERATORS_H

#include "testing/MadeInventory.h"

#include <optional>
#include <string>
#include <vector>

#include <rapidcheck.h>

namespace MadeInventory {

/// For the reports.
void showValue(const Node& node, std::ostream& stream);

} // namespace MadeInventory

namespace Generators {

/// Blanks around and nothing between, quotes, letters beyond ASCII, bytes that are no UTF-8, very long ones
/// and any other bytes. Some come up often, so that texts meet their like. Never a null character, which ends
/// a text on its way to the broker, and never empty: an empty name ends the collection.
rc::Gen<std::string> texts();

/// All there are, those around the ones with a meaning more often, also where only the lower 16 bits have
/// one.
rc::Gen<unsigned int> statuses();
rc::Gen<std::optional<unsigned int>> alarmStates();

/// Indicators and nodes of other kinds, several of them at one place.
rc::Gen<std::vector<MadeInventory::Node>> inventories();

/// Names of computer systems, each once; also none.
rc::Gen<std::vector<std::string>> computerSystems();

/// The names of some properties, in any order, some of them twice, in other letter case or unknown.
rc::Gen<std::vector<std::string>> propertyLists(const std::vector<std::string>& known);

} // namespace Generators

#endif
