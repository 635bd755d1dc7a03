/// \file
/// What an XML document may have, counted before anything is built of it.
#ifndef CIMHOST_SERVE_XMLLIMITS_H
#define CIMHOST_SERVE_XMLLIMITS_H

#include <cstddef>
#include <string>
#include <string_view>

namespace cimhost::serve {

/// What a document may have at most.
struct XmlLimits
{
    std::size_t depth = 64;         ///< elements in each other; a reference in a reference takes four
    std::size_t elements = 20000;   ///< in the whole document
    std::size_t attributes = 60000; ///< in the whole document
    // The library looks through all of these at each further attribute or name: with a bound on them, what a byte
    // of the document costs is bounded too.
    std::size_t attributesOfElement = 100;
    std::size_t namespaces = 100; ///< declared by elements that are in each other
};

/// Counts what stands in the document in one pass over its bytes, before a parser sees it. It is no parser: what
/// is not well-formed is counted somehow, and never as less than what a parser sees before it stops.
/// \throws RequestError  tooLarge
void requireWithin(const XmlLimits& limits, std::string_view document);

/// "line 3, column 7: ", for messages, of a byte of the document.
std::string placeAt(std::string_view document, std::size_t position);

} // namespace cimhost::serve

#endif
