/// \file
/// CIM objects out of their XML elements.
#ifndef CIMHOST_SERVE_VALUEREADER_H
#define CIMHOST_SERVE_VALUEREADER_H

#include "cim/Model.h"
#include "schema/Classes.h"
#include "serve/Xml.h"

#include <cstdint>
#include <stdexcept>
#include <string>

namespace cimhost::serve {

/// An element that the DTD allows and that cannot be taken, such as a number out of its type's range.
class ValueError : public std::runtime_error
{
public:
    ValueError(const Element& element, const std::string& found, const std::string& expected);
    ValueError(CMPIrc code, const std::string& message);

    /// The status for it, CMPI_RC_ERR_INVALID_PARAMETER unless another was given.
    [[nodiscard]] CMPIrc code() const noexcept { return code_; }

private:
    CMPIrc code_;
};

/// \param element  LOCALNAMESPACEPATH
std::string readNameSpace(const Element& element);

/// \param element  INSTANCENAME. A key's type is that of its TYPE; without one string, boolean, or the
/// widest type that a number needs. The only key may have no name, which is then empty.
/// \throws ValueError
cim::ObjectPath readInstanceName(const Element& element);

/// Gives the keys the types that the class declares, as far as it is known and their values are of these
/// types, and the only key its name. \throws ValueError  for a key without a name where the class is not
/// known or has several
void typeKeys(cim::ObjectPath& path, const schema::Classes& classes);

/// \param element   INSTANCE
/// \param limits    of the documents that embedded instances are
/// \throws ValueError
cim::Instance readInstance(const Element& element, const XmlLimits& limits);

/// \param element  VALUE  \throws ValueError
bool readBoolean(const Element& element);
std::uint32_t readUnsigned(const Element& element);

} // namespace cimhost::serve

#endif
