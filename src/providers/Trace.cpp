#include "Trace.h"

#include <MVLog/MVLogger.h>

#include <cstddef>
#include <cstdio>
#include <cstring>
#include <mutex>

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

const char* printable(const char* text)
{
    return text != nullptr ? text : "(null)";
}

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
    text = printable(text);
    file = printable(file);
    parameters = printable(parameters);
    const auto number = static_cast<int>(line);
    char* const buffer = parameterLineBuffer;
    std::memset(buffer, 0, bufferSize);
    switch (type) {
    case MessageType::Exiting:
        std::snprintf(buffer, bufferSize, "EXITING: %s() in %s [Line: %d],Parameters List: %s", text, file,
                      number, parameters);
        break;
    case MessageType::Method:
        std::snprintf(buffer, bufferSize, "METHOD: %s() was invoked in %s [Line: %d],Parameters List: %s",
                      text, file, number, parameters);
        break;
    case MessageType::Message:
        std::snprintf(buffer, bufferSize, "MESSAGE [File: %s, Line: %d]: %s,Parameters List: %s", file,
                      number, text, parameters);
        break;
    case MessageType::Entering:
    default:
        std::snprintf(buffer, bufferSize, "ENTERING: %s() in %s [Line: %d],Parameters List: %s", text, file,
                      number, parameters);
        break;
    }
    return buffer;
}

const char* trace(const char* text, const char* file, unsigned int line, MessageType /*type*/)
{
    std::memset(messageLineBuffer, 0, bufferSize);
    std::snprintf(messageLineBuffer, bufferSize, "MESSAGE [File: %s, Line: %d]: %s", printable(file),
                  static_cast<int>(line), printable(text));
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
