#include "cim/Table.h"

#include "cim/Utf8.h"

#include <algorithm>

namespace cimhost::cim {

namespace {

Row printableRow(const Row& row, std::size_t columns)
{
    Row result(columns);
    const std::size_t count = std::min(columns, row.size());
    std::transform(row.begin(), row.begin() + static_cast<std::ptrdiff_t>(count), result.begin(), printable);
    return result;
}

std::string line(const Row& cells, const std::vector<std::size_t>& widths)
{
    std::string text;
    for (std::size_t column = 0; column < cells.size(); ++column) {
        const std::size_t gap = column == 0 ? 0 : 2;
        text.append(gap, ' ').append(cells[column]);
        text.append(widths[column] - displayWidth(cells[column]), ' ');
    }
    text.erase(text.find_last_not_of(' ') + 1);
    return text + '\n';
}

} // namespace

std::string table(const Row& heading, const std::vector<Row>& rows)
{
    std::vector<Row> lines{printableRow(heading, heading.size())};
    for (const Row& row : rows)
        lines.push_back(printableRow(row, heading.size()));

    std::vector<std::size_t> widths(heading.size());
    for (const Row& cells : lines)
        for (std::size_t column = 0; column < cells.size(); ++column)
            widths[column] = std::max(widths[column], displayWidth(cells[column]));

    Row rule;
    for (const std::size_t width : widths)
        rule.emplace_back(width, '-');
    lines.insert(lines.begin() + 1, rule);

    std::string text;
    for (const Row& cells : lines)
        text += line(cells, widths);
    return text;
}

} // namespace cimhost::cim
