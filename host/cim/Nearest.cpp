#include "cim/Nearest.h"

#include "cim/Utf8.h"

#include <algorithm>
#include <cctype>
#include <cstddef>
#include <numeric>

namespace cimhost::cim {

namespace {

bool sameLetter(char a, char b)
{
    return std::tolower(static_cast<unsigned char>(a)) == std::tolower(static_cast<unsigned char>(b));
}

/// Row by row through the table of what the beginnings of both are away from each other.
std::size_t distance(const std::string& a, const std::string& b)
{
    std::vector<std::size_t> row(b.size() + 1);
    std::iota(row.begin(), row.end(), 0);
    for (std::size_t i = 0; i < a.size(); ++i) {
        std::size_t diagonal = row[0];
        row[0] = i + 1;
        for (std::size_t j = 0; j < b.size(); ++j) {
            const std::size_t changed = diagonal + (sameLetter(a[i], b[j]) ? 0 : 1);
            diagonal = row[j + 1];
            row[j + 1] = std::min({changed, diagonal + 1, row[j] + 1});
        }
    }
    return row.back();
}

} // namespace

std::string nearestName(const std::string& name, const std::vector<std::string>& names)
{
    constexpr std::size_t longest = 256; // of what anybody means
    if (name.size() > longest)
        return "";
    std::string nearest;
    std::size_t least = std::max<std::size_t>(2, name.size() / 4) + 1;
    for (const std::string& candidate : names)
        if (const std::size_t away = distance(name, candidate); away < least) {
            least = away;
            nearest = candidate;
        }
    return nearest;
}

std::string didYouMean(const std::string& name, const std::vector<std::string>& names)
{
    const std::string nearest = nearestName(name, names);
    return nearest.empty() ? "" : "; did you mean " + printable(nearest) + '?';
}

} // namespace cimhost::cim
