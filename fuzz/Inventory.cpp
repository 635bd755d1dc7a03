// Inventory files, also with long runs of a byte: read, and then as another parser reads them, or refused with a message
// that says what was expected.

#include "FuzzTarget.h"

#include "InventoryReader.h"

#include <cstddef>
#include <string>

#include <nlohmann/json.hpp>

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

void requireWhatStandsIn(const std::string& text, const Tavro::Inventory& inventory)
{
    const nlohmann::json json = nlohmann::json::parse(text, nullptr, false);
    Fuzz::require(!json.is_discarded(), "what is read is JSON");
    Fuzz::require(inventory.sources.size() == json.value("sources", nlohmann::json::array()).size(),
                  "every source is read");
    const nlohmann::json nodes = json.value("nodes", nlohmann::json::array());
    Fuzz::require(inventory.nodes.size() == nodes.size(), "every node is read");
    for (std::size_t i = 0; i < nodes.size(); ++i) {
        const Tavro::Node& node = inventory.nodes[i];
        Fuzz::require(node.path == nodes[i].at("path") && node.description == nodes[i].at("description") &&
                          node.status == nodes[i].at("status") &&
                          node.alarmState.has_value() == nodes[i].contains("alarmState"),
                      "a node has what the file says");
        Fuzz::require((node.description + node.path).find('\0') == std::string::npos,
                      "no text has a null character");
    }
}

} // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    constexpr std::size_t longestMessage = 1000;
    const std::string text = stretched(Fuzz::textOf(data, size));
    try {
        const Tavro::Inventory inventory = Tavro::readInventory(text);
        Fuzz::require(inventory.sources.size() <= Tavro::nodeSources().size(), "no source is given twice");
        requireWhatStandsIn(text, inventory);
    } catch (const Tavro::InventoryError& error) {
        const std::string message = error.what();
        Fuzz::require(message.find("expected") != std::string::npos, "a refusal says what was expected");
        Fuzz::require(message.size() <= longestMessage, "a refusal is short");
    }
    return 0;
}
