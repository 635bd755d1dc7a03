// Object paths as text: what is read is written so that it reads as the same; what is refused, is refused in
// one line that may go to a terminal.

#include "FuzzTarget.h"

#include "cim/ObjectPathText.h"
#include "cim/Utf8.h"
#include "cim/Values.h"

using namespace cimhost::cim;

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string text = Fuzz::textOf(data, size);
    try {
        const ObjectPath path = parseObjectPath(text);
        const std::string written = toText(path);
        Fuzz::require(printable(written) == written, "a written path has nothing that acts on a terminal");
        if (written.size() <= maxPathLength)
            Fuzz::require(parseObjectPath(written) == path, "the reader gives back what the writer wrote");
    } catch (const ParseError& error) {
        Fuzz::require(printable(error.what()) == error.what(), "a refusal may go to a terminal");
        Fuzz::require(error.offset() <= text.size() && error.column() >= 1, "a refusal names a place");
    }
    return 0;
}
