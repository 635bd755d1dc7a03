/// \file
/// Lists of named values: the keys of a path, the properties of an instance, entries and arguments.
/// Each list's elements have a `name` and a `value`; names compare ignoring letter case.
#ifndef CIMHOST_BROKER_NAMEDVALUES_H
#define CIMHOST_BROKER_NAMEDVALUES_H

#include "broker/Call.h"
#include "broker/Names.h"
#include "broker/Values.h"

#include <string>
#include <utility>
#include <vector>

namespace cimhost {

/// Sets the value of that name, at its old place or at the end.
template <class Named>
void setNamed(std::vector<Named>& list, const char* name, cim::Value value)
{
    Named* const present = findNamed(list, name);
    if (present != nullptr)
        present->value = std::move(value);
    else
        list.push_back({name, std::move(value)});
}

/// The data of that name, with the flags `state`; CMPI_notFound and the status `missing` when there is
/// none.
template <class Named>
CMPIData getNamed(Call& call, const std::vector<Named>& list, const char* name, CMPIrc missing,
                  CMPIValueState state = CMPI_goodValue)
{
    const Named* const present = findNamed(list, call.text(name, "the name"));
    if (present == nullptr) {
        call.answerWith(missing);
        return noData();
    }
    return giveValue(call.core(), present->value, state);
}

/// The data at a place.
/// \param name  receives the name unless it is null
template <class Named>
CMPIData getNamedAt(Call& call, const std::vector<Named>& list, CMPICount index, CMPIString** name,
                    CMPIrc missing, CMPIValueState state = CMPI_goodValue)
{
    if (index >= list.size()) {
        call.answerWith(missing);
        return noData();
    }
    if (name != nullptr)
        *name = call.makeString(list[index].name);
    return giveValue(call.core(), list[index].value, state);
}

} // namespace cimhost

#endif
