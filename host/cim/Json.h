/// \file
/// Answers in JSON, for programs.
///
///     {
///       "status": { "code": 0, "name": "CMPI_RC_OK", "message": null },
///       "paths": [ PATH, ... ],
///       "instances": [ { "path": PATH, "properties": { NAME: VALUE, ... } }, ... ]
///     }
///
/// A PATH is an object with "text" (as the command line takes it), "host" and "namespace" (null where
/// there is none), "className" and "keys" (NAME: VALUE). A VALUE is null, true or false, a number, a
/// string or an array of these; a reference is a PATH, an embedded instance as under "instances", a
/// char16 its number. Infinities and NaN, which JSON lacks, are strings.
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
