/// \file
/// CIM objects out of their XML elements.
#ifndef CIMHOST_SERVE_VALUEREADER_H
#define CIMHOST_SERVE_VALUEREADER_H

#include "cim/Model.h"
#include "serve/Xml.h"

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
/// widest type that a number needs.
/// \throws ValueError  also for a key without a name, which only a class repository could tell
cim::ObjectPath readInstanceName(const Element& element);

/// \param element   INSTANCE
/// \param limits    of the documents that embedded instances are
/// \throws ValueError
cim::Instance readInstance(const Element& element, const XmlLimits& limits);

/// \param element  VALUE  \throws ValueError
bool readBoolean(const Element& element);

} // namespace cimhost::serve

#endif
