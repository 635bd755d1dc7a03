#include "serve/PropertyLists.h"

#include "cim/Values.h"

#include <algorithm>

namespace cimhost::serve {

PropertyLists::PropertyLists(const schema::Classes& classes, const Registration& registration)
    : areAllKnown_(std::all_of(
          registration.classes.begin(), registration.classes.end(),
          [&](const RegisteredClass& served) { return classes.find(served.className) != nullptr; }))
{
    for (const schema::Class* const declaration : classes.subclassesOf("", true))
        for (const schema::Property& property : declaration->properties) {
            declared_.insert(property.name);
            inLowerCase_.insert(cim::lowerCase(property.name));
        }
}

void PropertyLists::shorten(cim::PropertyList& list) const
{
    if (!list || list->empty())
        return;
    const std::string first = list->front();
    // A name as its class spells it is kept beside another spelling, as providers look for it so.
    std::set<std::string> given;
    const auto isDropped = [&](const std::string& name) {
        return !isMeaningful(name) ||
               !given.insert(declared_.count(name) != 0 ? name : ' ' + cim::lowerCase(name)).second;
    };
    list->erase(std::remove_if(list->begin(), list->end(), isDropped), list->end());
    if (list->empty()) // an empty one is not for all brokers one that nothing is found for
        list->push_back(first);
}

bool PropertyLists::isMeaningful(const std::string& name) const
{
    return !areAllKnown_ || inLowerCase_.count(cim::lowerCase(name)) != 0;
}

} // namespace cimhost::serve
