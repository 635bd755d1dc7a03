#include "cli/Watch.h"

#include "cim/Utf8.h"
#include "cli/Output.h"
#include "cli/Signals.h"
#include "cli/watch/CapturedErrors.h"
#include "cli/watch/Terminal.h"
#include "cli/watch/View.h"

#include <array>
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

std::string timeNow(bool withDate)
{
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    std::array<char, 64> text{};
    return {text.data(), withDate ? std::strftime(text.data(), text.size(), "%Y-%m-%dT%H:%M:%S%z", &local)
                                  : std::strftime(text.data(), text.size(), "%H:%M:%S", &local)};
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
    /// \param withDate  whether it is said of what was seen
    Watching(const Watch& command, Broker& broker, bool withDate)
        : command_(command),
          broker_(broker),
          withDate_(withDate),
          watched_(command.isWide)
    {}

    /// \return the status of the answer
    cim::Status ask()
    {
        const cim::Answer answer = broker_.enumerateInstances(command_.target, std::nullopt);
        news_ = watched_.take(answer, timeNow(withDate_));
        return answer.status;
    }

    void showLines()
    {
        std::string text;
        for (const std::string& line : news_)
            text += line + '\n';
        writeNow(text);
    }

    void showScreen(const Terminal& terminal, const std::vector<std::string>& messages)
    {
        const std::string title =
            cim::printable(command_.target.className + " in " + command_.target.nameSpace);
        watched_.tell(messages);
        terminal.show(watched_.frame(title, Terminal::size(), isColourWanted()));
    }

private:
    const Watch& command_;
    Broker& broker_;
    bool withDate_;
    Watched watched_;
    std::vector<std::string> news_;
};

ExitStatus refuse(const cim::Status& status, std::ostream& err)
{
    err << "cimhost: " << statusLine(status) << '\n';
    return exitError;
}

ExitStatus watchAsLines(const Watch& command, Broker& broker, std::ostream& err)
{
    Watching watching(command, broker, true);
    if (const cim::Status first = watching.ask(); first.code != CMPI_RC_OK)
        return refuse(first, err);
    const HeldSignals signals{SIGINT, SIGTERM, SIGHUP};
    while (true) {
        watching.showLines();
        const HeldSignals::Wakeup wakeup =
            signals.waitUntil(Clock::now() + command.interval, STDOUT_FILENO, false);
        if (wakeup.signal != 0)
            return exitAnswered;
        if (wakeup.isReady) // nobody reads it any more
            return exitError;
        watching.ask();
    }
}

ExitStatus watchOnTerminal(const Watch& command, Broker& broker, std::ostream& err)
{
    std::optional<CapturedErrors> errors(std::in_place);
    Watching watching(command, broker, false);
    if (const cim::Status first = watching.ask(); first.code != CMPI_RC_OK) {
        errors.reset();
        return refuse(first, err);
    }
    const HeldSignals signals{SIGINT, SIGTERM, SIGHUP, SIGWINCH, SIGTSTP, SIGCONT};
    std::optional<Terminal> terminal(std::in_place);
    Clock::time_point next = Clock::now() + command.interval;
    while (true) {
        watching.showScreen(*terminal, errors->take());
        const HeldSignals::Wakeup wakeup = signals.waitUntil(next, terminal->keyboard(), true);
        if (endsWatching(wakeup.signal) || (wakeup.isReady && terminal->isEndAsked()))
            return exitAnswered;
        if (wakeup.signal == SIGTSTP) {
            terminal.reset();
            errors.reset();
            raise(SIGSTOP); // goes on here when it is continued
            errors.emplace();
            terminal.emplace();
        } else if (Clock::now() >= next) {
            watching.ask();
            next = Clock::now() + command.interval;
        }
    }
}

} // namespace

ExitStatus watchUntilSignal(const Watch& command, Broker& broker, bool isTerminal, std::ostream& err)
{
    try {
        return isTerminal ? watchOnTerminal(command, broker, err) : watchAsLines(command, broker, err);
    } catch (const std::system_error& error) {
        // A reader that has seen enough, such as head, needs no message.
        if (error.code() == std::errc::broken_pipe)
            return exitError;
        throw;
    }
}

} // namespace cimhost::cli
