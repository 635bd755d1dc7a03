// Message catalogues: read, or refused with a message that says where and what was expected.

#include "FuzzTarget.h"

#include "MessageCatalogue.h"

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    try {
        std::size_t characters = 0;
        for (const auto& [key, text] : Tavro::readMessages(Fuzz::textOf(data, size))) {
            Fuzz::require(!text.empty(), "a message has a text");
            characters += key.size() + text.size();
        }
        Fuzz::require(characters <= size, "there is no more text than the catalogue has bytes");
    } catch (const Tavro::CatalogueError& error) {
        const std::string message = error.what();
        Fuzz::require(message.find("byte ") == 0, "a refusal says where");
        Fuzz::require(message.find("expected") != std::string::npos, "a refusal says what was expected");
    }
    return 0;
}
