#include "Log.h"

#include "DatagramSink.h"
#include "Escape.h"
#include "FileSink.h"
#include "Formatters.h"
#include "Settings.h"
#include "StandardErrorSink.h"

#include <HeldOverFork.h>

#include <cstdlib>
#include <limits>
#include <memory>
#include <mutex>
#include <utility>
#include <vector>

#include <spdlog/fmt/fmt.h>

#include <unistd.h>

namespace MVLog {
namespace {

constexpr std::int64_t notRead = std::numeric_limits<std::int64_t>::min();
constexpr int flowLevel = 3000;
constexpr int errorLevel = 6000;

const char* orUnknown(const char* text)
{
    return text == nullptr ? "?" : text;
}

spdlog::level::level_enum severityOf(int level)
{
    if (level >= errorLevel)
        return spdlog::level::err;
    return level > flowLevel ? spdlog::level::info : spdlog::level::debug;
}

/// Hands a line to a sink. \throw spdlog::spdlog_ex when it cannot be written
void log(spdlog::sinks::sink& sink, const char* channel, const Line& line)
{
    const std::string text =
        printable(fmt::format("{} {} {} {}() {}:{}: {}", line.level, channel, line.category,
                              orUnknown(line.function), orUnknown(line.file), line.line, line.text));
    // Deliberate: the fields one by one. The constructors ask for the thread's number in a way that ends the process
    // where the memory has run out, and that answers a forked child with its parent's. Test:
    // Fork.aChildLogsItsOwnProcessAndThread, RealLibraries.
    spdlog::details::log_msg message;
    message.logger_name = line.category;
    message.level = severityOf(line.level);
    message.time = spdlog::log_clock::now();
    message.thread_id = static_cast<std::size_t>(gettid());
    message.source = {orUnknown(line.file), line.line, orUnknown(line.function)};
    message.payload = text;
    sink.log(message);
}

/// Says on standard error what is wrong with the log itself.
void complain(const std::string& complaint)
{
    StandardErrorSink sink;
    sink.set_formatter(lineFormatter());
    try {
        log(sink, "log", {"complain", "Log.cpp", __LINE__, "MVLog", errorLevel, complaint});
    } catch (const spdlog::spdlog_ex&) {
        // There is nobody left to tell.
    }
}

/// A sink, and whether anybody was told yet that it fails.
class Destination
{
public:
    explicit Destination(std::shared_ptr<spdlog::sinks::sink> sink) : sink_(std::move(sink)) {}

    /// The first failure is complained of.
    void write(const char* channel, const Line& line)
    {
        try {
            log(*sink_, channel, line);
        } catch (const spdlog::spdlog_ex& error) {
            if (!std::exchange(hasComplained_, true))
                complain(error.what());
        }
    }

private:
    std::shared_ptr<spdlog::sinks::sink> sink_;
    bool hasComplained_ = false;
};

std::shared_ptr<spdlog::sinks::sink> withFormatter(std::shared_ptr<spdlog::sinks::sink> sink)
{
    sink->set_formatter(lineFormatter());
    return sink;
}

/// \throw spdlog::spdlog_ex
std::shared_ptr<spdlog::sinks::sink> open(const Output& output)
{
    switch (output.kind) {
    case Output::file:
        return withFormatter(std::make_shared<FileSink>(output.path));
    case Output::syslog:
        return std::make_shared<DatagramSink>(output.path, syslogFormatter());
    case Output::journal:
        return std::make_shared<DatagramSink>(output.path, journalFormatter());
    default:
        return withFormatter(std::make_shared<StandardErrorSink>());
    }
}

std::shared_ptr<Destination> openOrStandardError(const Output& output, std::vector<std::string>& complaints)
{
    try {
        return std::make_shared<Destination>(open(output));
    } catch (const spdlog::spdlog_ex& error) {
        const char* const expected =
            output.kind == Output::file ? "a file to append to" : "a log daemon's socket";
        complaints.push_back(std::string(output.variable) + ": " + error.what() + ", expected " + expected +
                             "; taking standard error");
        return std::make_shared<Destination>(open(Output{}));
    }
}

/// What the settings come to.
struct Log
{
    std::array<std::shared_ptr<Destination>, 2> destinations; ///< by channel, often one for both; null: off
    std::vector<std::string> categories;
};

std::mutex access; ///< guards the next two
Log* theLog = nullptr;

/// Runs before anything that uses the library is set up.
[[gnu::constructor]] void letChildrenLog()
{
    Tavro::holdOverFork<access>();
}

/// Opens the log unless it is open. Needs `access`.
void open()
{
    if (theLog != nullptr)
        return;
    Settings settings = readSettings([](const char* name) { return secure_getenv(name); });
    auto opened = std::make_unique<Log>();
    opened->categories = std::move(settings.categories);

    auto& [log, trace] = opened->destinations;
    if (settings.log.leastLevel != off)
        log = openOrStandardError(settings.log.output, settings.complaints);
    if (settings.trace.leastLevel != off)
        trace = log != nullptr && settings.trace.output == settings.log.output
                    ? log
                    : openOrStandardError(settings.trace.output, settings.complaints);

    theLog = opened.release();
    leastLevels[0] = settings.log.leastLevel;
    leastLevels[1] = settings.trace.leastLevel;
    for (const std::string& complaint : settings.complaints)
        complain(complaint);
}

/// Runs when the library is unloaded or, at the end of the process, after the static objects of all
/// that use it are gone.
[[gnu::destructor]] void close()
{
    const std::lock_guard<std::mutex> guard(access);
    delete theLog;
    theLog = nullptr;
}

} // namespace

std::array<std::atomic<std::int64_t>, 2> leastLevels{notRead, notRead};

void writeUnlessDropped(Channel channel, const Line& line)
{
    const auto number = static_cast<std::size_t>(channel);
    const std::lock_guard<std::mutex> guard(access);
    open();
    if (line.level >= leastLevels[number] && isWanted(theLog->categories, line.category))
        theLog->destinations[number]->write(channel == Channel::log ? "log" : "trace", line);
}

} // namespace MVLog
