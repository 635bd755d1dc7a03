#include "broker/DateTime.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdio>

namespace cimhost {

namespace {

constexpr std::size_t length = 25;
constexpr std::size_t pointAt = 14;
constexpr std::size_t signAt = 21;

constexpr std::uint64_t microsPerSecond = 1'000'000;
constexpr std::uint64_t secondsPerDay = 86'400;
/// 9999-12-31 23:59:59.999999 and 99999999 days less a microsecond.
constexpr std::uint64_t lastPoint = 253'402'300'800 * microsPerSecond - 1;
constexpr std::uint64_t lastInterval = 100'000'000 * secondsPerDay * microsPerSecond - 1;

bool isDigitOrStar(char c)
{
    return (c >= '0' && c <= '9') || c == '*';
}

/// The number in a field; `least` when a digit of it is not given.
std::int64_t field(std::string_view text, std::size_t start, std::size_t size, std::int64_t least = 0)
{
    std::int64_t number = 0;
    for (const char c : text.substr(start, size)) {
        if (c == '*')
            return least;
        number = number * 10 + (c - '0');
    }
    return number;
}

/// Days from 1970-01-01 to a day of the Gregorian calendar; months and days count from 1.
std::int64_t daysTo(std::int64_t year, std::int64_t month, std::int64_t day)
{
    // Years begin in March here, so that a leap day is a year's last.
    const std::int64_t y = month > 2 ? year : year - 1;
    const std::int64_t m = month > 2 ? month - 3 : month + 9;
    return y * 365 + y / 4 - y / 100 + y / 400 + (m * 153 + 2) / 5 + day - 1 - 719'468;
}

struct Day
{
    int year;
    int month;
    int day;
};

/// The inverse of daysTo, for days from 1970 on.
Day dayAt(std::int64_t days)
{
    const std::int64_t z = days + 719'468;
    const std::int64_t era = z / 146'097;
    const std::int64_t dayOfEra = z % 146'097;
    const std::int64_t yearOfEra =
        (dayOfEra - dayOfEra / 1'460 + dayOfEra / 36'524 - dayOfEra / 146'096) / 365;
    const std::int64_t dayOfYear = dayOfEra - (365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100);
    const std::int64_t m = (5 * dayOfYear + 2) / 153;
    const std::int64_t month = m < 10 ? m + 3 : m - 9;
    return {static_cast<int>(yearOfEra + era * 400 + (month <= 2 ? 1 : 0)), static_cast<int>(month),
            static_cast<int>(dayOfYear - (153 * m + 2) / 5 + 1)};
}

std::int64_t timeOfDay(std::string_view text)
{
    const std::int64_t seconds = field(text, 8, 2) * 3'600 + field(text, 10, 2) * 60 + field(text, 12, 2);
    return seconds * static_cast<std::int64_t>(microsPerSecond) + field(text, 15, 6);
}

bool inRange(std::string_view text, std::size_t start, std::int64_t least, std::int64_t most)
{
    const std::int64_t number = field(text, start, 2, least);
    return number >= least && number <= most;
}

} // namespace

bool isDateTime(std::string_view text)
{
    if (text.size() != length || text[pointAt] != '.')
        return false;
    const char sign = text[signAt];
    if (sign != '+' && sign != '-' && sign != ':')
        return false;
    for (std::size_t i = 0; i < length; ++i)
        if (i != pointAt && i != signAt && !isDigitOrStar(text[i]))
            return false;
    if (!inRange(text, 8, 0, 23) || !inRange(text, 10, 0, 59) || !inRange(text, 12, 0, 59))
        return false;
    return isInterval(text) ? text.substr(signAt + 1) == "000"
                            : inRange(text, 4, 1, 12) && inRange(text, 6, 1, 31);
}

bool isInterval(std::string_view text)
{
    return text[signAt] == ':';
}

std::uint64_t toMicroseconds(std::string_view text)
{
    const auto inMicros = [](std::int64_t seconds) {
        return seconds * static_cast<std::int64_t>(microsPerSecond);
    };
    if (isInterval(text))
        return static_cast<std::uint64_t>(
            inMicros(field(text, 0, 8) * static_cast<std::int64_t>(secondsPerDay)) + timeOfDay(text));

    const std::int64_t days = daysTo(field(text, 0, 4), field(text, 4, 2, 1), field(text, 6, 2, 1));
    const std::int64_t offset = inMicros(field(text, signAt + 1, 3) * 60);
    const std::int64_t local = inMicros(days * static_cast<std::int64_t>(secondsPerDay)) + timeOfDay(text);
    const std::int64_t utc = text[signAt] == '+' ? local - offset : local + offset;
    return static_cast<std::uint64_t>(std::max(utc, std::int64_t{0}));
}

std::string toDateTime(std::uint64_t microseconds, bool interval)
{
    const std::uint64_t held = std::min(microseconds, interval ? lastInterval : lastPoint);
    const auto micros = static_cast<unsigned>(held % microsPerSecond);
    const auto days = static_cast<std::int64_t>(held / microsPerSecond / secondsPerDay);
    const auto second = static_cast<unsigned>(held / microsPerSecond % secondsPerDay);

    std::array<char, 64> text{};
    if (interval) {
        std::snprintf(text.data(), text.size(), "%08lld%02u%02u%02u.%06u:000", static_cast<long long>(days),
                      second / 3'600, second / 60 % 60, second % 60, micros);
    } else {
        const Day day = dayAt(days);
        std::snprintf(text.data(), text.size(), "%04d%02d%02d%02u%02u%02u.%06u+000", day.year, day.month,
                      day.day, second / 3'600, second / 60 % 60, second % 60, micros);
    }
    return text.data();
}

std::string currentDateTime()
{
    const auto now = std::chrono::system_clock::now().time_since_epoch();
    return toDateTime(
        static_cast<std::uint64_t>(std::chrono::duration_cast<std::chrono::microseconds>(now).count()),
        false);
}

} // namespace cimhost
