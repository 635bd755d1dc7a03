/// \file
/// Lets GoogleTest and RapidCheck show the model's values in what they report.
#ifndef CIMHOST_CIM_TESTS_PRINT_H
#define CIMHOST_CIM_TESTS_PRINT_H

#include "cim/Literal.h"
#include "cim/ObjectPathText.h"
#include "cim/Values.h"

#include <ostream>

namespace cimhost::cim {

inline std::ostream& operator<<(std::ostream& stream, const Value& value)
{
    return stream << typeName(value.type) << ' ' << literal(value);
}

inline std::ostream& operator<<(std::ostream& stream, const ObjectPath& path)
{
    return stream << toText(path);
}

} // namespace cimhost::cim

#endif
