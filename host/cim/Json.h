/// \file
/// CIM objects in JSON, for programs.
///
/// A value is null, true or false, a number, a string or an array of these; a reference is a path, an
/// embedded instance an instance, a char16 its number. Infinities and NaN, which JSON lacks, are strings.
///
///     path:      { "text": as a command line takes it, "host": STRING or null,
///                  "namespace": STRING or null, "className": STRING, "keys": { NAME: value, ... } }
///     instance:  { "path": path, "properties": { NAME: value, ... } }
///     status:    { "code": NUMBER, "name": STRING, "message": STRING or null }
#ifndef CIMHOST_CIM_JSON_H
#define CIMHOST_CIM_JSON_H

#include "cim/Model.h"

#include <nlohmann/json.hpp>

namespace cimhost::cim {

using Json = nlohmann::ordered_json;

Json toJson(const Value& value);
Json toJson(const ObjectPath& path);
Json toJson(const Instance& instance);
Json toJson(const Status& status);

/// The text of a document, in ASCII and over several lines: nothing in it acts on a terminal. Bytes
/// that are not UTF-8 become U+FFFD.
std::string toText(const Json& document);

} // namespace cimhost::cim

#endif
