/// \file
/// A parser of JSON for texts without a fault.
#ifndef TAVRO_QUICKPARSER_H
#define TAVRO_QUICKPARSER_H

#include <cstddef>
#include <cstdint>
#include <functional>
#include <limits>
#include <string>
#include <string_view>
#include <utility>

#include <boost/json/basic_parser_impl.hpp>

namespace Tavro {

/// Hands what the parser comes along to a handler of nlohmann::json's kind. Where that has nothing for a value, it counts
/// as a fault.
template <class Handler>
class QuickHandler
{
public:
    using Text = boost::json::string_view;
    using Error = boost::json::error_code;

    QuickHandler(Handler& next, std::string_view json, std::size_t longestGap)
        : handler_(next),
          json_(json),
          longest_(longestGap)
    {}

    // What the parser calls and asks for, under its names. False is a fault.
    // NOLINTBEGIN(readability-identifier-naming)
    static constexpr std::size_t max_object_size = std::numeric_limits<std::size_t>::max();
    static constexpr std::size_t max_array_size = max_object_size;
    static constexpr std::size_t max_key_size = max_object_size;
    static constexpr std::size_t max_string_size = max_object_size;

    static bool on_document_begin(Error&) { return true; }
    bool on_document_end(Error&) { return true; }
    bool on_object_begin(Error&) { return handler_.start_object(0); }
    bool on_object_end(std::size_t, Error&) { return handler_.end_object(); }
    bool on_array_begin(Error&) { return handler_.start_array(0); }
    bool on_array_end(std::size_t, Error&) { return handler_.end_array(); }
    bool on_key_part(Text part, std::size_t, Error&) { return keep(part); }
    bool on_key(Text end, std::size_t, Error&) { return advancesTo(end) && handler_.key(whole(end)); }
    bool on_string_part(Text part, std::size_t, Error&) { return keep(part); }
    bool on_string(Text end, std::size_t, Error&) { return advancesTo(end) && handler_.string(whole(end)); }
    bool on_int64(std::int64_t number, Text digits, Error&)
    {
        return digits.front() != '-' && advancesTo(digits) &&
               handler_.number_unsigned(static_cast<std::uint64_t>(number));
    }
    static bool on_number_part(Text, Error&) { return false; }
    static bool on_uint64(std::uint64_t, Text, Error&) { return false; } // larger than any std::int64_t
    static bool on_double(double, Text, Error&) { return false; }
    static bool on_bool(bool, Error&) { return false; }
    static bool on_null(Error&) { return false; }
    static bool on_comment_part(Text, Error&) { return false; }
    static bool on_comment(Text, Error&) { return false; }
    // NOLINTEND(readability-identifier-naming)

    /// Whether less than the longest gap is between the last name or value and the end.
    [[nodiscard]] bool reachesTheEnd() const { return json_.size() - place_ < longest_; }

private:
    /// A text with escapes comes in pieces.
    bool keep(std::string_view part)
    {
        parts_ += part;
        return true;
    }

    /// \return valid until the next call
    std::string_view whole(std::string_view end)
    {
        if (parts_.empty())
            return end;
        text_ = std::exchange(parts_, {}).append(end);
        return text_;
    }

    /// Whether less than the longest gap was read since the last name or value. Where that, without its escapes, stands
    /// elsewhere, the next one tells.
    bool advancesTo(std::string_view piece)
    {
        const char* const end = piece.data() + piece.size();
        const char* const jsonEnd = json_.data() + json_.size();
        if (std::less<>()(end, json_.data()) || std::less<>()(jsonEnd, end))
            return true;
        const auto place = static_cast<std::size_t>(end - json_.data());
        return place - std::exchange(place_, place) < longest_;
    }

    Handler& handler_;
    std::string_view json_;
    std::size_t longest_;
    std::size_t place_ = 0; ///< behind the last name or value
    std::string parts_;     ///< of the text that the parser is in
    std::string text_;
};

/// Parses a text. \return false where it has a fault or so many bytes between the ends of two names or values that it is to
/// be looked at closely; what the handler has been told up to there is of no use then
/// \throw what the handler throws; std::bad_alloc
template <class Handler>
bool parseQuickly(std::string_view json, Handler& handler, std::size_t longestGap)
{
    boost::json::basic_parser<QuickHandler<Handler>> parser({}, handler, json, longestGap);
    boost::json::error_code error;
    const std::size_t read = parser.write_some(false, json.data(), json.size(), error);
    return !error && read == json.size() && parser.handler().reachesTheEnd();
}

} // namespace Tavro

#endif
