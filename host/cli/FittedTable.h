/// \file
/// Tables that fit the window.
#ifndef CIMHOST_CLI_FITTEDTABLE_H
#define CIMHOST_CLI_FITTEDTABLE_H

#include "cim/Table.h"

#include <cstddef>
#include <limits>
#include <string>
#include <string_view>
#include <vector>

namespace cimhost::cli {

constexpr std::size_t anyWidth = std::numeric_limits<std::size_t>::max();

struct Column
{
    /// How it gives way, the first first.
    enum Kind
    {
        identifier, ///< shortened in the middle, as identifiers differ at their ends
        list,       ///< shortened at its end
        plain,      ///< the same, where nothing else helps
    };

    std::string name;
    Kind kind;
    bool mayGo = false; ///< whether it is left out before others suffer
};

/// As cim::table(), no line wider than that on a terminal.
std::string fittedTable(std::vector<Column> columns, std::vector<cim::Row> rows, std::size_t width);

/// The beginning of a printable text that is no wider.
std::string cropped(std::string_view text, std::size_t width);

/// The same, with an ellipsis for what is left out: at the end, or in the middle.
std::string shortenedAtEnd(std::string_view text, std::size_t width);
std::string shortenedInMiddle(std::string_view text, std::size_t width);

} // namespace cimhost::cli

#endif
