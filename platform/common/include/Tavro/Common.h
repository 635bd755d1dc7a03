/// \file
/// Helpers that the providers share. All may be called from several threads at once.
#ifndef TAVRO_COMMON_H
#define TAVRO_COMMON_H

#include <string>

#include <cmpift.h>

namespace Tavro {

/// This host's name as the kernel has it, without a domain unless the administrator set one there.
std::string getSystemName();

/// Whether two object paths name the same instance: the same class and the same keys with equal
/// values, the keys in any order. Letter case is ignored in names of classes and keys, and matters in
/// values. Namespace and host take no part.
///
/// Values are equal by type:
/// - integers of any width and sign are compared as numbers, since a path read from text does not tell
///   the width; reals likewise among themselves
/// - strings, character pointers and date-times are compared as text
/// - booleans and 16-bit characters equal their own kind only
/// - null values equal null values
/// - references: with `deep` as paths in this same way, otherwise by the text of their class and keys,
///   to which types make no difference
/// - anything else (an array, an embedded object) cannot be a key and equals nothing
///
/// A null path or one with a null handle equals nothing, itself included; neither does a path that its
/// broker cannot read out in full, or one with references nested more than eight deep.
bool isObjPathsEqual(const CMPIObjectPath* a, const CMPIObjectPath* b, bool deep);

/// `text` without leading and trailing blanks. A blank is the space U+0020 alone; tabs and line ends
/// belong to the text.
std::string stripSpaces(const std::string& text);

} // namespace Tavro

#endif
