#include "broker/Router.h"

#include "cim/Values.h"

#include <algorithm>

namespace cimhost {

namespace {

bool isIn(const RegisteredClass& entry, const std::string& nameSpace)
{
    return std::any_of(entry.nameSpaces.begin(), entry.nameSpaces.end(),
                       [&](const std::string& name) { return cim::sameName(name, nameSpace); });
}

} // namespace

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

Provider& Router::instanceProvider(const std::string& className, const std::string& nameSpace)
{
    return find(className, nameSpace, &RegisteredClass::instance, "instance");
}

Provider& Router::associationProvider(const std::string& className, const std::string& nameSpace)
{
    return find(className, nameSpace, &RegisteredClass::association, "association");
}

std::vector<Provider*> Router::associationProviders(const std::string& nameSpace)
{
    requireNameSpace(nameSpace);
    std::vector<Provider*> found;
    for (const RegisteredClass& entry : registration_.classes) {
        if (!entry.association || !isIn(entry, nameSpace))
            continue;
        Provider* const provider = &providerOf(entry);
        if (std::find(found.begin(), found.end(), provider) == found.end())
            found.push_back(provider);
    }
    return found;
}

void Router::cleanUp()
{
    for (auto& [key, provider] : providers_)
        provider->cleanUp();
}

Provider& Router::find(const std::string& className, const std::string& nameSpace,
                       bool RegisteredClass::*serves, const char* type)
{
    requireNameSpace(nameSpace);
    bool known = false;
    for (const RegisteredClass& entry : registration_.classes) {
        if (!cim::sameName(entry.className, className) || !isIn(entry, nameSpace))
            continue;
        if (entry.*serves)
            return providerOf(entry);
        known = true;
    }
    if (known)
        throw RoutingError(CMPI_RC_ERR_NOT_SUPPORTED,
                           "no " + std::string(type) + " provider is registered for the class " + className);
    throw RoutingError(CMPI_RC_ERR_INVALID_CLASS,
                       "no provider is registered for the class " + className + " in " + nameSpace);
}

void Router::requireNameSpace(const std::string& nameSpace) const
{
    const auto& classes = registration_.classes;
    if (std::none_of(classes.begin(), classes.end(),
                     [&](const RegisteredClass& entry) { return isIn(entry, nameSpace); }))
        throw RoutingError(CMPI_RC_ERR_INVALID_NAMESPACE,
                           nameSpace.empty() ? "the path names no namespace"
                                             : "no registration names the namespace " + nameSpace);
}

Provider& Router::providerOf(const RegisteredClass& entry)
{
    return *providers_.at({entry.provider, entry.location});
}

} // namespace cimhost
