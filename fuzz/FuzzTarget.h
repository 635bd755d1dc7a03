/// \file
/// What a fuzz target is made of: the function that is fed, and the check of what must hold for any input.
#ifndef FUZZ_FUZZTARGET_H
#define FUZZ_FUZZTARGET_H

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>

/// Every target defines it: takes one input. An exception that leaves it is a finding, as is a crash, a leak
/// or what a sanitizer reports. \return 0
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace Fuzz {

inline std::string textOf(const std::uint8_t* data, std::size_t size)
{
    return size == 0 ? std::string() : std::string(reinterpret_cast<const char*>(data), size);
}

/// Makes the input a finding unless something holds. \param what  that holds, for the report
inline void require(bool holds, const std::string& what)
{
    if (holds)
        return;
    std::fprintf(stderr, "This does not hold: %s\n", what.c_str());
    std::abort();
}

} // namespace Fuzz

#endif
