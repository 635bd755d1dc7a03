#include "cli/ClassList.h"

#include <algorithm>

namespace cimhost::cli {

namespace {

std::string answersOf(const RegisteredClass& entry)
{
    if (entry.instance && entry.association)
        return "all";
    return entry.instance ? "ein, ei, gi" : entry.association ? "ain, ai, rin, ri" : "";
}

} // namespace

std::string classTable(const Registration& registration, std::size_t width)
{
    std::vector<cim::Row> rows;
    for (const RegisteredClass& entry : registration.classes)
        for (const std::string& nameSpace : entry.nameSpaces)
            rows.push_back({nameSpace, entry.className, answersOf(entry), entry.provider,
                            "lib" + entry.location + ".so"});
    std::stable_sort(rows.begin(), rows.end(),
                     [](const cim::Row& a, const cim::Row& b) { return a[0] < b[0]; });
    return fittedTable({{"Namespace", Column::plain},
                        {"Class", Column::plain},
                        {"Commands", Column::list},
                        {"Provider", Column::identifier},
                        {"Library", Column::identifier, true}},
                       rows, width);
}

} // namespace cimhost::cli
