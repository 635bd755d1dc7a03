#include "broker/Router.h"

#include "cim/Nearest.h"
#include "cim/Values.h"

#include <algorithm>

namespace cimhost {

Router::Router(Core& core, Registration registration, std::vector<std::string> directories)
    : registration_(std::move(registration)),
      surroundings_{core, std::move(directories), {}}
{
    for (const RegisteredClass& entry : registration_.classes) {
        std::unique_ptr<Provider>& provider = providers_[{entry.provider, entry.location}];
        if (provider == nullptr)
            provider = std::make_unique<Provider>(surroundings_, entry.provider, entry.location);
    }
}

const RegisteredClass& Router::instanceClass(const std::string& className, const std::string& nameSpace) const
{
    requireNameSpace(nameSpace);
    for (const RegisteredClass& entry : registration_.classes)
        if (entry.instance && cim::sameName(entry.className, className) && isRegisteredIn(entry, nameSpace))
            return entry;
    fail(className, nameSpace, "instance");
}

std::vector<const RegisteredClass*> Router::instanceClasses(const std::string& className,
                                                            const std::string& nameSpace) const
{
    return findAll(className, nameSpace, &RegisteredClass::instance, "instance");
}

std::vector<const RegisteredClass*> Router::associationClasses(const std::string& className,
                                                               const std::string& nameSpace) const
{
    return findAll(className, nameSpace, &RegisteredClass::association, "association");
}

std::vector<const RegisteredClass*> Router::associationClasses(const std::string& nameSpace) const
{
    requireNameSpace(nameSpace);
    std::vector<const RegisteredClass*> found;
    for (const RegisteredClass& entry : registration_.classes)
        if (entry.association && isRegisteredIn(entry, nameSpace))
            found.push_back(&entry);
    return found;
}

void Router::cleanUp()
{
    for (auto& [key, provider] : providers_)
        provider->cleanUp();
}

std::vector<const RegisteredClass*> Router::findAll(const std::string& className,
                                                    const std::string& nameSpace,
                                                    bool RegisteredClass::*serves, const char* type) const
{
    requireNameSpace(nameSpace);
    std::vector<const RegisteredClass*> found;
    const auto isFound = [&](const RegisteredClass& entry) {
        return std::any_of(found.begin(), found.end(), [&](const RegisteredClass* other) {
            return cim::sameName(other->className, entry.className);
        });
    };
    for (const RegisteredClass& entry : registration_.classes)
        if (entry.*serves && isRegisteredIn(entry, nameSpace) && !isFound(entry) &&
            surroundings_.core.classes.isA(entry.className, className))
            found.push_back(&entry);
    if (found.empty() &&
        (isRegistered(className, nameSpace) || surroundings_.core.classes.find(className) == nullptr))
        fail(className, nameSpace, type);
    return found;
}

bool Router::isRegistered(const std::string& className, const std::string& nameSpace) const
{
    return std::any_of(
        registration_.classes.begin(), registration_.classes.end(), [&](const RegisteredClass& entry) {
            return cim::sameName(entry.className, className) && isRegisteredIn(entry, nameSpace);
        });
}

void Router::fail(const std::string& className, const std::string& nameSpace, const char* type) const
{
    if (isRegistered(className, nameSpace) || surroundings_.core.classes.find(className) != nullptr)
        throw RoutingError(CMPI_RC_ERR_NOT_SUPPORTED,
                           "no " + std::string(type) + " provider is registered for the class " + className);
    std::vector<std::string> names;
    for (const RegisteredClass& entry : registration_.classes)
        if (isRegisteredIn(entry, nameSpace))
            names.push_back(entry.className);
    throw RoutingError(CMPI_RC_ERR_INVALID_CLASS, "no provider is registered for the class " + className +
                                                      " in " + nameSpace + cim::didYouMean(className, names));
}

void Router::requireNameSpace(const std::string& nameSpace) const
{
    const auto& classes = registration_.classes;
    if (std::none_of(classes.begin(), classes.end(),
                     [&](const RegisteredClass& entry) { return isRegisteredIn(entry, nameSpace); }))
        throw RoutingError(CMPI_RC_ERR_INVALID_NAMESPACE,
                           nameSpace.empty() ? "the path names no namespace"
                                             : "no registration names the namespace " + nameSpace);
}

Provider& Router::providerOf(const RegisteredClass& entry)
{
    return *providers_.at({entry.provider, entry.location});
}

} // namespace cimhost
