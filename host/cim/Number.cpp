#include "cim/Number.h"

#include "cim/Values.h"

#include <cerrno>
#include <charconv>
#include <clocale>
#include <cmath>
#include <cstdlib>
#include <string>

namespace cimhost::cim {

namespace {

/// What std::from_chars() does, which not every standard library has for real numbers: in any locale.
std::optional<double> readReal(const std::string& text)
{
    static const locale_t plain = newlocale(LC_ALL_MASK, "C", nullptr);
    char* end = nullptr;
    errno = 0;
    const double number = strtod_l(text.c_str(), &end, plain);
    const bool fits = errno != ERANGE || std::fpclassify(number) == FP_SUBNORMAL;
    return fits && end == text.c_str() + text.size() ? std::optional(number) : std::nullopt;
}

} // namespace

std::optional<Value> parseNumber(std::string_view text)
{
    const bool hasStrangers = text.find_first_not_of("0123456789+-.eE") != std::string_view::npos;
    const bool signedTwice = text.substr(0, 2) == "+-";
    if (text.empty() || hasStrangers || signedTwice)
        return std::nullopt;

    const char* const first = text.data() + (text.front() == '+' ? 1 : 0);
    const char* const last = text.data() + text.size();
    const auto isRead = [&](auto& number) {
        const auto [end, error] = std::from_chars(first, last, number);
        return error == std::errc() && end == last;
    };
    std::uint64_t natural = 0;
    std::int64_t integer = 0;
    if (text.find_first_of(".eE") != std::string_view::npos) {
        const std::optional<double> real = readReal(std::string(first, last));
        return real ? std::optional(realValue(*real)) : std::nullopt;
    }
    if (isRead(natural))
        return unsignedValue(natural);
    if (isRead(integer))
        return integer < 0 ? signedValue(integer) : unsignedValue(0);
    return std::nullopt;
}

} // namespace cimhost::cim
