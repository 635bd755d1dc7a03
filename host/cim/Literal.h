/// \file
/// Values in the notation of MOF.
#ifndef CIMHOST_CIM_LITERAL_H
#define CIMHOST_CIM_LITERAL_H

#include "cim/Model.h"

#include <string_view>

namespace cimhost::cim {

/// `NULL`, `TRUE`, `42`, `"text"`, `'c'`, `{1, 2}`; a reference as its quoted path, an embedded
/// instance as its quoted MOF. Never has a line end or another control character in it. The bytes of
/// a text that are not UTF-8 become U+FFFD; infinities and NaN, which MOF lacks, are written as C does.
std::string literal(const Value& value);

/// One item of a value of that type.
std::string literal(const Value::Scalar& item, CMPIType type);

/// A text with quotes around it and escapes in it.
std::string inQuotes(std::string_view text);

/// The shortest text that reads back as the same number, always with a point or an exponent.
std::string realText(double number);

} // namespace cimhost::cim

#endif
