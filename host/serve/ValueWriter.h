/// \file
/// CIM objects as XML elements.
#ifndef CIMHOST_SERVE_VALUEWRITER_H
#define CIMHOST_SERVE_VALUEWRITER_H

#include "cim/Model.h"
#include "schema/Classes.h"
#include "serve/XmlWriter.h"

#include <stdexcept>
#include <string>

namespace cimhost::serve {

/// A value for which CIM-XML has no form, such as a key that is null.
class UnwritableError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// INSTANCENAME: class and keys. \throws UnwritableError
void writeInstanceName(XmlWriter& xml, const cim::ObjectPath& path);

/// INSTANCEPATH: host, namespace, class and keys. \throws UnwritableError
void writeInstancePath(XmlWriter& xml, const cim::ObjectPath& path);

/// INSTANCE: class and properties. \param origins  null: where properties come from is not told
/// \throws UnwritableError
void writeInstance(XmlWriter& xml, const cim::Instance& instance, const schema::Classes* origins = nullptr);

} // namespace cimhost::serve

#endif
