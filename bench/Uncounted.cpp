// What callgrind shall not see differ: in the place of testing/Allocations.cpp memory comes from the run-time library, as
// in a broker, and the name of this machine is that of any.

#include "testing/Allocations.h"

#include <cstring>

#include <sys/utsname.h>

namespace Allocations {

Pause::Pause() = default;
Pause::~Pause() = default;

} // namespace Allocations

// NOLINTNEXTLINE(readability-inconsistent-declaration-parameter-name)
int uname(utsname* kernel) noexcept
{
    *kernel = {};
    std::strcpy(static_cast<char*>(kernel->nodename), "server");
    return 0;
}
