#include "serve/Http.h"

#include "cim/Values.h"

#include <algorithm>

namespace cimhost::serve {

namespace {

std::string_view withoutBlanks(std::string_view text)
{
    const std::size_t first = text.find_first_not_of(" \t");
    if (first == std::string_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

/// Takes the part up to the separator off the text.
std::string_view takePart(std::string_view& text, char separator)
{
    const std::string_view part = text.substr(0, text.find(separator));
    text.remove_prefix(std::min(part.size() + 1, text.size()));
    return withoutBlanks(part);
}

/// Whether a weight says "not at all", as q=0 or q=0.000 does.
bool isZero(std::string_view weight)
{
    return !weight.empty() && weight.find_first_not_of("0.") == std::string_view::npos;
}

/// Whether a range such as `text/*` has the value.
bool covers(std::string_view range, std::string_view value)
{
    if (range == "*" || range == "*/*" || cim::sameName(range, value))
        return true;
    const std::size_t slash = range.find("/*");
    return slash != std::string_view::npos && slash + 2 == range.size() &&
           cim::sameName(range.substr(0, slash + 1), value.substr(0, slash + 1));
}

} // namespace

const std::string* findHeader(const HttpRequest& request, std::string_view name)
{
    const auto found =
        std::find_if(request.headers.begin(), request.headers.end(),
                     [&](const HeaderField& field) { return cim::sameName(field.name, name); });
    return found == request.headers.end() ? nullptr : &found->value;
}

bool accepts(const HttpRequest& request, std::string_view header, const std::vector<std::string_view>& values)
{
    const std::string* const list = findHeader(request, header);
    if (list == nullptr)
        return true;
    for (std::string_view rest = *list; !rest.empty();) {
        const std::string_view item = takePart(rest, ',');
        const std::string_view range = withoutParameters(item);
        if (!isZero(parameterOf(item, "q")) &&
            std::any_of(values.begin(), values.end(),
                        [&](std::string_view value) { return covers(range, value); }))
            return true;
    }
    return false;
}

std::string_view withoutParameters(std::string_view value)
{
    return takePart(value, ';');
}

std::string_view parameterOf(std::string_view value, std::string_view name)
{
    takePart(value, ';');
    while (!value.empty()) {
        std::string_view parameter = takePart(value, ';');
        if (!cim::sameName(takePart(parameter, '='), name))
            continue;
        parameter = withoutBlanks(parameter);
        const bool isQuoted = parameter.size() >= 2 && parameter.front() == '"' && parameter.back() == '"';
        return isQuoted ? parameter.substr(1, parameter.size() - 2) : parameter;
    }
    return {};
}

} // namespace cimhost::serve
