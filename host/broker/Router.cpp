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
    return find(className, nameSpace, &RegisteredClass::instance, "instance");
}

const RegisteredClass& Router::associationClass(const std::string& className,
                                                const std::string& nameSpace) const
{
    return find(className, nameSpace, &RegisteredClass::association, "association");
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

const RegisteredClass& Router::find(const std::string& className, const std::string& nameSpace,
                                    bool RegisteredClass::*serves, const char* type) const
{
    requireNameSpace(nameSpace);
    bool known = false;
    std::vector<std::string> names;
    for (const RegisteredClass& entry : registration_.classes) {
        if (!isRegisteredIn(entry, nameSpace))
            continue;
        names.push_back(entry.className);
        if (!cim::sameName(entry.className, className))
            continue;
        if (entry.*serves)
            return entry;
        known = true;
    }
    if (known)
        throw RoutingError(CMPI_RC_ERR_NOT_SUPPORTED,
                           "no " + std::string(type) + " provider is registered for the class " + className);
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
