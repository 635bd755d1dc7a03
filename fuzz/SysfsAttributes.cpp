// The contents of attributes of LEDs and of the slots of drive enclosures.

#include "FuzzTarget.h"

#include "SysfsAttributes.h"

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string text = Fuzz::textOf(data, size);

    if (const std::optional<unsigned int> number = Tavro::wholeNumber(text)) {
        const std::string written = std::to_string(*number);
        Fuzz::require(text.find(written) != std::string::npos, "a number is one that stands in the text");
        const unsigned int state = Tavro::lightState(*number);
        Fuzz::require(state == Tavro::offState || state == Tavro::steadyState, "a light is off or steady");
    }

    if (const std::optional<std::string_view> trigger = Tavro::activeTrigger(text)) {
        const std::string inBrackets = '[' + std::string(*trigger) + ']';
        Fuzz::require(text.find(inBrackets) != std::string::npos, "a trigger stands in brackets");
        (void)Tavro::blinks(*trigger);
    }

    const unsigned int status = Tavro::slotStatus(text);
    Fuzz::require(status <= Tavro::wellStatus || (status >= 20 && status <= 22),
                  "a status is one of the five");
    return 0;
}
