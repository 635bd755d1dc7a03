/// \file
/// Object paths as text, in the form that the clients of the field write:
///
///     root/cimv2:CIM_Example.Name="a \"b\"",Number=42,Flag=TRUE
///     //host/root/cimv2:CIM_Link.Left="root/cimv2:CIM_Example.Name=\"a\""
///
/// Before the class may stand a host (`//host/`, `http://host:port/`) and a namespace; without keys
/// it is the path of a class. Numbers are decimal. Texts are quoted, with the escapes of MOF:
/// `\"`, `\\`, `\'`, `\b`, `\t`, `\n`, `\f`, `\r` and `\x` with one to four hexadecimal digits.
///
/// A quoted value is a reference if all of it reads as an object path with keys, and its class has
/// a schema's prefix (`Schema_Name`); anything else is a string. A string that happens to read so is
/// told apart by an escape with `\x`: a value that has one is always a string.
#ifndef CIMHOST_CIM_OBJECTPATHTEXT_H
#define CIMHOST_CIM_OBJECTPATHTEXT_H

#include "cim/Model.h"

#include <cstddef>
#include <stdexcept>
#include <string_view>

namespace cimhost::cim {

/// The longest text read, in bytes, and how deep references may be nested.
constexpr std::size_t maxPathLength = 65536;
constexpr int maxPathDepth = 8;

/// Text that is no object path; what() has it all in one line.
class ParseError : public std::runtime_error
{
public:
    /// \param offset  of the place in the text, in bytes
    ParseError(std::string_view text, std::size_t offset, std::string found, std::string expected);

    [[nodiscard]] std::size_t offset() const noexcept { return offset_; }
    /// The place in characters, from 1; one past the last character for the end of the text.
    [[nodiscard]] std::size_t column() const noexcept { return column_; }
    [[nodiscard]] const std::string& found() const noexcept { return found_; }
    [[nodiscard]] const std::string& expected() const noexcept { return expected_; }

private:
    std::size_t offset_;
    std::size_t column_;
    std::string found_;
    std::string expected_;
};

/// Reads a path. Its values have the widest types: CMPI_uint64, CMPI_sint64 for negative numbers,
/// CMPI_real64, CMPI_boolean, CMPI_string, CMPI_ref. The scheme before a host is dropped.
/// \throws ParseError
ObjectPath parseObjectPath(std::string_view text);

/// Writes a path so that parseObjectPath() gives it back: strings, booleans, numbers (with the widest
/// type) and references to objects with keys of a class with a schema's prefix. A datetime comes back
/// as a string. What no key may have (a null, an array) is written as in MOF and not read back.
std::string toText(const ObjectPath& path);

} // namespace cimhost::cim

#endif
