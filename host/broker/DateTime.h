/// \file
/// CIM's datetime: 25 characters, either a point in time, `yyyymmddhhmmss.mmmmmmsuuu` with the offset
/// from UTC in minutes, or an interval, `ddddddddhhmmss.mmmmmm:000`. Asterisks stand for digits that
/// are not given.
#ifndef CIMHOST_BROKER_DATETIME_H
#define CIMHOST_BROKER_DATETIME_H

#include <cstdint>
#include <string>
#include <string_view>

namespace cimhost {

bool isDateTime(std::string_view text);

/// \param text  for which isDateTime() holds
bool isInterval(std::string_view text);

/// Microseconds since 1970-01-01 00:00:00 UTC, or of the interval; digits not given count as the
/// smallest that may stand there. A point in time before 1970 is 0.
/// \param text  for which isDateTime() holds
std::uint64_t toMicroseconds(std::string_view text);

/// The point in time, in UTC, or the interval; one beyond what the text can hold is the last that it can.
std::string toDateTime(std::uint64_t microseconds, bool interval);

/// The point in time that it is now, in UTC.
std::string currentDateTime();

} // namespace cimhost

#endif
