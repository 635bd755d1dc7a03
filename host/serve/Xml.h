/// \file
/// An XML document as a tree, read without trusting it.
#ifndef CIMHOST_SERVE_XML_H
#define CIMHOST_SERVE_XML_H

#include "serve/XmlLimits.h"

#include <string>
#include <string_view>
#include <vector>

namespace cimhost::serve {

struct Attribute
{
    std::string name;
    std::string value;
};

struct Element
{
    std::string name;
    int line = 0; ///< of its start tag, from 1
    std::vector<Attribute> attributes;
    std::vector<Element> children;
    std::string text; ///< all that stands directly in it, references and CDATA sections resolved
};

/// Reads a document in UTF-8 that is within the limits. Nothing is read besides it, and no entity but XML's own
/// five is known: a document type declaration ends the reading at once.
/// \param isKnown  an element for which it is false is left out, with all that is in it
/// \throws RequestError  notWellFormed, notValid or tooLarge; notLooselyValid when nothing is left
Element parseXml(std::string_view document, const XmlLimits& limits, bool (*isKnown)(std::string_view name));

} // namespace cimhost::serve

#endif
