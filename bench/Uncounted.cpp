// In the place of testing/Allocations.cpp: memory comes from the run-time library, as in a broker.

#include "testing/Allocations.h"

namespace Allocations {

Pause::Pause() = default;
Pause::~Pause() = default;

} // namespace Allocations
