#include "Trace.h"

#include <MVLog/MVLogger.h>

#include <algorithm>
#include <charconv>
#include <cstddef>
#include <cstring>
#include <iterator>
#include <limits>
#include <mutex>
#include <string_view>
#include <utility>

namespace Tavro {

namespace {

constexpr std::size_t bufferSize = 512;
constexpr int flowLevel = 3000;
constexpr int errorLevel = 6000;

char parameterLineBuffer[bufferSize];
char messageLineBuffer[bufferSize];

// Guards both buffers from formatting until the text is copied out. A lock, and not buffers of each
// thread's own: those would be allocated at a thread's first trace line by the loader, which ends the
// process when the memory has run out.
std::mutex bufferMutex;

/// A text in one of the buffers, put together piece by piece; what is longer than the buffer is cut.
class Line
{
public:
    /// Clears the buffer.
    explicit Line(char (&emptied)[bufferSize]) : next(emptied), last(emptied + bufferSize - 1)
    {
        std::memset(emptied, 0, bufferSize);
    }

    Line& operator<<(const char* text)
    {
        const std::string_view characters = text != nullptr ? text : "(null)";
        next = std::copy_n(characters.data(), std::min(characters.size(), room()), next);
        return *this;
    }

    Line& operator<<(int number)
    {
        char digits[std::numeric_limits<int>::digits10 + 3]; // a sign, all digits, the end
        *std::to_chars(std::begin(digits), std::end(digits) - 1, number).ptr = '\0';
        return *this << std::as_const(digits);
    }

private:
    [[nodiscard]] std::size_t room() const { return static_cast<std::size_t>(last - next); }

    char* next;
    char* last; ///< stays a null character
};

/// The line that `format` leaves in one of the buffers, read back from a fresh message buffer.
template <class Format>
std::string messageText(Format format)
{
    MVLog::MVMessageBuffer message;
    const std::lock_guard lock(bufferMutex);
    message << format();
    return message.str();
}

/// Hands the line to the log and then to the trace, formatted anew for each.
template <class Format>
void emit(const TraceModule& module, const char* function, unsigned int line, int level, Format format)
{
    const auto number = static_cast<int>(line);
    MVLog::MVLogger::logLevelMessage(function, module.file, number, module.category, level, nullptr, 0, 0,
                                     messageText(format));
    MVLog::MVLogger::traceLevelMessage(function, module.file, number, module.category, level, nullptr, 0, 0,
                                       messageText(format));
}

} // namespace

const char* tracepara(const char* text, const char* file, unsigned int line, const char* parameters,
                      MessageType type)
{
    const auto number = static_cast<int>(line);
    Line buffer(parameterLineBuffer);
    switch (type) {
    case MessageType::Exiting:
        buffer << "EXITING: " << text << "() in " << file << " [Line: " << number << "]";
        break;
    case MessageType::Method:
        buffer << "METHOD: " << text << "() was invoked in " << file << " [Line: " << number << "]";
        break;
    case MessageType::Message:
        buffer << "MESSAGE [File: " << file << ", Line: " << number << "]: " << text;
        break;
    case MessageType::Entering:
    default:
        buffer << "ENTERING: " << text << "() in " << file << " [Line: " << number << "]";
        break;
    }
    buffer << ",Parameters List: " << parameters;
    return parameterLineBuffer;
}

const char* trace(const char* text, const char* file, unsigned int line, MessageType /*type*/)
{
    Line(messageLineBuffer) << "MESSAGE [File: " << file << ", Line: " << static_cast<int>(line)
                            << "]: " << text;
    return messageLineBuffer;
}

FunctionTrace::FunctionTrace(const TraceModule& tracedModule, const char* functionName)
    : module(tracedModule),
      function(functionName)
{}

void FunctionTrace::entering(const std::string& parameters, unsigned int line) const
{
    flow(MessageType::Entering, parameters, line);
}

void FunctionTrace::exiting(const std::string& parameters, unsigned int line) const
{
    flow(MessageType::Exiting, parameters, line);
}

void FunctionTrace::error(const char* text, unsigned int line) const
{
    emit(module, function, line, errorLevel,
         [&] { return trace(text, module.file, line, MessageType::Message); });
}

void FunctionTrace::flow(MessageType type, const std::string& parameters, unsigned int line) const
{
    emit(module, function, line, flowLevel,
         [&] { return tracepara(function, module.file, line, parameters.c_str(), type); });
}

} // namespace Tavro
