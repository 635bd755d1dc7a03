// Texts on their way into a log line: one line of UTF-8 that drives no terminal, and the same as cimhost shows.

#include "FuzzTarget.h"

#include "Escape.h"
#include "cim/Utf8.h"

#include <string>

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string text = Fuzz::textOf(data, size);
    const std::string line = MVLog::printable(text);
    Fuzz::require(MVLog::printable(line) == line, "nothing is left to be escaped");
    Fuzz::require(line == cimhost::cim::printable(text), "cimhost shows the same");
    return 0;
}
