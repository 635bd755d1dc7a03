// Inventory files: read, or refused with a message that says what was expected.

#include "FuzzTarget.h"

#include "InventoryReader.h"

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    constexpr std::size_t longestMessage = 1000;
    try {
        const Tavro::Inventory inventory = Tavro::readInventory(Fuzz::textOf(data, size));
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
