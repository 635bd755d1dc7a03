// What holds between the names and the instances of a class: they agree one to one but where it is meant
// otherwise, and what is named is found.

#include "Generators.h"
#include "Server.h"

#include "cim/Values.h"

#include <algorithm>
#include <cstddef>
#include <string>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

namespace cim = cimhost::cim;

namespace {

RC_GTEST_PROP(Names, andInstancesOfAClassAgreeOneToOne, ())
{
    Server server(*Generators::inventories());
    for (const std::string& className : Server::classes())
        RC_ASSERT(sameObjects(server.names(className), pathsOf(server.instances(className))));
}

// Names of system devices are collected in one list for all computer systems and that list is answered again
// for each: those of the second system come twice, of the third three times. The instances come once each.
RC_GTEST_PROP(Names, ofSystemDevicesComeAgainForEverySystem, ())
{
    const auto systems = *Generators::computerSystems();
    Server server(*Generators::inventories(), systems);
    const Server::Paths instances = pathsOf(server.instances(Server::systemDevice));
    const std::size_t devices = server.names(Server::glimmark).size();
    Server::Paths expected;
    for (std::size_t system = 0; system < systems.size(); ++system)
        for (std::size_t time = 0; time <= system; ++time)
            expected.append(instances.part(system * devices, devices));
    RC_ASSERT(instances.size() == systems.size() * devices);
    RC_ASSERT(sameObjects(server.names(Server::systemDevice), expected));
}

RC_GTEST_PROP(Names, areThoseOfObjectsThatAreFound, ())
{
    Server server(*Generators::inventories(), *Generators::computerSystems());
    for (const std::string& className : Server::classes()) {
        const Server::Instances instances = server.instances(className);
        for (const cim::ObjectPath& name : server.names(className)) {
            const Server::Instances found = server.get(name);
            RC_ASSERT(found.size() == 1U);
            RC_ASSERT(cim::sameObject(found[0].path, name));
            RC_ASSERT(std::count(instances.begin(), instances.end(), found[0]) == 1);
        }
    }
}

RC_GTEST_PROP(Instances, areEachOnce, ())
{
    Server server(*Generators::inventories(), *Generators::computerSystems());
    for (const std::string& className : Server::classes()) {
        const Server::Paths paths = pathsOf(server.instances(className));
        for (std::size_t i = 0; i < paths.size(); ++i)
            for (std::size_t j = 0; j < i; ++j)
                RC_ASSERT(!cim::sameObject(paths[i], paths[j]));
    }
}

RC_GTEST_PROP(Names, areTheSameWhenAskedAgain, ())
{
    Server server(*Generators::inventories(), *Generators::computerSystems());
    for (const std::string& className : Server::classes()) {
        RC_ASSERT(server.names(className) == server.names(className));
        RC_ASSERT(server.instances(className) == server.instances(className));
    }
}

} // namespace
