// cimhost: asks CIM providers, loaded into this process, what a CIM client asks.

#include "cli/Program.h"
#include "cli/watch/Terminal.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <iostream>
#include <optional>
#include <sstream>
#include <string>
#include <system_error>
#include <vector>

#include <unistd.h>

namespace {

/// Everything at once, so that a reason for not writing is known and tells of the whole output.
bool writeToStandardOutput(const std::string& text)
{
    return std::fwrite(text.data(), 1, text.size(), stdout) == text.size() && std::fflush(stdout) == 0;
}

} // namespace

int main(int argc, char* argv[])
{
    using namespace cimhost::cli;

    // Writing to a pipe that nobody reads any more, or beyond a limit, ends in an exit status, not in a signal.
    std::signal(SIGPIPE, SIG_IGN);
    std::signal(SIGXFSZ, SIG_IGN);

    std::optional<std::size_t> columns;
    if (isatty(STDOUT_FILENO) != 0)
        columns = Terminal::size().columns;
    std::ostringstream out;
    const Ending ending = run(std::vector<std::string>(argv + (argc > 0 ? 1 : 0), argv + argc),
                              readSurroundings(), columns, out, std::cerr);
    if (writeToStandardOutput(out.str()))
        return ending.status;
    const int reason = errno;
    if (reason != EPIPE)
        std::cerr << "cimhost: cannot write to standard output: " << std::generic_category().message(reason)
                  << '\n';
    else if (ending.isOneDocument) // where a reader of lines, such as head, has seen enough
        std::cerr << "cimhost: nobody read the graph to its end\n";
    return exitError;
}
