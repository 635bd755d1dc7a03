#include "cim/Literal.h"

#include "cim/Mof.h"
#include "cim/ObjectPathText.h"
#include "cim/Utf8.h"
#include "cim/Values.h"

#include <array>
#include <charconv>
#include <cmath>
#include <cstdio>

namespace cimhost::cim {

namespace {

std::string characterLiteral(std::uint64_t code)
{
    const bool isSurrogate = code >= 0xD800 && code <= 0xDFFF;
    if (isSurrogate || code > 0xFFFF) {
        std::array<char, 24> text{};
        std::snprintf(text.data(), text.size(), "'\\x%04llX'", static_cast<unsigned long long>(code));
        return text.data();
    }
    std::string character;
    appendCharacter(character, static_cast<char32_t>(code));
    return '\'' + escaped(character, "'") + '\'';
}

/// One function for each kind of item.
struct LiteralOf
{
    CMPIType type;

    std::string operator()(std::monostate /*null*/) const { return "NULL"; }
    std::string operator()(bool flag) const { return flag ? "TRUE" : "FALSE"; }
    std::string operator()(std::uint64_t number) const
    {
        return type == CMPI_char16 ? characterLiteral(number) : std::to_string(number);
    }
    std::string operator()(std::int64_t number) const { return std::to_string(number); }
    std::string operator()(double number) const { return realText(number); }
    std::string operator()(const std::string& text) const { return inQuotes(text); }
    std::string operator()(const std::shared_ptr<const ObjectPath>& path) const
    {
        return path ? inQuotes(toText(*path)) : "NULL";
    }
    std::string operator()(const std::shared_ptr<const Instance>& instance) const
    {
        return instance ? inQuotes(mof(*instance)) : "NULL";
    }
};

} // namespace

std::string literal(const Value& value)
{
    if (value.isNull)
        return "NULL";
    const auto elementType = static_cast<CMPIType>(value.type & ~CMPI_ARRAY);
    std::string list;
    for (const Value::Scalar& item : value.items)
        list += (list.empty() ? "" : ", ") + literal(item, elementType);
    return isArray(value) ? '{' + list + '}' : list;
}

std::string literal(const Value::Scalar& item, CMPIType type)
{
    return std::visit(LiteralOf{type}, item);
}

std::string inQuotes(std::string_view text)
{
    return '"' + escaped(text, "\"") + '"';
}

std::string realText(double number)
{
    std::array<char, 32> buffer{};
    char* const end = std::to_chars(buffer.data(), buffer.data() + buffer.size(), number).ptr;
    std::string text(buffer.data(), end);
    const bool isBare = text.find_first_of(".e") == std::string::npos;
    return isBare && std::isfinite(number) ? text + ".0" : text;
}

} // namespace cimhost::cim
