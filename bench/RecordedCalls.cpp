#include "RecordedCalls.h"

#include "testing/Allocations.h"
#include "testing/MadeInventory.h"

#include <MVLog/MVLogger.h>
#include <MVLog/MVMessageBuffer.h>
#include <Tavro/Common.h>
#include <Tavro/Locale.h>

#include <regex>
#include <sstream>

#include <dlfcn.h>

namespace RecordedCalls {

namespace {

std::vector<std::string> calls;

std::string quoted(const std::string& text)
{
    return '"' + text + '"';
}

std::string withoutNumbers(const std::string& text)
{
    static const std::regex addresses("0x[0-9a-f]+");
    static const std::regex lines("Line: [0-9]+");
    return std::regex_replace(std::regex_replace(text, addresses, "ADDRESS"), lines, "Line: LINE");
}

/// \param write  returns the call's text
template <class Write>
void record(Write write)
{
    const Allocations::Pause pause; // the record is not the library's
    calls.push_back(withoutNumbers(write()));
}

void record(const char* call)
{
    record([=] { return std::string(call); });
}

std::string narrow(const std::wstring& text)
{
    return {text.begin(), text.end()};
}

} // namespace

std::vector<std::string> all()
{
    return calls;
}

std::size_t count()
{
    return calls.size();
}

void clear()
{
    calls.clear();
    MadeInventory::tell([](const std::string& call) { record([&] { return call; }); });
}

} // namespace RecordedCalls

using RecordedCalls::quoted;
using RecordedCalls::record;

// Logging.

namespace MVLog {

namespace {

std::string lineText(const char* channel, const char* function, const char* file, const std::string& category,
                     int level, const char* reserved, int first, int second, const std::string& text)
{
    std::ostringstream call;
    call << channel << '(' << function << ", " << file << ", LINE, " << category << ", " << level << ", "
         << (reserved == nullptr ? "null" : reserved) << ", " << first << ", " << second << ", "
         << quoted(text) << ')';
    return call.str();
}

} // namespace

void MVLogger::logLevelMessage(const char* function, const char* file, int /*line*/,
                               const std::string& category, int level, const char* reserved, int first,
                               int second, const std::string& text)
{
    record([&] {
        return lineText("logLevelMessage", function, file, category, level, reserved, first, second, text);
    });
}

void MVLogger::traceLevelMessage(const char* function, const char* file, int /*line*/,
                                 const std::string& category, int level, const char* reserved, int first,
                                 int second, const std::string& text)
{
    record([&] {
        return lineText("traceLevelMessage", function, file, category, level, reserved, first, second, text);
    });
}

struct MVMessageBuffer::Implementation
{
    std::ostringstream stream;
};

MVMessageBuffer::MVMessageBuffer() : implementation_(std::make_unique<Implementation>())
{
    record("MVMessageBuffer()");
}

MVMessageBuffer::~MVMessageBuffer()
{
    record("~MVMessageBuffer()");
}

MVMessageBuffer& MVMessageBuffer::operator<<(const char* text)
{
    record([&] { return "<< text " + (text == nullptr ? "null" : quoted(text)); });
    if (text != nullptr)
        implementation_->stream << text;
    else
        implementation_->stream.setstate(std::ios_base::badbit);
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(const std::string& text)
{
    record([&] { return "<< string " + quoted(text); });
    implementation_->stream << text;
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(const void* address)
{
    record(address == nullptr ? "<< null" : "<< ADDRESS");
    implementation_->stream << address;
    return *this;
}

MVMessageBuffer& MVMessageBuffer::operator<<(bool flag)
{
    record(flag ? "<< true" : "<< false");
    implementation_->stream << flag;
    return *this;
}

std::string MVMessageBuffer::str() const
{
    record("str()");
    return implementation_->stream.str();
}

} // namespace MVLog

namespace Tavro {

// Common.

std::string getSystemName()
{
    record("getSystemName()");
    return "server-with-a-name";
}

std::string stripSpaces(const std::string& text)
{
    record([&] { return "stripSpaces(" + quoted(text) + ")"; });
    return text;
}

bool isObjPathsEqual(const CMPIObjectPath* a, const CMPIObjectPath* b, bool deep)
{
    using Compare = bool (*)(const CMPIObjectPath*, const CMPIObjectPath*, bool);
    static const auto original =
        reinterpret_cast<Compare>(dlsym(RTLD_NEXT, "_ZN5Tavro15isObjPathsEqualEPK15_CMPIObjectPathS2_b"));
    record(deep ? "isObjPathsEqual(deep)" : "isObjPathsEqual()"); // the calls that it makes tell the paths
    const Allocations::Pause pause;
    return original(a, b, deep);
}

// Locale.

std::string Locale::getLanguageId()
{
    record("getLanguageId()");
    return "en_US";
}

std::wstring Locale::getResourceLibrary(int library, const std::string& language)
{
    record([&] { return "getResourceLibrary(" + std::to_string(library) + ", " + language + ")"; });
    return L"the library";
}

struct ResourceString::Implementation
{};

ResourceString::ResourceString(const std::wstring& library, const std::wstring& messageId)
{
    record([&] {
        return "ResourceString(" + RecordedCalls::narrow(library) + ", " + RecordedCalls::narrow(messageId) +
               ")";
    });
}

ResourceString::~ResourceString()
{
    record("~ResourceString()");
}

ResourceString::operator std::wstring() const
{
    record("ResourceString to wstring");
    return L"A Caption";
}

std::string make_string(const std::wstring& text)
{
    record([&] { return "make_string(" + RecordedCalls::narrow(text) + ")"; });
    return RecordedCalls::narrow(text);
}

} // namespace Tavro
