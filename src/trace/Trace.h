/// \file
/// Trace lines in the library's fixed formats, and their way into the logging library.
///
/// A source module names itself once and traces its functions through FunctionTrace:
///
///     const std::string loggerExample("Mavrel.Example");
///     const TraceModule module{"Example.cpp", loggerExample};
///
///     const FunctionTrace flow(module, "exampleFunction",
///                              [&] { return parameterList(" ref=", ref, " status=", status); });
///     ...
///     flow.exiting();
#ifndef TAVRO_TRACE_H
#define TAVRO_TRACE_H

#include <MVLog/MVMessageBuffer.h>

#include <string>
#include <utility>

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
/// \return the buffer, which all threads share and the next call overwrites: not safe for threads; use
///     FunctionTrace
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

/// A function by name, for those that trace on its behalf: each line goes to the logging library's log and
/// then to its trace, formatted anew for each, on the caller's own stack. Lines of several threads do not
/// mix, and none waits for another. Line numbers are the caller's.
class TracedFunction
{
public:
    /// A MESSAGE line without parameters, level 6000.
    void error(const char* text, unsigned int line = __builtin_LINE()) const;

protected:
    TracedFunction(const TraceModule& tracedModule, const char* functionName)
        : module(tracedModule),
          function(functionName)
    {}

    /// A line with parameters, level 3000.
    void flow(MessageType type, const std::string& parameters, unsigned int line) const;

private:
    const TraceModule& module;
    const char* function;
};

/// Traces the function that it stands in: an ENTERING line when it is made, an EXITING line where the
/// function says so. Not every way out of every function does. \tparam Parameters  a function without
/// arguments that builds the parameter list, for each of the two lines anew
template <class Parameters>
class FunctionTrace : public TracedFunction
{
public:
    /// \param tracedModule  outlives this object
    /// \param functionName  unqualified; outlives this object
    FunctionTrace(const TraceModule& tracedModule, const char* functionName, Parameters parameterList,
                  unsigned int line = __builtin_LINE())
        : TracedFunction(tracedModule, functionName),
          parameters(std::move(parameterList))
    {
        flow(MessageType::Entering, parameters(), line);
    }

    void exiting(unsigned int line = __builtin_LINE()) const { exiting(parameters(), line); }

    /// With another parameter list than the ENTERING line has.
    void exiting(const std::string& otherParameters, unsigned int line = __builtin_LINE()) const
    {
        flow(MessageType::Exiting, otherParameters, line);
    }

private:
    Parameters parameters;
};

} // namespace Tavro

#endif
