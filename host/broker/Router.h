/// \file
/// Which provider serves a request.
#ifndef CIMHOST_BROKER_ROUTER_H
#define CIMHOST_BROKER_ROUTER_H

#include "broker/Core.h"
#include "broker/Provider.h"
#include "broker/Registration.h"
#include "cim/Model.h"

#include <map>
#include <memory>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

namespace cimhost {

/// A request that no provider can be asked.
class RoutingError : public std::runtime_error
{
public:
    RoutingError(CMPIrc code, const std::string& message) : std::runtime_error(message), code_(code) {}
    [[nodiscard]] CMPIrc code() const { return code_; }

private:
    CMPIrc code_;
};

/// Owns the providers. Safe to use from several threads at once.
class Router
{
public:
    Router(Core& core, Registration registration, std::vector<std::string> directories);

    [[nodiscard]] const Registration& registration() const { return registration_; }

    /// Whether anything serves exactly that class in a namespace.
    [[nodiscard]] bool isRegistered(const std::string& className, const std::string& nameSpace) const;

    /// What serves the instances of a class in a namespace. \throws RoutingError
    [[nodiscard]] const RegisteredClass& instanceClass(const std::string& className,
                                                       const std::string& nameSpace) const;
    /// The same with the classes that derive from it; none: the class is known, and nobody serves it.
    /// \throws RoutingError
    [[nodiscard]] std::vector<const RegisteredClass*> instanceClasses(const std::string& className,
                                                                      const std::string& nameSpace) const;
    /// What serves the traversals of an association class, and of those that derive from it, in a namespace;
    /// none as above. \throws RoutingError
    [[nodiscard]] std::vector<const RegisteredClass*> associationClasses(const std::string& className,
                                                                         const std::string& nameSpace) const;
    /// All that serves traversals in a namespace. \throws RoutingError
    [[nodiscard]] std::vector<const RegisteredClass*> associationClasses(const std::string& nameSpace) const;

    /// Who serves one of these.
    Provider& providerOf(const RegisteredClass& entry);

    /// Cleans up every provider; no request may come any more.
    void cleanUp();

private:
    [[nodiscard]] std::vector<const RegisteredClass*> findAll(const std::string& className,
                                                              const std::string& nameSpace,
                                                              bool RegisteredClass::*serves,
                                                              const char* type) const;
    [[noreturn]] void fail(const std::string& className, const std::string& nameSpace,
                           const char* type) const;
    void requireNameSpace(const std::string& nameSpace) const;

    Registration registration_;
    ProviderSurroundings surroundings_;
    /// By name and location.
    std::map<std::pair<std::string, std::string>, std::unique_ptr<Provider>> providers_;
};

} // namespace cimhost

#endif
