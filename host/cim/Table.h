/// \file
/// A table of text in columns, for people.
#ifndef CIMHOST_CIM_TABLE_H
#define CIMHOST_CIM_TABLE_H

#include <string>
#include <vector>

namespace cimhost::cim {

using Row = std::vector<std::string>;

/// The heading, a rule and the rows, each column as wide as its widest cell on a terminal. Cells are
/// made printable; a row with fewer cells than the heading ends in empty ones, surplus cells are
/// left out. No line ends in blanks.
std::string table(const Row& heading, const std::vector<Row>& rows);

} // namespace cimhost::cim

#endif
