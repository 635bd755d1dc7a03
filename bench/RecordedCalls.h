/// \file
/// Support libraries that write down every call: this executable defines their functions itself, ahead of the
/// real ones, for the provider library as for the floor. The inventory is MadeInventory, which tells its
/// calls.
#ifndef BENCH_RECORDEDCALLS_H
#define BENCH_RECORDEDCALLS_H

#include <cstddef>
#include <string>
#include <vector>

namespace RecordedCalls {

/// The calls since the last clear(), each as the function's name with its arguments; addresses are "ADDRESS",
/// line numbers "LINE", wherever they stand.
std::vector<std::string> all();

/// Number of all().
std::size_t count();

/// Forgets the calls so far, and listens to the inventory from now on.
void clear();

} // namespace RecordedCalls

#endif
