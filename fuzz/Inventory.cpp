// Inventory files, also with long runs of a byte: read, or refused with a message that says what was expected.

#include "FuzzTarget.h"

#include "InventoryReader.h"

#include <string>

namespace {

/// A text with runs as long as those that are refused: the byte 1 stands for thirty thousand of the one before it.
std::string stretched(const std::string& text)
{
    constexpr std::size_t longest = 200000;
    std::string result;
    for (const char byte : text)
        if (byte != '\1' || result.empty() || result.size() > longest)
            result += byte;
        else
            result.append(30000, result.back());
    return result;
}

} // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    constexpr std::size_t longestMessage = 1000;
    try {
        const Tavro::Inventory inventory = Tavro::readInventory(stretched(Fuzz::textOf(data, size)));
        Fuzz::require(inventory.sources.size() <= Tavro::nodeSources().size(), "no source is given twice");
        for (const Tavro::Node& node : inventory.nodes)
            Fuzz::require((node.description + node.path).find('\0') == std::string::npos,
                          "no text has a null character");
    } catch (const Tavro::InventoryError& error) {
        const std::string message = error.what();
        Fuzz::require(message.find("expected") != std::string::npos, "a refusal says what was expected");
        Fuzz::require(message.size() <= longestMessage, "a refusal is short");
    }
    return 0;
}
