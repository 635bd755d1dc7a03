/// \file
/// Names of classes, keys, properties and the like, which compare without regard to letter case.
#ifndef CIMHOST_BROKER_NAMES_H
#define CIMHOST_BROKER_NAMES_H

#include "cim/Values.h"

#include <algorithm>
#include <string>
#include <string_view>
#include <vector>

namespace cimhost {

/// The element with that `name`; null when there is none.
template <class Named>
const Named* findNamed(const std::vector<Named>& list, std::string_view name)
{
    const auto found = std::find_if(list.begin(), list.end(),
                                    [&](const Named& item) { return cim::sameName(item.name, name); });
    return found == list.end() ? nullptr : &*found;
}

template <class Named>
Named* findNamed(std::vector<Named>& list, std::string_view name)
{
    const auto found = std::find_if(list.begin(), list.end(),
                                    [&](const Named& item) { return cim::sameName(item.name, name); });
    return found == list.end() ? nullptr : &*found;
}

inline bool contains(const std::vector<std::string>& names, std::string_view name)
{
    return std::any_of(names.begin(), names.end(),
                       [&](const std::string& listed) { return cim::sameName(listed, name); });
}

/// Drops the elements that have none of the names.
template <class Named>
void keepOnly(std::vector<Named>& list, const std::vector<std::string>& names)
{
    list.erase(std::remove_if(list.begin(), list.end(),
                              [&](const Named& item) { return !contains(names, item.name); }),
               list.end());
}

/// Names as CMPI passes them: an array of character pointers that ends with a null pointer; null for
/// no names at all. The names must outlive it.
class NameArray
{
public:
    explicit NameArray(const cim::PropertyList& names)
    {
        if (!names)
            return;
        for (const std::string& name : *names)
            pointers_.push_back(name.c_str());
        pointers_.push_back(nullptr);
    }

    const char** get() { return pointers_.empty() ? nullptr : pointers_.data(); }

private:
    std::vector<const char*> pointers_;
};

} // namespace cimhost

#endif
