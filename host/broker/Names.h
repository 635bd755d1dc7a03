/// \file
/// Names of classes, keys, properties and the like, which compare without regard to letter case.
#ifndef CIMHOST_BROKER_NAMES_H
#define CIMHOST_BROKER_NAMES_H

#include "cim/Values.h"

#include <algorithm>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <strings.h>

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

/// Names that are looked for in many places, such as those of a filter. A name is found in few steps, however many
/// there are.
class NameSet
{
public:
    explicit NameSet(std::vector<std::string> names)
        : names_(std::move(names)),
          sorted_(names_.begin(), names_.end())
    {
        std::sort(sorted_.begin(), sorted_.end(), &isLess);
    }
    NameSet(const NameSet&) = delete;
    NameSet& operator=(const NameSet&) = delete;

    [[nodiscard]] bool contains(std::string_view name) const
    {
        return std::binary_search(sorted_.begin(), sorted_.end(), name, &isLess);
    }

    /// Whether it was made of these, which end with a null pointer.
    [[nodiscard]] bool isOf(const char* const* names) const
    {
        for (const std::string& name : names_)
            if (*names == nullptr || name != *names++)
                return false;
        return *names == nullptr;
    }

private:
    static bool isLess(std::string_view a, std::string_view b)
    {
        const int order = strncasecmp(a.data(), b.data(), std::min(a.size(), b.size()));
        return order != 0 ? order < 0 : a.size() < b.size();
    }

    std::vector<std::string> names_;       ///< as they were given
    std::vector<std::string_view> sorted_; ///< the same
};

/// Drops the elements that have none of the names.
template <class Named>
void keepOnly(std::vector<Named>& list, const NameSet& names)
{
    list.erase(std::remove_if(list.begin(), list.end(),
                              [&](const Named& item) { return !names.contains(item.name); }),
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
