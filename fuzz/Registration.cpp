// Registration files: read into complete entries, or refused in one line that may go to a terminal.

#include "FuzzTarget.h"

#include "broker/Registration.h"
#include "cim/Utf8.h"

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    try {
        for (const auto& entry : cimhost::parseRegistration(Fuzz::textOf(data, size), "input").classes) {
            Fuzz::require(!entry.className.empty() && !entry.provider.empty() && !entry.location.empty(),
                          "an entry names its class, its provider and its library");
            Fuzz::require(entry.instance || entry.association, "an entry has a type");
            Fuzz::require(!entry.nameSpaces.empty(), "an entry has a namespace");
        }
    } catch (const cimhost::RegistrationError& error) {
        Fuzz::require(cimhost::cim::printable(error.what()) == error.what(),
                      "a refusal may go to a terminal");
    }
    return 0;
}
