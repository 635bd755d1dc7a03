/// \file
/// Declarations of classes as XML elements.
#ifndef CIMHOST_SERVE_CLASSWRITER_H
#define CIMHOST_SERVE_CLASSWRITER_H

#include "schema/MofReader.h"
#include "serve/XmlWriter.h"

namespace cimhost::serve {

/// CLASS, with the qualifiers and origins that the declaration has.
void writeClass(XmlWriter& xml, const schema::Class& declaration);

} // namespace cimhost::serve

#endif
