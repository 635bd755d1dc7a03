// Asks the provider library with a neighbour loaded before it, as a broker does, and prints what it answered.
//
// Usage: library-calls MODE NEIGHBOUR LIBRARY      MODE: how dlopen() binds, now or lazy; NEIGHBOUR: a file, or none

#include "Load.h"

#include "broker/Registration.h"
#include "testing/Operations.h"

#include <exception>
#include <iostream>
#include <sstream>

namespace {

template <class Function>
Function* entryPoint(void* library, const std::string& name)
{
    return reinterpret_cast<Function*>(symbolOf(library, name));
}

EntryPoints entryPointsOf(void* library)
{
    using Instances = std::remove_pointer_t<EntryPoints::CreateInstanceMI>;
    using Associations = std::remove_pointer_t<EntryPoints::CreateAssociationMI>;
    return {entryPoint<Instances>(library, "GlimmarkProfileProvider_Create_InstanceMI"),
            entryPoint<Instances>(library, "GlimmarkCapabilitiesProvider_Create_InstanceMI"),
            entryPoint<Instances>(library, "GlimmarkElementCapabilitiesProvider_Create_InstanceMI"),
            entryPoint<Associations>(library, "GlimmarkElementCapabilitiesProvider_Create_AssociationMI"),
            entryPoint<Instances>(library, "GlimmarkSystemDeviceProvider_Create_InstanceMI"),
            entryPoint<Associations>(library, "GlimmarkSystemDeviceProvider_Create_AssociationMI")};
}

int run(const std::string& mode, const std::string& neighbour, const std::string& file)
{
    const EntryPoints entryPoints = entryPointsOf(loadBeside(neighbour, file, mode));
    cimhost::Broker host(cimhost::readRegistrationFile(COMPUTER_SYSTEM_REGISTRATION), {PROVIDER_DIRECTORY});
    for (const auto& operations : {allOperations(entryPoints), fixedOperations(entryPoints)}) {
        for (const Operation& operation : operations) {
            std::ostringstream outcome;
            PrintTo(ask(host, operation), &outcome);
            std::cout << operation.name << '\n' << outcome.str() << '\n';
        }
    }
    return 0;
}

} // namespace

int main(int argc, char** argv)
try {
    return argc == 4 ? run(argv[1], argv[2], argv[3]) : 2;
} catch (const std::exception& error) {
    std::cerr << error.what() << '\n';
    return 1;
}
