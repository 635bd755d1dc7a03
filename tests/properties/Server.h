/// \file
/// A broker that serves all classes of the project, as a client sees it.
#ifndef TESTS_PROPERTIES_SERVER_H
#define TESTS_PROPERTIES_SERVER_H

#include "testing/MadeInventory.h"

#include "broker/Broker.h"

#include <map>
#include <string>
#include <vector>

namespace cimhost::cim {

// For the reports.
void showValue(const ObjectPath& path, std::ostream& stream);
void showValue(const Instance& instance, std::ostream& stream);

} // namespace cimhost::cim

/// Every request must succeed, and nothing that the providers do with the broker may be wrong: a property in
/// which it is, fails.
class Server
{
public:
    using Paths = cimhost::cim::ObjectPaths;
    using Instances = cimhost::cim::Instances;
    using Properties = cimhost::cim::PropertyList;

    static constexpr auto glimmark = "TAVRO_Glimmark";
    static constexpr auto capabilities = "TAVRO_GlimmarkCapabilities";
    static constexpr auto elementCapabilities = "TAVRO_GlimmarkElementCapabilities";
    static constexpr auto systemDevice = "TAVRO_GlimmarkSystemDevice";
    static constexpr auto computerSystem = "TAVRO_ComputerSystem";

    /// The four classes of the provider library.
    static const std::vector<std::string>& classes();

    explicit Server(const std::vector<MadeInventory::Node>& inventory,
                    const std::vector<std::string>& computerSystems = {"one"});
    ~Server();
    Server(const Server&) = delete;
    Server& operator=(const Server&) = delete;

    Paths names(const std::string& className);
    Instances instances(const std::string& className, const Properties& properties = {});
    Instances get(const cimhost::cim::ObjectPath& path, const Properties& properties = {});

    // The traversals of an association class from one object.

    Paths associatorNames(const cimhost::cim::ObjectPath& from, const cimhost::Traversal& traversal);
    Instances associators(const cimhost::cim::ObjectPath& from, const cimhost::Traversal& traversal,
                          const Properties& properties = {});
    Paths referenceNames(const cimhost::cim::ObjectPath& from, const cimhost::Traversal& traversal);
    Instances references(const cimhost::cim::ObjectPath& from, const cimhost::Traversal& traversal);

private:
    [[nodiscard]] cimhost::cim::Answer checked(cimhost::cim::Answer answer) const;

    std::vector<std::string> misuses_;
    cimhost::Broker broker_;
};

/// The value of a key as text; empty where there is none.
std::string keyOf(const cimhost::cim::ObjectPath& path, const std::string& key);

/// The path behind a reference of an association's instance.
cimhost::cim::ObjectPath endOf(const cimhost::cim::Instance& association, const std::string& reference);

/// The paths of instances, in order.
Server::Paths pathsOf(const Server::Instances& instances);

/// Whether the lists name the same objects in the same order.
bool sameObjects(const Server::Paths& a, const Server::Paths& b);

#endif
