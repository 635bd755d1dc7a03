/// \file
/// Trace lines in the library's fixed formats, and their way into the logging library.
///
/// A source module names itself once and traces its functions through FunctionTrace:
///
///     const std::string loggerExample("Mavrel.Example");
///     const TraceModule module{"Example.cpp", loggerExample};
///
///     const auto parameters = [&] { return parameterList(" ref=", ref, " status=", status); };
///     const FunctionTrace flow(module, "exampleFunction");
///     flow.entering(parameters());
#ifndef TAVRO_TRACE_H
#define TAVRO_TRACE_H

#include <MVLog/MVMessageBuffer.h>

#include <string>

namespace Tavro {

/// Selects the format of a trace line.
enum class MessageType : unsigned int
{
    Entering = 0,
    Exiting = 1,
    Method = 2,
    Message = 3
};

/// Formats a line with a parameter list into a buffer of 511 characters, cutting what is longer:
///
///     Entering  ENTERING: TEXT() in FILE [Line: LINE],Parameters List: PARAMETERS
///     Exiting   EXITING: TEXT() in FILE [Line: LINE],Parameters List: PARAMETERS
///     Method    METHOD: TEXT() was invoked in FILE [Line: LINE],Parameters List: PARAMETERS
///     Message   MESSAGE [File: FILE, Line: LINE]: TEXT,Parameters List: PARAMETERS
///
/// Any other type formats as Entering. A null string prints as "(null)".
/// \return the buffer, which all threads share and the next call overwrites. FunctionTrace guards it;
///     whoever calls this function directly is on their own.
const char* tracepara(const char* text, const char* file, unsigned int line, const char* parameters,
                      MessageType type);

/// Formats "MESSAGE [File: FILE, Line: LINE]: TEXT", whatever the type, into a buffer of its own;
/// otherwise as tracepara.
const char* trace(const char* text, const char* file, unsigned int line, MessageType type);

/// A source module as its trace lines name it.
struct TraceModule
{
    const char* file;            ///< name of the source file, without folders
    const std::string& category; ///< logger category
};

/// Streams labels and values, in turn, into a message buffer: texts as texts, other pointers as
/// addresses, flags as the stream prints them. A null text ends the list, as it ends any stream.
template <class... LabelsAndValues>
std::string parameterList(const LabelsAndValues&... labelsAndValues)
{
    MVLog::MVMessageBuffer buffer;
    (buffer << ... << labelsAndValues);
    return buffer.str();
}

/// Traces one function: each line goes to the logging library's log and then to its trace, formatted
/// anew for each. Lines of several threads do not mix. The line number is the caller's.
class FunctionTrace
{
public:
    /// \param module    outlives this object
    /// \param function  the function's name, unqualified; outlives this object
    FunctionTrace(const TraceModule& module, const char* function);

    /// An ENTERING line, level 3000.
    void entering(const std::string& parameters, unsigned int line = __builtin_LINE()) const;
    /// An EXITING line, level 3000.
    void exiting(const std::string& parameters, unsigned int line = __builtin_LINE()) const;
    /// A MESSAGE line without parameters, level 6000.
    void error(const char* text, unsigned int line = __builtin_LINE()) const;

private:
    void flow(MessageType type, const std::string& parameters, unsigned int line) const;

    const TraceModule& module;
    const char* function;
};

} // namespace Tavro

#endif
