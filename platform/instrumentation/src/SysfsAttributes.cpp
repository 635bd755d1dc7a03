#include "SysfsAttributes.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstddef>
#include <limits>
#include <system_error>

namespace Tavro {
namespace {

/// As the kernel names them: on and off at set intervals, like a heart, faster under load, and as a person
/// has set it.
constexpr std::array<std::string_view, 4> blinkingTriggers = {"timer", "heartbeat", "activity", "pattern"};

struct StatusWord
{
    std::string_view word;
    unsigned int status;
};

constexpr std::size_t mostDigits = std::numeric_limits<unsigned int>::digits10 + 1;

constexpr std::array statusWords = {StatusWord{"OK", wellStatus}, StatusWord{"non-critical", 20},
                                    StatusWord{"critical", 21}, StatusWord{"unrecoverable", 22}};

std::string_view withoutLineEnd(std::string_view text)
{
    if (!text.empty() && text.back() == '\n')
        text.remove_suffix(1);
    return text;
}

} // namespace

std::optional<unsigned int> wholeNumber(std::string_view text)
{
    const std::string_view digits = withoutLineEnd(text);
    // Also: what was cut at a page is no number.
    if (digits.size() > mostDigits)
        return std::nullopt;
    const char* const end = digits.data() + digits.size();
    unsigned int number = 0;
    const auto [stop, error] = std::from_chars(digits.data(), end, number);
    if (error != std::errc() || stop != end)
        return std::nullopt;
    return number;
}

unsigned int lightState(unsigned int value)
{
    return value == 0 ? offState : steadyState;
}

std::optional<std::string_view> activeTrigger(std::string_view list)
{
    const std::size_t open = list.find('[');
    if (open == std::string_view::npos)
        return std::nullopt;
    const std::string_view behind = list.substr(open + 1);
    const std::size_t close = behind.find(']');
    if (close == std::string_view::npos)
        return std::nullopt;
    return behind.substr(0, close);
}

bool blinks(std::string_view trigger)
{
    return std::find(blinkingTriggers.begin(), blinkingTriggers.end(), trigger) != blinkingTriggers.end();
}

unsigned int slotStatus(std::string_view text)
{
    const std::string_view word = withoutLineEnd(text);
    for (const StatusWord& known : statusWords)
        if (known.word == word)
            return known.status;
    return unknownStatus;
}

} // namespace Tavro
