#include "Log.h"

#include "DescriptorSink.h"
#include "Settings.h"

#include <atomic>
#include <limits>
#include <memory>
#include <mutex>

#include <spdlog/fmt/fmt.h>
#include <spdlog/logger.h>

namespace MVLog {
namespace {

constexpr int notRead = std::numeric_limits<int>::min();

// All three are set up at compile time and need no destructor, so that objects constructed earlier or
// destroyed later than anything of this library can log.
std::atomic<int> leastLevel{notRead};
std::mutex access; ///< guards `logger`
spdlog::logger* logger = nullptr;

std::shared_ptr<DescriptorSink> openSink(Settings& settings)
{
    if (settings.file.empty())
        return std::make_shared<DescriptorSink>();
    try {
        return std::make_shared<DescriptorSink>(settings.file);
    } catch (const spdlog::spdlog_ex& error) {
        settings.complaints.push_back("MVLOG_FILE: " + std::string(error.what()) +
                                      ", expected a file to append to; taking standard error");
        return std::make_shared<DescriptorSink>();
    }
}

/// One line stays one line, and a terminal is sent no commands.
std::string withControlCharactersEscaped(const std::string& text)
{
    std::string escaped;
    escaped.reserve(text.size());
    for (const char character : text) {
        const auto code = static_cast<unsigned char>(character);
        if (code < 0x20 || code == 0x7F)
            escaped += fmt::format("\\x{:02X}", code);
        else
            escaped += character;
    }
    return escaped;
}

/// Says on standard error what is wrong with the log itself.
void complain(const std::string& complaint)
{
    spdlog::logger("mvlog", std::make_shared<DescriptorSink>()).warn(withControlCharactersEscaped(complaint));
}

std::unique_ptr<spdlog::logger> openLogger(Settings& settings)
{
    auto opened = std::make_unique<spdlog::logger>("mvlog", openSink(settings));
    opened->set_pattern("%Y-%m-%dT%H:%M:%S.%e%z [%P:%t] %v");
    opened->set_error_handler([hasComplained = false](const std::string& reason) mutable {
        if (!hasComplained)
            complain("a log line is lost: " + reason);
        hasComplained = true;
    });
    return opened;
}

/// Opens the log unless it is open. Needs `access`.
void open()
{
    if (logger != nullptr)
        return;
    Settings settings = readSettings();
    logger = openLogger(settings).release();
    leastLevel = settings.leastLevel;
    for (const std::string& complaint : settings.complaints)
        complain(complaint);
}

/// Runs when the library is unloaded or, at the end of the process, after the static objects of all
/// that use it are gone.
[[gnu::destructor]] void close()
{
    const std::lock_guard<std::mutex> guard(access);
    delete logger;
    logger = nullptr;
}

const char* orUnknown(const char* text)
{
    return text == nullptr ? "?" : text;
}

std::string format(const Line& line)
{
    return withControlCharactersEscaped(fmt::format("{} {} {} {}() {}:{}: {}", line.level, line.channel,
                                                    line.category, orUnknown(line.function),
                                                    orUnknown(line.file), line.line, line.text));
}

} // namespace

void write(const Line& line)
{
    if (line.level < leastLevel.load(std::memory_order_relaxed))
        return;
    const std::lock_guard<std::mutex> guard(access);
    open();
    if (line.level >= leastLevel)
        logger->info(format(line));
}

} // namespace MVLog
