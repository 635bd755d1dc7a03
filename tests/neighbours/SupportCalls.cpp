// Loads a support library beside a neighbour, then the caller, which is linked with that support library and finds it
// before all others, and has it call everything.
//
// Usage: support-calls MODE NEIGHBOUR LIBRARY CALLER FUNCTION

#include "Load.h"

#include <exception>
#include <iostream>

namespace {

int run(const std::string& mode, const std::string& neighbour, const std::string& file,
        const std::string& caller, const std::string& function)
{
    loadBeside(neighbour, file, mode);
    void* const calls = load(caller, RTLD_NOW | RTLD_LOCAL | RTLD_DEEPBIND);
    std::cout << reinterpret_cast<const char* (*)()>(symbolOf(calls, function))() << '\n';
    return 0;
}

} // namespace

int main(int argc, char** argv)
try {
    return argc == 6 ? run(argv[1], argv[2], argv[3], argv[4], argv[5]) : 2;
} catch (const std::exception& error) {
    std::cerr << error.what() << '\n';
    return 1;
}
