/// \file
/// Numbers as text.
#ifndef CIMHOST_CIM_NUMBER_H
#define CIMHOST_CIM_NUMBER_H

#include "cim/Model.h"

#include <optional>
#include <string_view>

namespace cimhost::cim {

/// A decimal number, in the widest type that it needs: CMPI_uint64, CMPI_sint64 if it is negative,
/// CMPI_real64 if it has a point or an exponent. Nothing: the text is not all of a number, or the number
/// does not fit in 64 bits.
std::optional<Value> parseNumber(std::string_view text);

} // namespace cimhost::cim

#endif
