/// \file
/// What the numbers of well-known properties mean, in words for people. Keyed by the names that the
/// DMTF's schema gives to properties, whatever the class.
#ifndef CIMHOST_CLI_VALUEWORDS_H
#define CIMHOST_CLI_VALUEWORDS_H

#include <cstdint>
#include <optional>
#include <string_view>

namespace cimhost::cli {

/// Nothing: the property or the number has no word.
std::optional<std::string_view> valueWord(std::string_view property, std::uint64_t number);

} // namespace cimhost::cli

#endif
