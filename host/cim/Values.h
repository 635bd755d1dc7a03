/// \file
/// What every user of the model needs: making values, comparing them, finding them by name.
#ifndef CIMHOST_CIM_VALUES_H
#define CIMHOST_CIM_VALUES_H

#include "cim/Model.h"

#include <string>
#include <string_view>

namespace cimhost::cim {

Value booleanValue(bool value);
/// \param type  an integer type; its values are the caller's care
Value unsignedValue(std::uint64_t value, CMPIType type = CMPI_uint64);
/// \param type  a signed integer type
Value signedValue(std::int64_t value, CMPIType type = CMPI_sint64);
Value realValue(double value, CMPIType type = CMPI_real64);
/// \param type  CMPI_string or CMPI_dateTime
Value textValue(std::string value, CMPIType type = CMPI_string);
Value referenceValue(ObjectPath path);
Value instanceValue(Instance instance);
Value nullValue(CMPIType type);
/// \param elementType  without CMPI_ARRAY, which is added here
Value arrayValue(CMPIType elementType, std::vector<Value::Scalar> items);

/// Equal in every detail: names letter by letter, keys and properties in order, references and
/// embedded instances by what they hold. Numbers of different types differ.
bool operator==(const Value& a, const Value& b);
bool operator==(const ObjectPath& a, const ObjectPath& b);
bool operator==(const Instance& a, const Instance& b);
bool operator!=(const Value& a, const Value& b);
bool operator!=(const ObjectPath& a, const ObjectPath& b);
bool operator!=(const Instance& a, const Instance& b);

/// CIM names (of classes, keys, properties, namespaces) are the same whatever their letter case.
bool sameName(std::string_view a, std::string_view b);

/// With capital letters of ASCII, the only ones that names have, as small ones.
std::string lowerCase(std::string text);

/// Equal as a key is: integers by their number, whatever their width; a datetime as its text;
/// references as sameObject(); everything else exactly.
bool sameKeyValue(const Value& a, const Value& b);

/// Whether both paths name the same object: the same class and keys, in any order and letter case of
/// names. Hosts take no part, and a missing namespace is anyone's.
bool sameObject(const ObjectPath& a, const ObjectPath& b);

/// What to look paths up by: equal for paths that are sameObject(). Others may share it too, where they
/// differ in the namespace or in keys that are real numbers, arrays or embedded instances.
std::string lookupText(const ObjectPath& path);

/// The value of that name; null: there is none.
const Value* findKey(const ObjectPath& path, std::string_view name);
const Value* findProperty(const Instance& instance, std::string_view name);

/// The type in MOF: "uint16", "string", "uint16[]"; "ref" for a reference, "instance" for an embedded
/// instance, "null" for no type, "type 0x1234" for one that no value can have.
std::string typeName(CMPIType type);

bool isArray(const Value& value);

} // namespace cimhost::cim

#endif
