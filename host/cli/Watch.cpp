#include "cli/Watch.h"

#include "cim/Utf8.h"
#include "cli/Output.h"
#include "cli/Signals.h"
#include "cli/watch/Terminal.h"
#include "cli/watch/View.h"

#include <array>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <ctime>
#include <optional>
#include <ostream>
#include <system_error>

#include <unistd.h>

namespace cimhost::cli {

namespace {

using Clock = std::chrono::steady_clock;

std::string timeNow()
{
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    std::array<char, 64> text{};
    return {text.data(), std::strftime(text.data(), text.size(), "%Y-%m-%dT%H:%M:%S%z", &local)};
}

/// As no-color.org has it.
bool isColourWanted()
{
    const char* const value = std::getenv("NO_COLOR");
    return value == nullptr || *value == '\0';
}

bool endsWatching(int signal)
{
    return signal == SIGINT || signal == SIGTERM || signal == SIGHUP;
}

class Watching
{
public:
    Watching(const Watch& command, Broker& broker) : command_(command), broker_(broker) {}

    /// \return the status of the answer
    cim::Status ask()
    {
        const cim::Answer answer = broker_.enumerateInstances(command_.target, std::nullopt);
        news_ = watched_.take(answer, timeNow());
        return answer.status;
    }

    void showLines()
    {
        std::string text;
        for (const std::string& line : news_)
            text += line + '\n';
        writeNow(text);
    }

    void showScreen(const Terminal& terminal) const
    {
        const std::string title =
            cim::printable(command_.target.className + " in " + command_.target.nameSpace);
        terminal.show(watched_.frame(title, Terminal::size(), isColourWanted()));
    }

private:
    const Watch& command_;
    Broker& broker_;
    Watched watched_;
    std::vector<std::string> news_;
};

void watchAsLines(Watching& watching, std::chrono::milliseconds interval)
{
    const HeldSignals signals{SIGINT, SIGTERM, SIGHUP};
    watching.showLines();
    while (signals.waitUntil(Clock::now() + interval) == 0) {
        watching.ask();
        watching.showLines();
    }
}

void watchOnTerminal(Watching& watching, std::chrono::milliseconds interval)
{
    const HeldSignals signals{SIGINT, SIGTERM, SIGHUP, SIGWINCH, SIGTSTP, SIGCONT};
    std::optional<Terminal> terminal(std::in_place);
    Clock::time_point next = Clock::now() + interval;
    for (int signal = 0; !endsWatching(signal); signal = signals.waitUntil(next)) {
        if (signal == SIGTSTP) {
            terminal.reset();
            raise(SIGSTOP); // goes on here when it is continued
            terminal.emplace();
        } else if (signal == 0 && Clock::now() >= next) {
            watching.ask();
            next = Clock::now() + interval;
        }
        watching.showScreen(*terminal);
    }
}

} // namespace

ExitStatus watchUntilSignal(const Watch& command, Broker& broker, bool isTerminal, std::ostream& err)
{
    Watching watching(command, broker);
    const cim::Status first = watching.ask();
    if (first.code != CMPI_RC_OK) {
        err << "cimhost: " << statusLine(first) << '\n';
        return exitError;
    }
    try {
        if (isTerminal)
            watchOnTerminal(watching, command.interval);
        else
            watchAsLines(watching, command.interval);
        return exitAnswered;
    } catch (const std::system_error& error) {
        // A reader that has seen enough, such as head, needs no message.
        if (error.code() == std::errc::broken_pipe)
            return exitError;
        throw;
    }
}

} // namespace cimhost::cli
