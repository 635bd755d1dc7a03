// What callgrind shall not see differ: in the place of testing/Allocations.cpp memory comes from the run-time library, as
// in a broker, and the name of this machine is that of any.

#include "testing/Allocations.h"

#include <cstring>

#include <sys/utsname.h>

namespace Allocations {

// NOLINTBEGIN(performance-trivially-destructible): declared for what counts
Pause::Pause() = default;
Pause::~Pause() = default;
// NOLINTEND(performance-trivially-destructible)

} // namespace Allocations

// NOLINTNEXTLINE(readability-inconsistent-declaration-parameter-name)
int uname(utsname* kernel) noexcept
{
    *kernel = {};
    std::strcpy(static_cast<char*>(kernel->nodename), "server");
    return 0;
}
