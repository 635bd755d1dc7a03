/// \file
/// A CMPI 2.0 broker in one process: it loads the providers that a registration names, hands them
/// requests and gives their answers back as plain values (cim/Model.h). It knows the CMPI interface
/// and nothing of any provider.
#ifndef CIMHOST_BROKER_BROKER_H
#define CIMHOST_BROKER_BROKER_H

#include "broker/FunctionTables.h"
#include "broker/Registration.h"
#include "cim/Model.h"
#include "schema/Classes.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <cmpift.h>

namespace cimhost {

/// One call of the broker's encapsulated `trace` service by a provider.
struct TraceRecord
{
    CMPILevel level;
    std::string component; ///< empty also for a null one
    std::string text;      ///< the text, or that of the string object given instead
};

/// One call of the broker's `logMessage` service by a provider.
struct LogRecord
{
    CMPISeverity severity;
    std::string id;
    std::string text;
};

/// Where the broker tells what it sees. All are called on the thread of the request, never two at
/// a time; an empty function means that nobody wants to know.
struct Listeners
{
    std::function<void(const TraceRecord&)> trace;
    std::function<void(const LogRecord&)> log;
    /// A provider's breach of the interface, in one line: what it did with which service. The call
    /// was answered with a status code (CMPI_RC_ERR_INVALID_HANDLE for a null, released or earlier
    /// request's object) and had no other effect.
    std::function<void(const std::string&)> misuse;
};

/// Arguments of the four traversal operations; nothing: a null argument.
struct Traversal
{
    std::optional<std::string> assocClass;
    std::optional<std::string> resultClass;
    std::optional<std::string> role;
    std::optional<std::string> resultRole;
};

bool operator==(const Traversal& a, const Traversal& b);

struct Habits;

/// The broker. Requests may come from several threads at once. Each request is answered by the
/// provider registered for the class (letter case ignored) and namespace of its path, an enumeration by
/// those of the classes that derive from it too, each asked for its own class; a class that is not known
/// and nobody serves is answered with CMPI_RC_ERR_INVALID_CLASS, a namespace that no registration names
/// with CMPI_RC_ERR_INVALID_NAMESPACE, a provider that could not be loaded with CMPI_RC_ERR_FAILED
/// and the reason. Providers are loaded on first use and cleaned up and unloaded with the broker.
class Broker
{
public:
    /// \param registration  what serves which class
    /// \param providerDirectories  searched in order for libLOCATION.so
    /// \param habits  of a real broker, which this one takes on (Habits.h); they must outlive it. Null: none
    /// \param classes  what derives from what, and what the keys are, as far as it is known
    Broker(Registration registration, std::vector<std::string> providerDirectories, Listeners listeners = {},
           const Habits* habits = nullptr, schema::Classes classes = {});
    ~Broker();
    Broker(const Broker&) = delete;
    Broker& operator=(const Broker&) = delete;

    cim::Answer enumerateInstanceNames(const cim::ObjectPath& classPath);
    cim::Answer enumerateInstances(const cim::ObjectPath& classPath,
                                   const cim::PropertyList& properties = {});
    /// An answer without an instance and without an error is CMPI_RC_ERR_NOT_FOUND, as real brokers have it.
    cim::Answer getInstance(const cim::ObjectPath& path, const cim::PropertyList& properties = {});
    cim::Answer createInstance(const cim::ObjectPath& classPath, const cim::Instance& instance);
    cim::Answer modifyInstance(const cim::ObjectPath& path, const cim::Instance& instance,
                               const cim::PropertyList& properties = {});
    cim::Answer deleteInstance(const cim::ObjectPath& path);
    cim::Answer execQuery(const cim::ObjectPath& classPath, const std::string& query,
                          const std::string& language);

    /// The traversals ask the provider of `assocClass` (of `resultClass` for the references); without
    /// one, every association provider registered for the namespace, each with a null class, and join
    /// the answers; the first error among them becomes the status. A superclass stands for the registered
    /// classes that derive from it: without habits, each provider is asked for its own association class, and
    /// for results of any class, of which those of the superclass and of unknown classes are taken.
    cim::Answer associators(const cim::ObjectPath& path, const Traversal& traversal,
                            const cim::PropertyList& properties = {});
    cim::Answer associatorNames(const cim::ObjectPath& path, const Traversal& traversal);
    cim::Answer references(const cim::ObjectPath& path, const Traversal& traversal,
                           const cim::PropertyList& properties = {});
    cim::Answer referenceNames(const cim::ObjectPath& path, const Traversal& traversal);

    [[nodiscard]] const Registration& registration() const;
    [[nodiscard]] const schema::Classes& classes() const;

    /// The broker as a provider sees it, for driving a provider's function tables by hand.
    [[nodiscard]] const CMPIBroker* cmpiBroker() const;

    /// The tables that this broker and all its objects answer through. A layer over the broker, one
    /// that records calls or lets them fail, puts its own functions into them before the first request.
    FunctionTables& tables();

private:
    friend class Request;
    class Implementation;
    std::unique_ptr<Implementation> implementation_;
};

/// A request in the broker's own terms, for driving a provider's function tables by hand: the objects
/// that are made on this thread while it exists belong to it and end with it. Requests of a thread nest: the
/// one made last ends first.
class Request
{
public:
    explicit Request(Broker& broker);
    ~Request();
    Request(const Request&) = delete;
    Request& operator=(const Request&) = delete;

    const CMPIContext* context();
    const CMPIResult* result();
    /// A handle for a path, an instance; owned by the request.
    CMPIObjectPath* path(const cim::ObjectPath& path);
    CMPIInstance* instance(const cim::Instance& instance);

    /// What the provider has returned through `result()` so far, with the provider's own status read
    /// into it.
    /// \param status  what the operation returned; its message is read while the request lives
    [[nodiscard]] cim::Answer answer(const CMPIStatus& status) const;
    /// How often the provider has called returnDone.
    [[nodiscard]] int doneCount() const;

private:
    class Implementation;
    std::unique_ptr<Implementation> implementation_;
};

/// Reads what an object of this broker holds, for tests and listeners. Null for a null, foreign or
/// dead object.
std::optional<cim::ObjectPath> read(const CMPIObjectPath* path);
std::optional<cim::Instance> read(const CMPIInstance* instance);
std::optional<std::string> read(const CMPIString* string);

} // namespace cimhost

#endif
