/// \file
/// The kinds of nodes by the names that an inventory file may call them.
#ifndef TAVRO_NODEKINDS_H
#define TAVRO_NODEKINDS_H

#include <optional>
#include <string>
#include <string_view>

namespace Tavro {

/// The number of the kind with that name, such as "diagnostic indicator"; letter case matters.
std::optional<unsigned int> findNodeKind(std::string_view name);

/// All names, quoted and separated by commas.
std::string listNodeKinds();

} // namespace Tavro

#endif
