// Every function of the support libraries that the library calls, defined here ahead of the libraries' own:
// linked into an executable, it stands before them for all that the process loads. Each is a plain function
// under the linker's name of the original, with a member function's object as its first argument; this is how
// the platform's C++ calls members. FloorTest shows that none is missing.

#include "Recorder.h"

#include <MVLog/MVMessageBuffer.h>
#include <Tavro/Instrumentation.h>
#include <Tavro/Locale.h>

#include <dlfcn.h>

namespace bench {

namespace {

/// \tparam Function  one of this file
template <auto Function>
struct Forward;

template <class Result, class... Parameters, Result (*Function)(Parameters...)>
struct Forward<Function> : Recorded<Forward<Function>, Result, Parameters...>
{
    /// \param linkerName  the original's \param shownName  for people
    Forward(const char* linkerName, const char* shownName) : symbol(linkerName), name(shownName) {}

    static Result call(Parameters... parameters) { return Function(parameters...); }

    /// Hands a call on to the original.
    Result operator()(Parameters... parameters) const
    {
        if (Recorder* const recorder = Recorder::current())
            return Forward::record(*recorder, name, parameters...);
        static const auto original = reinterpret_cast<Result (*)(Parameters...)>(dlsym(RTLD_NEXT, symbol));
        return original(parameters...);
    }

    const char* symbol;
    const char* name;
};

} // namespace

struct Buffer : Held
{};
struct Cursor : Held
{};
struct Resource : Held
{};

static_assert(sizeof(MVLog::MVMessageBuffer) <= sizeof(Tape::Word) &&
              sizeof(Tavro::Instrumentation) <= sizeof(Tape::Word) &&
              sizeof(Tavro::ResourceString) <= sizeof(Tape::Word));

using Text = const std::string&;
using WideText = const std::wstring&;

// NOLINTBEGIN(bugprone-macro-parentheses): a declarator, and arguments that bring theirs
#define FORWARD(Result, name, symbol, parameters, arguments)                                                 \
    Result name parameters __asm__(symbol);                                                                  \
    Result name parameters                                                                                   \
    {                                                                                                        \
        return Forward<&name>(symbol, #name) arguments;                                                      \
    }

// NOLINTEND(bugprone-macro-parentheses)

// Logging.

#define STRING "RKNSt7__cxx1112basic_stringIcSt11char_traitsIcESaIcEEE"
#define WIDE_STRING "NSt7__cxx1112basic_stringIwSt11char_traitsIwESaIwEEE"

#define LOG_LINE                                                                                             \
    (const char* function, const char* file, int line, Text category, int level, const char* reserved,       \
     int first, int second, Text text)
#define LOG_ARGUMENTS (function, file, line, category, level, reserved, first, second, text)

FORWARD(void, logLevelMessage, "_ZN5MVLog8MVLogger15logLevelMessageEPKcS2_i" STRING "iS2_iiSA_", LOG_LINE,
        LOG_ARGUMENTS)
FORWARD(void, traceLevelMessage, "_ZN5MVLog8MVLogger17traceLevelMessageEPKcS2_i" STRING "iS2_iiSA_", LOG_LINE,
        LOG_ARGUMENTS)
FORWARD(void, makeBuffer, "_ZN5MVLog15MVMessageBufferC1Ev", (Buffer * buffer), (buffer))
FORWARD(void, endBuffer, "_ZN5MVLog15MVMessageBufferD1Ev", (Buffer * buffer), (buffer))
FORWARD(Buffer&, insertText, "_ZN5MVLog15MVMessageBufferlsEPKc", (Buffer * buffer, const char* text),
        (buffer, text))
FORWARD(Buffer&, insertAddress, "_ZN5MVLog15MVMessageBufferlsEPKv", (Buffer * buffer, const void* address),
        (buffer, address))
FORWARD(Buffer&, insertFlag, "_ZN5MVLog15MVMessageBufferlsEb", (Buffer * buffer, bool flag), (buffer, flag))
FORWARD(std::string, str, "_ZNK5MVLog15MVMessageBuffer3strB5cxx11Ev", (const Buffer* buffer), (buffer))

// Instrumentation.

FORWARD(void, makeCursor, "_ZN5Tavro15InstrumentationC1Ev", (Cursor * cursor), (cursor))
FORWARD(void, endCursor, "_ZN5Tavro15InstrumentationD1Ev", (Cursor * cursor), (cursor))
FORWARD(void, selectNode, "_ZN5Tavro15Instrumentation10selectNodeENS_11NodeLexicon8NodeTypeE",
        (Cursor * cursor, Tavro::NodeLexicon::NodeType kind), (cursor, kind))
FORWARD(bool, isOnNode, "_ZNK5Tavro15InstrumentationcvbEv", (const Cursor* cursor), (cursor))
FORWARD(Cursor&, step, "_ZN5Tavro15InstrumentationppEv", (Cursor * cursor), (cursor))
FORWARD(std::string, getPathToNode, "_ZNK5Tavro15Instrumentation13getPathToNodeB5cxx11Ev",
        (const Cursor* cursor), (cursor))
FORWARD(std::string, convertPathToString, "_ZNK5Tavro15Instrumentation19convertPathToStringE" STRING,
        (const Cursor* cursor, Text path), (cursor, path))
FORWARD(std::string, getNodeDescription, "_ZNK5Tavro15Instrumentation18getNodeDescriptionB5cxx11Ev",
        (const Cursor* cursor), (cursor))
FORWARD(unsigned int, getNodeStatus, "_ZNK5Tavro15Instrumentation13getNodeStatusEv", (const Cursor* cursor),
        (cursor))
FORWARD(bool, getProperty, "_ZNK5Tavro15Instrumentation11getPropertyENS_11NodeLexicon10PropertiesERj",
        (const Cursor* cursor, Tavro::NodeLexicon::Properties property, unsigned int& value),
        (cursor, property, value))

// Common.

FORWARD(std::string, getSystemName, "_ZN5Tavro13getSystemNameB5cxx11Ev", (), ())
FORWARD(std::string, stripSpaces, "_ZN5Tavro11stripSpacesE" STRING, (Text text), (text))
FORWARD(bool, isObjPathsEqual, "_ZN5Tavro15isObjPathsEqualEPK15_CMPIObjectPathS2_b",
        (const CMPIObjectPath* a, const CMPIObjectPath* b, bool deep), (a, b, deep))

// Locale.

FORWARD(std::string, getLanguageId, "_ZN5Tavro6Locale13getLanguageIdB5cxx11Ev", (), ())
FORWARD(std::wstring, getResourceLibrary, "_ZN5Tavro6Locale18getResourceLibraryEi" STRING,
        (int library, Text language), (library, language))
FORWARD(void, makeResource, "_ZN5Tavro14ResourceStringC1ERK" WIDE_STRING "S8_",
        (Resource * resource, WideText library, WideText messageId), (resource, library, messageId))
FORWARD(void, endResource, "_ZN5Tavro14ResourceStringD1Ev", (Resource * resource), (resource))
FORWARD(std::wstring, textOf, "_ZNK5Tavro14ResourceStringcv" WIDE_STRING "Ev", (const Resource* resource),
        (resource))
FORWARD(std::string, make_string, "_ZN5Tavro11make_stringERK" WIDE_STRING, (WideText text), (text))

#undef FORWARD

} // namespace bench
