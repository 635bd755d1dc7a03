/// \file
/// The text format of Prometheus, version 0.0.4.
#ifndef CIMHOST_CLI_METRICS_EXPOSITION_H
#define CIMHOST_CLI_METRICS_EXPOSITION_H

#include <string>
#include <string_view>
#include <vector>

namespace cimhost::cli {

/// Of the Content-Type of HTTP.
constexpr const char* expositionType = "text/plain; version=0.0.4; charset=utf-8";

struct Label
{
    std::string_view name;
    std::string value; ///< any text: it is escaped, and each byte that is not UTF-8 becomes U+FFFD
};

/// Writes gauges, one family after the other.
class Exposition
{
public:
    /// Begins the gauges of that name.
    /// \param help  one line, without a backslash
    void begin(std::string_view name, std::string_view help);

    /// A gauge of the family begun last. No two have the same labels.
    /// \param value  a number as the format has it
    void gauge(const std::vector<Label>& labels, std::string_view value);

    [[nodiscard]] const std::string& text() const { return text_; }

private:
    std::string_view name_;
    std::string text_;
};

/// The text with U+FFFD in the place of each byte that is not UTF-8, as a label's value has it.
std::string validUtf8(std::string_view text);

} // namespace cimhost::cli

#endif
