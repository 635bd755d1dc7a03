/// \file
#ifndef TAVRO_QUOTEDNAMES_H
#define TAVRO_QUOTEDNAMES_H

#include <string>

namespace Tavro {

/// The members `name` of all items, quoted and separated by commas.
template <class Items>
std::string quotedNames(const Items& items)
{
    std::string list;
    for (const auto& item : items) {
        if (!list.empty())
            list += ", ";
        list.append(1, '"').append(item.name).append(1, '"');
    }
    return list;
}

} // namespace Tavro

#endif
