// What holds between the four traversals of an association, in both directions, and with its instances.

#include "Generators.h"
#include "Server.h"

#include "cim/Values.h"

#include <algorithm>
#include <optional>
#include <string>
#include <utility>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

namespace cim = cimhost::cim;
using cimhost::Traversal;

namespace {

/// An association as seen from one of its ends.
struct Direction
{
    std::string association;
    std::string nearEnd; ///< name of the reference to the object that a traversal starts from
    std::string farEnd;
};

const Direction toCapabilities{Server::elementCapabilities, "ManagedElement", "Capabilities"};
const Direction fromCapabilities{Server::elementCapabilities, "Capabilities", "ManagedElement"};
const Direction toSystem{Server::systemDevice, "PartComponent", "GroupComponent"};
const Direction fromSystem{Server::systemDevice, "GroupComponent", "PartComponent"};

Traversal associatorsOf(const Direction& direction)
{
    return {direction.association, {}, {}, {}};
}

/// References are asked for with the association as their class.
Traversal referencesOf(const Direction& direction)
{
    return {{}, direction.association, {}, {}};
}

/// The forms that answer with names and those that answer with instances agree.
void checkForms(Server& server, const cim::ObjectPath& from, const Direction& direction)
{
    RC_ASSERT(sameObjects(server.associatorNames(from, associatorsOf(direction)),
                          pathsOf(server.associators(from, associatorsOf(direction)))));
    RC_ASSERT(sameObjects(server.referenceNames(from, referencesOf(direction)),
                          pathsOf(server.references(from, referencesOf(direction)))));
}

/// Each reference ties the object to one of its associators, in the same order.
void checkEnds(Server& server, const cim::ObjectPath& from, const Direction& direction)
{
    Server::Paths far;
    for (const cim::Instance& reference : server.references(from, referencesOf(direction))) {
        RC_ASSERT(cim::sameObject(endOf(reference, direction.nearEnd), from));
        far.push_back(endOf(reference, direction.farEnd));
    }
    RC_ASSERT(sameObjects(far, server.associatorNames(from, associatorsOf(direction))));
}

bool contains(const Server::Paths& paths, const cim::ObjectPath& wanted)
{
    return std::any_of(paths.begin(), paths.end(),
                       [&](const cim::ObjectPath& path) { return cim::sameObject(path, wanted); });
}

/// What an object leads to leads back to it.
void checkWayBack(Server& server, const cim::ObjectPath& from, const Direction& there, const Direction& back)
{
    for (const cim::ObjectPath& other : server.associatorNames(from, associatorsOf(there)))
        RC_ASSERT(contains(server.associatorNames(other, associatorsOf(back)), from));
}

RC_GTEST_PROP(Traversals, ofElementCapabilitiesAgreeInBothDirections, ())
{
    Server server(*Generators::inventories());
    const Server::Paths devices = server.names(Server::glimmark);
    const cim::ObjectPath capabilities = server.names(Server::capabilities).at(0);
    for (const cim::ObjectPath& device : devices) {
        checkForms(server, device, toCapabilities);
        checkEnds(server, device, toCapabilities);
        RC_ASSERT(sameObjects(server.associatorNames(device, associatorsOf(toCapabilities)), {capabilities}));
    }
    checkForms(server, capabilities, fromCapabilities);
    checkEnds(server, capabilities, fromCapabilities);
    checkWayBack(server, capabilities, fromCapabilities, toCapabilities);
    RC_ASSERT(sameObjects(server.associatorNames(capabilities, associatorsOf(fromCapabilities)), devices));
    RC_ASSERT(sameObjects(server.referenceNames(capabilities, referencesOf(fromCapabilities)),
                          server.names(Server::elementCapabilities)));
}

RC_GTEST_PROP(Traversals, ofSystemDevicesAgreeFromTheSystem, ())
{
    Server server(*Generators::inventories(), *Generators::computerSystems());
    Server::Paths all;
    for (const cim::ObjectPath& system : server.names(Server::computerSystem)) {
        checkForms(server, system, fromSystem);
        checkEnds(server, system, fromSystem);
        checkWayBack(server, system, fromSystem, toSystem);
        all.append(server.referenceNames(system, referencesOf(fromSystem)));
    }
    RC_ASSERT(sameObjects(all, pathsOf(server.instances(Server::systemDevice))));
}

// A reference from an indicator names the class of the computer systems, not one of them; there is one for
// each.
RC_GTEST_PROP(Traversals, ofSystemDevicesAgreeFromTheIndicator, ())
{
    Server server(*Generators::inventories(), *Generators::computerSystems());
    const Server::Paths systems = server.names(Server::computerSystem);
    for (const cim::ObjectPath& device : server.names(Server::glimmark)) {
        checkForms(server, device, toSystem);
        RC_ASSERT(sameObjects(server.associatorNames(device, associatorsOf(toSystem)), systems));
        const Server::Instances references = server.references(device, referencesOf(toSystem));
        RC_ASSERT(references.size() == systems.size());
        for (const cim::Instance& reference : references) {
            RC_ASSERT(cim::sameObject(endOf(reference, "PartComponent"), device));
            const cim::ObjectPath system = endOf(reference, "GroupComponent");
            RC_ASSERT(system.className == Server::computerSystem);
            RC_ASSERT(system.keys.empty());
        }
    }
}

RC_GTEST_PROP(Traversals, areNotFilteredByRoles, ())
{
    const auto roles = rc::gen::maybe(Generators::texts());
    const auto role = [&]() -> std::optional<std::string> {
        const auto text = *roles;
        return text ? std::optional<std::string>(*text) : std::nullopt;
    };
    Server server(*Generators::inventories());
    const cim::ObjectPath system = server.names(Server::computerSystem).at(0);
    const cim::ObjectPath capabilities = server.names(Server::capabilities).at(0);
    for (const auto& [from, direction] :
         {std::pair(system, fromSystem), std::pair(capabilities, fromCapabilities)}) {
        const Traversal associators{direction.association, {}, role(), role()};
        RC_ASSERT(server.associators(from, associators) ==
                  server.associators(from, associatorsOf(direction)));
        const Traversal references{{}, direction.association, role(), {}};
        RC_ASSERT(server.references(from, references) == server.references(from, referencesOf(direction)));
    }
}

} // namespace
