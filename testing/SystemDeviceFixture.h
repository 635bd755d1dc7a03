/// \file
/// What the tests of the association TAVRO_GlimmarkSystemDevice share.
#ifndef TESTING_SYSTEMDEVICEFIXTURE_H
#define TESTING_SYSTEMDEVICEFIXTURE_H

#include "EntryPoints.h"
#include "testing/AssociationFixture.h"

#include <Tavro/Common.h>

#include <memory>
#include <string>
#include <utility>
#include <variant>
#include <vector>

namespace SystemDevice {

inline constexpr auto association = "TAVRO_GlimmarkSystemDevice";
inline constexpr auto module = "GlimmarkSystemDeviceProvider";

using Recorded::joined;
using Recorded::statusText;
using Recorded::Texts;

/// The line of a failed enumeration of the computer systems, as Logged::lines() gives it.
inline const std::string enumerationFailed =
    "6000 Mavrel.GlimmarkSystemDeviceProvider MESSAGE [File: GlimmarkSystemDeviceProvider.cpp, Line]: "
    "Call to CBEnumInstances of target Class Failed.";

/// The broker's trace of a failure.
inline std::string warning(const std::string& text)
{
    return Recorded::warning(module, text);
}

/// The path that a key or property of one of the types refers to; fails the test where there is none.
template <class Items>
cimhost::cim::ObjectPath referenceAmong(const Items& items, const std::string& name)
{
    using Reference = std::shared_ptr<const cimhost::cim::ObjectPath>;
    for (const auto& item : items) {
        if (item.name != name || item.value.type != CMPI_ref || item.value.isNull)
            continue;
        return *std::get<Reference>(item.value.items.at(0));
    }
    ADD_FAILURE() << "no reference " << name;
    return {};
}

/// Both ends as "SYSTEM DEVICE", the first by its Name and the second by its DeviceID.
template <class Items>
std::string pairAmong(const Items& items)
{
    return valueOf(referenceAmong(items, "GroupComponent"), "Name") + " " +
           valueOf(referenceAmong(items, "PartComponent"), "DeviceID");
}

inline std::vector<std::string> pairsOf(const cimhost::cim::ObjectPaths& paths)
{
    std::vector<std::string> pairs;
    pairs.reserve(paths.size());
    for (const auto& path : paths)
        pairs.push_back(pairAmong(path.keys));
    return pairs;
}

inline std::vector<std::string> pairsOf(const cimhost::cim::Instances& instances)
{
    std::vector<std::string> pairs;
    pairs.reserve(instances.size());
    for (const auto& instance : instances)
        pairs.push_back(pairAmong(instance.properties));
    return pairs;
}

/// A registration that says nothing.
inline cimhost::Registration nobody()
{
    return {};
}

/// One that names a library for TAVRO_ComputerSystem that cannot be loaded.
inline cimhost::Registration unloadable()
{
    cimhost::RegisteredClass entry;
    entry.className = "TAVRO_ComputerSystem";
    entry.provider = "TavroComputerSystemProvider";
    entry.location = "NoSuchLibrary";
    entry.instance = true;
    entry.nameSpaces = {"root/test"};
    return {{entry}};
}

/// With two indicators unless a test makes others.
class Fixture : public AssociationFixture
{
protected:
    Fixture() { MadeInventory::set({{"b", "2"}, {"a", "1"}}); }
    explicit Fixture(cimhost::Registration registration) : AssociationFixture(std::move(registration))
    {
        MadeInventory::set({{"b", "2"}, {"a", "1"}});
    }
};

} // namespace SystemDevice

#endif
