/// \file
/// What the elements of CIM-XML have in them: the rules of DMTF DSP0203, the DTD of DMTF DSP0201, as
/// questions to an element. What an element lacks is a RequestError, notLooselyValid.
#ifndef CIMHOST_SERVE_DTD_H
#define CIMHOST_SERVE_DTD_H

#include "serve/Xml.h"

#include <initializer_list>
#include <string>
#include <string_view>

namespace cimhost::serve {

/// Whether the DTD has an element of that name. What it does not know is to be ignored.
bool isKnownElement(std::string_view name);

/// "line 4, NAME", for messages.
std::string placeOf(const Element& element);

/// Null: there is none.
const std::string* findAttribute(const Element& element, std::string_view name);
const std::string& attribute(const Element& element, std::string_view name);

using Names = std::initializer_list<std::string_view>;

bool isOneOf(const Element& element, Names names);

/// The only child, which is one of these.
const Element& onlyChild(const Element& element, Names names);
/// Null: there is none.
const Element* optionalChild(const Element& element, Names names);
/// All children are among these.
const std::vector<Element>& childrenAmong(const Element& element, Names names);
/// There are exactly these children, in that order.
const std::vector<Element>& childrenInOrder(const Element& element, Names names);

/// The text of an element that has no children.
const std::string& textOf(const Element& element);

/// \param found     of the element
/// \param expected  of it
[[noreturn]] void failAt(const Element& element, const std::string& found, const std::string& expected);

} // namespace cimhost::serve

#endif
