#include "Server.h"

#include "testing/RecordedLog.h"

#include "cim/Json.h"
#include "cim/ObjectPathText.h"
#include "cim/Values.h"

#include <algorithm>
#include <cstdlib>
#include <utility>

#include <rapidcheck.h>

namespace cim = cimhost::cim;

namespace cimhost::cim {

void showValue(const ObjectPath& path, std::ostream& stream)
{
    stream << toText(path);
}

void showValue(const Instance& instance, std::ostream& stream)
{
    stream << toText(instance.path) << " with";
    for (const Property& property : instance.properties)
        stream << ' ' << property.name;
}

} // namespace cimhost::cim

namespace {

cimhost::Registration allProviders()
{
    cimhost::Registration all;
    for (const char* file : {TEST_REGISTRATION, TEST_COMPUTER_SYSTEM_REGISTRATION}) {
        const cimhost::Registration one = cimhost::readRegistrationFile(file);
        all.classes.insert(all.classes.end(), one.classes.begin(), one.classes.end());
    }
    return all;
}

std::string joined(const std::vector<std::string>& names)
{
    std::string list;
    for (const std::string& name : names)
        list += (list.empty() ? "" : ",") + name;
    return list;
}

cim::ObjectPath classPath(const std::string& className)
{
    return {"", "root/cimv2", className, {}};
}

} // namespace

const std::vector<std::string>& Server::classes()
{
    static const std::vector<std::string> names{glimmark, capabilities, elementCapabilities, systemDevice};
    return names;
}

Server::Server(const std::vector<MadeInventory::Node>& inventory,
               const std::vector<std::string>& computerSystems)
    : broker_(allProviders(), {TEST_PROVIDER_DIRECTORY},
              {{}, {}, [this](const std::string& misuse) { misuses_.push_back(misuse); }})
{
    RecordedLog::keep(false);
    MadeInventory::set(inventory);
    ::setenv("TAVRO_COMPUTER_SYSTEMS", joined(computerSystems).c_str(), 1);
}

Server::~Server()
{
    RecordedLog::keep(true);
}

Server::Paths Server::names(const std::string& className)
{
    return checked(broker_.enumerateInstanceNames(classPath(className))).paths;
}

Server::Instances Server::instances(const std::string& className, const Properties& properties)
{
    return checked(broker_.enumerateInstances(classPath(className), properties)).instances;
}

Server::Instances Server::get(const cim::ObjectPath& path, const Properties& properties)
{
    return checked(broker_.getInstance(path, properties)).instances;
}

Server::Paths Server::associatorNames(const cim::ObjectPath& from, const cimhost::Traversal& traversal)
{
    return checked(broker_.associatorNames(from, traversal)).paths;
}

Server::Instances Server::associators(const cim::ObjectPath& from, const cimhost::Traversal& traversal,
                                      const Properties& properties)
{
    return checked(broker_.associators(from, traversal, properties)).instances;
}

Server::Paths Server::referenceNames(const cim::ObjectPath& from, const cimhost::Traversal& traversal)
{
    return checked(broker_.referenceNames(from, traversal)).paths;
}

Server::Instances Server::references(const cim::ObjectPath& from, const cimhost::Traversal& traversal)
{
    return checked(broker_.references(from, traversal)).instances;
}

cim::Answer Server::checked(cim::Answer answer) const
{
    RC_ASSERT(answer.status.code == CMPI_RC_OK);
    RC_ASSERT(misuses_ == std::vector<std::string>());
    RC_ASSERT(MadeInventory::openCursors() == 0);
    return answer;
}

std::string keyOf(const cim::ObjectPath& path, const std::string& key)
{
    const cim::Value* const value = cim::findKey(path, key);
    const auto* const text =
        value == nullptr || value->isNull ? nullptr : std::get_if<std::string>(&value->items.at(0));
    return text == nullptr ? "" : *text;
}

cim::ObjectPath endOf(const cim::Instance& association, const std::string& reference)
{
    const cim::Value* const value = cim::findProperty(association, reference);
    RC_ASSERT(value != nullptr);
    RC_ASSERT(value->type == CMPI_ref && !value->isNull);
    return *std::get<std::shared_ptr<const cim::ObjectPath>>(value->items.at(0));
}

Server::Paths pathsOf(const Server::Instances& instances)
{
    Server::Paths paths;
    for (const cim::Instance& instance : instances)
        paths.push_back(instance.path);
    return paths;
}

bool sameObjects(const Server::Paths& a, const Server::Paths& b)
{
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), cim::sameObject);
}
