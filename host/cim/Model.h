/// \file
/// CIM objects as plain values: what the broker keeps behind its CMPI handles, what a request is
/// made of and what an answer consists of. No CMPI function table is needed to read or write them.
#ifndef CIMHOST_CIM_MODEL_H
#define CIMHOST_CIM_MODEL_H

#include "cim/SharedList.h"

#include <cmpidt.h>

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace cimhost::cim {

struct ObjectPath;
struct Instance;

/// A value of one of CIM's types: null, one scalar, or an array of scalars.
struct Value
{
    /// By the type: boolean as bool; uint8 to uint64 and char16 as uint64_t; sint8 to sint64 as
    /// int64_t; real32 and real64 as double; string and datetime as UTF-8 text; ref and embedded
    /// instance as shared, unchangeable objects. A monostate is a null element of an array.
    using Scalar = std::variant<std::monostate, bool, std::uint64_t, std::int64_t, double, std::string,
                                std::shared_ptr<const ObjectPath>, std::shared_ptr<const Instance>>;

    /// Never CMPI_chars: text is CMPI_string. CMPI_ARRAY is or-ed in for an array.
    CMPIType type = CMPI_null;
    /// No value at all; a typed null keeps its type. `items` is then empty.
    bool isNull = true;
    /// Exactly one item for a scalar, any number for an array.
    std::vector<Scalar> items;
};

/// A key of an object path. Names keep the letter case they were given; looking them up ignores it.
struct Key
{
    std::string name;
    Value value;
};

/// The path of an instance, or of a class when it has no keys.
struct ObjectPath
{
    std::string host;      ///< empty: not given
    std::string nameSpace; ///< such as root/cimv2; empty: not given
    std::string className;
    std::vector<Key> keys; ///< in the order in which they were added
};

struct Property
{
    std::string name;
    Value value;
};

struct Instance
{
    ObjectPath path;
    std::vector<Property> properties; ///< in the order in which they were set
};

/// The outcome of a request.
struct Status
{
    CMPIrc code = CMPI_RC_OK;
    std::optional<std::string> message; ///< the provider's own; nothing: it gave none
};

using ObjectPaths = SharedList<ObjectPath>;
using Instances = SharedList<Instance>;

/// What a request brought: the status, and the paths or instances that the provider returned, in
/// its order. A null object that a provider returned is reported as misuse and left out here.
struct Answer
{
    Status status;
    ObjectPaths paths;
    Instances instances;
};

/// Names of the properties wanted; nothing: all of them. An empty list: the keys only.
using PropertyList = std::optional<std::vector<std::string>>;

} // namespace cimhost::cim

#endif
