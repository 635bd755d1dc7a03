#include "Formatters.h"

#include "Escape.h"

#include <array>
#include <cerrno>
#include <ctime>
#include <iterator>
#include <string_view>

#include <spdlog/details/os.h>
#include <spdlog/fmt/fmt.h>
#include <spdlog/pattern_formatter.h>

#include <syslog.h>

namespace MVLog {
namespace {

int severity(spdlog::level::level_enum level)
{
    switch (level) {
    case spdlog::level::debug:
        return LOG_DEBUG;
    case spdlog::level::info:
        return LOG_INFO;
    default:
        return LOG_ERR;
    }
}

std::string_view viewOf(spdlog::string_view_t text)
{
    return {text.data(), text.size()};
}

class SyslogFormatter : public spdlog::formatter
{
public:
    void format(const spdlog::details::log_msg& message, spdlog::memory_buf_t& datagram) override
    {
        // In English whatever the process's locale is.
        static constexpr std::array months{"Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                           "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
        const std::tm time = spdlog::details::os::localtime(spdlog::log_clock::to_time_t(message.time));
        fmt::format_to(std::back_inserter(datagram), "<{}>{} {:2} {:02}:{:02}:{:02} {}[{}]: {}",
                       LOG_DAEMON | severity(message.level), months.at(static_cast<std::size_t>(time.tm_mon)),
                       time.tm_mday, time.tm_hour, time.tm_min, time.tm_sec,
                       printable(program_invocation_short_name), spdlog::details::os::pid(),
                       viewOf(message.payload));
    }

    [[nodiscard]] std::unique_ptr<spdlog::formatter> clone() const override { return syslogFormatter(); }
};

class JournalFormatter : public spdlog::formatter
{
public:
    void format(const spdlog::details::log_msg& message, spdlog::memory_buf_t& datagram) override
    {
        // A value of one line stands behind its name, so no value may have a newline.
        const auto add = [&](const char* field, std::string_view value) {
            fmt::format_to(std::back_inserter(datagram), "{}={}\n", field, printable(value));
        };
        add("MESSAGE", viewOf(message.payload));
        add("PRIORITY", std::to_string(severity(message.level)));
        add("SYSLOG_IDENTIFIER", program_invocation_short_name);
        add("CODE_FILE", message.source.filename);
        add("CODE_LINE", std::to_string(message.source.line));
        add("CODE_FUNC", message.source.funcname);
        add("MVLOG_CATEGORY", viewOf(message.logger_name));
    }

    [[nodiscard]] std::unique_ptr<spdlog::formatter> clone() const override { return journalFormatter(); }
};

} // namespace

std::unique_ptr<spdlog::formatter> lineFormatter()
{
    return std::make_unique<spdlog::pattern_formatter>("%Y-%m-%dT%H:%M:%S.%e%z [%P:%t] %v");
}

std::unique_ptr<spdlog::formatter> syslogFormatter()
{
    return std::make_unique<SyslogFormatter>();
}

std::unique_ptr<spdlog::formatter> journalFormatter()
{
    return std::make_unique<JournalFormatter>();
}

} // namespace MVLog
