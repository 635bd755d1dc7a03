#include "LedName.h"

#include "Words.h"

#include <array>
#include <cstddef>

namespace Tavro {
namespace {

/// The name's parts, in their order. Colons further left belong to the device: it is called by its address.
std::array<std::string_view, 3> partsOf(std::string_view name)
{
    const std::size_t beforeFunction = name.rfind(':');
    if (beforeFunction == std::string_view::npos)
        return {{{}, {}, name}};
    const std::string_view function = name.substr(beforeFunction + 1);
    name = name.substr(0, beforeFunction);
    const std::size_t beforeColour = name.rfind(':');
    if (beforeColour == std::string_view::npos)
        return {{{}, name, function}};
    return {{name.substr(0, beforeColour), name.substr(beforeColour + 1), function}};
}

/// A device's address, such as 0000:02:00.0, would not gain by being taken apart.
std::string describeDevice(std::string_view device)
{
    return device.find_first_of(":.") == std::string_view::npos ? inWords(device) : printable(device);
}

void appendWords(std::string& text, const std::string& words)
{
    if (!text.empty() && !words.empty())
        text += ' ';
    text += words;
}

} // namespace

std::string describeLed(std::string_view name)
{
    const auto [device, colour, function] = partsOf(name);
    std::string text = describeDevice(device);
    appendWords(text, inWords(colour));
    appendWords(text, inWords(function));
    // A plain name may say it itself: front-led, led0.
    if ((' ' + text + ' ').find(" LED ") == std::string::npos)
        appendWords(text, "LED");
    return text;
}

} // namespace Tavro
