#include "Trace.h"

#include <MVLog/MVLogger.h>

#include <algorithm>
#include <charconv>
#include <cstddef>
#include <cstring>
#include <iterator>
#include <limits>
#include <string_view>

namespace Tavro {

namespace {

constexpr std::size_t bufferSize = 512;
constexpr int flowLevel = 3000;
constexpr int errorLevel = 6000;

using Buffer = char[bufferSize];

/// A text in a buffer, put together piece by piece and ended at last; what is longer than the buffer is cut.
class Line
{
public:
    explicit Line(Buffer& buffer) : next(buffer), last(buffer + bufferSize - 1) {}
    ~Line() { *next = '\0'; }

    Line(const Line&) = delete;
    Line& operator=(const Line&) = delete;

    Line& operator<<(const char* text)
    {
        return *this << std::string_view(text != nullptr ? text : "(null)");
    }

    Line& operator<<(std::string_view characters)
    {
        next = std::copy_n(characters.data(), std::min(characters.size(), room()), next);
        return *this;
    }

    Line& operator<<(int number)
    {
        char digits[std::numeric_limits<int>::digits10 + 2]; // a sign, all digits
        const auto* const end = std::to_chars(std::begin(digits), std::end(digits), number).ptr;
        return *this << std::string_view(std::begin(digits), static_cast<std::size_t>(end - digits));
    }

private:
    [[nodiscard]] std::size_t room() const { return static_cast<std::size_t>(last - next); }

    char* next;
    char* last; ///< of the buffer
};

template <class Parameters>
void formatWithParameters(Buffer& buffer, const char* text, const char* file, int number,
                          Parameters parameters, MessageType type)
{
    Line line(buffer);
    switch (type) {
    case MessageType::Exiting:
        line << "EXITING: " << text << "() in " << file << " [Line: " << number << "]";
        break;
    case MessageType::Method:
        line << "METHOD: " << text << "() was invoked in " << file << " [Line: " << number << "]";
        break;
    case MessageType::Message:
        line << "MESSAGE [File: " << file << ", Line: " << number << "]: " << text;
        break;
    case MessageType::Entering:
    default:
        line << "ENTERING: " << text << "() in " << file << " [Line: " << number << "]";
        break;
    }
    line << ",Parameters List: " << parameters;
}

void formatMessage(Buffer& buffer, const char* text, const char* file, int number)
{
    Line(buffer) << "MESSAGE [File: " << file << ", Line: " << number << "]: " << text;
}

/// The line that `format` leaves in a buffer, read back from a fresh message buffer.
template <class Format>
std::string messageText(Format format)
{
    Buffer buffer;
    format(buffer);
    MVLog::MVMessageBuffer message;
    message << static_cast<const char*>(buffer);
    return message.str();
}

/// Hands the line to the log and then to the trace, formatted anew for each.
template <class Format>
void emit(const TraceModule& module, const char* function, int number, int level, Format format)
{
    MVLog::MVLogger::logLevelMessage(function, module.file, number, module.category, level, nullptr, 0, 0,
                                     messageText(format));
    MVLog::MVLogger::traceLevelMessage(function, module.file, number, module.category, level, nullptr, 0, 0,
                                       messageText(format));
}

} // namespace

const char* tracepara(const char* text, const char* file, unsigned int line, const char* parameters,
                      MessageType type)
{
    static Buffer buffer;
    std::memset(buffer, 0, bufferSize);
    formatWithParameters(buffer, text, file, static_cast<int>(line), parameters, type);
    return buffer;
}

const char* trace(const char* text, const char* file, unsigned int line, MessageType /*type*/)
{
    static Buffer buffer;
    std::memset(buffer, 0, bufferSize);
    formatMessage(buffer, text, file, static_cast<int>(line));
    return buffer;
}

void TracedFunction::error(const char* text, unsigned int line) const
{
    const auto number = static_cast<int>(line);
    emit(module, function, number, errorLevel,
         [&](Buffer& buffer) { formatMessage(buffer, text, module.file, number); });
}

void TracedFunction::flow(MessageType type, const std::string& parameters, unsigned int line) const
{
    const auto number = static_cast<int>(line);
    emit(module, function, number, flowLevel, [&](Buffer& buffer) {
        formatWithParameters(buffer, function, module.file, number, std::string_view(parameters), type);
    });
}

} // namespace Tavro
