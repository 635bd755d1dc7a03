#include "cli/FittedTable.h"

#include "cim/Utf8.h"

#include <algorithm>
#include <numeric>
#include <optional>
#include <sstream>

namespace cimhost::cli {

namespace {

constexpr const char* ellipsis = "\u2026";
constexpr std::size_t columnGap = 2;
constexpr std::size_t leastIdentifier = 20; ///< columns that still tell one from another
constexpr std::size_t leastList = 12;       ///< columns that a word fits in
constexpr std::size_t leastText = 4;

using Widths = std::vector<std::size_t>;

Widths widthsOf(const std::vector<Column>& columns, const std::vector<cim::Row>& rows)
{
    Widths widths;
    for (const Column& column : columns)
        widths.push_back(cim::displayWidth(column.name));
    for (const cim::Row& row : rows)
        for (std::size_t i = 0; i < row.size(); ++i)
            widths[i] = std::max(widths[i], cim::displayWidth(row[i]));
    return widths;
}

std::size_t totalOf(const Widths& widths)
{
    return std::accumulate(widths.begin(), widths.end(),
                           widths.empty() ? 0 : columnGap * (widths.size() - 1));
}

/// Up to where columns of a kind give way, in this order.
struct Phase
{
    Column::Kind kind;
    std::size_t least;
};

/// Takes columns of that kind in, the widest first, until all fit or none can give more.
void narrow(Widths& widths, const std::vector<Column>& columns, Phase phase, std::size_t width)
{
    while (totalOf(widths) > width) {
        std::optional<std::size_t> widest;
        for (std::size_t i = 0; i < widths.size(); ++i)
            if (columns[i].kind == phase.kind && widths[i] > phase.least &&
                (!widest || widths[i] > widths[*widest]))
                widest = i;
        if (!widest)
            return;
        --widths[*widest];
    }
}

void removeThoseThatMayGo(std::vector<Column>& columns, std::vector<cim::Row>& rows)
{
    for (std::size_t i = columns.size(); i-- > 0;)
        if (columns[i].mayGo) {
            columns.erase(columns.begin() + static_cast<std::ptrdiff_t>(i));
            for (cim::Row& row : rows)
                row.erase(row.begin() + static_cast<std::ptrdiff_t>(i));
        }
}

std::string croppedLines(const std::string& text, std::size_t width)
{
    std::istringstream lines(text);
    std::string result;
    for (std::string line; std::getline(lines, line);)
        result += cropped(line, width) + '\n';
    return result;
}

} // namespace

std::string fittedTable(std::vector<Column> columns, std::vector<cim::Row> rows, std::size_t width)
{
    for (cim::Row& row : rows)
        std::transform(row.begin(), row.end(), row.begin(), cim::printable);
    Widths widths = widthsOf(columns, rows);
    narrow(widths, columns, {Column::identifier, leastIdentifier}, width);
    if (totalOf(widths) > width) {
        removeThoseThatMayGo(columns, rows);
        widths = widthsOf(columns, rows);
        for (const Phase phase : {Phase{Column::identifier, leastIdentifier}, Phase{Column::list, leastList},
                                  Phase{Column::plain, leastText}, Phase{Column::list, leastText},
                                  Phase{Column::identifier, leastText}})
            narrow(widths, columns, phase, width);
    }

    cim::Row heading;
    for (std::size_t i = 0; i < columns.size(); ++i) {
        heading.push_back(shortenedAtEnd(columns[i].name, widths[i]));
        for (cim::Row& row : rows)
            row[i] = columns[i].kind == Column::identifier ? shortenedInMiddle(row[i], widths[i])
                                                           : shortenedAtEnd(row[i], widths[i]);
    }
    return croppedLines(cim::table(heading, rows), width);
}

std::string cropped(std::string_view text, std::size_t width)
{
    std::string result;
    std::size_t used = 0;
    while (!text.empty()) {
        std::string_view rest = text;
        cim::takeCharacter(rest);
        const std::string_view character = text.substr(0, text.size() - rest.size());
        used += cim::displayWidth(character);
        if (used > width)
            break;
        result += character;
        text = rest;
    }
    return result;
}

std::string shortenedAtEnd(std::string_view text, std::size_t width)
{
    if (cim::displayWidth(text) <= width)
        return std::string(text);
    return width == 0 ? "" : cropped(text, width - 1) + ellipsis;
}

std::string shortenedInMiddle(std::string_view text, std::size_t width)
{
    if (cim::displayWidth(text) <= width)
        return std::string(text);
    if (width == 0)
        return "";
    const std::string start = cropped(text, (width - 1) / 2);
    std::string_view end = text;
    while (cim::displayWidth(end) > width - 1 - cim::displayWidth(start))
        cim::takeCharacter(end);
    return start + ellipsis + std::string(end);
}

} // namespace cimhost::cli
