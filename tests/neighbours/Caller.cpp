// Calls each function of one support library, by a function for each library. All return what came back as a text that
// lasts until the next call.

#include <MVLog/MVLogger.h>
#include <MVLog/MVMessageBuffer.h>
#include <Tavro/Common.h>
#include <Tavro/Instrumentation.h>
#include <Tavro/Locale.h>
#include <Tavro/NodeLexicon.h>

#include <string>

namespace {

const char* lasting(const std::string& text)
{
    static std::string last;
    last = text;
    return last.c_str();
}

} // namespace

extern "C" {

const char* calls_of_mvlog()
{
    MVLog::MVMessageBuffer buffer;
    buffer << "text " << std::string("string ") << true << static_cast<const void*>(nullptr);
    MVLog::MVLogger::logLevelMessage("function", "file", 1, "category", 9000, nullptr, 0, 0, buffer.str());
    MVLog::MVLogger::traceLevelMessage("function", "file", 1, "category", 9000, nullptr, 0, 0, buffer.str());
    return lasting(buffer.str());
}

const char* calls_of_tavro_common()
{
    return lasting(Tavro::stripSpaces(" " + Tavro::getSystemName() + " ") +
                   (Tavro::isObjPathsEqual(nullptr, nullptr, true) ? " equal" : " not equal"));
}

const char* calls_of_tavro_locale()
{
    const std::wstring library = Tavro::Locale::getResourceLibrary(2, Tavro::Locale::getLanguageId());
    const Tavro::ResourceString caption(library, L"MSGID_ALARMDEVICE_CAPTION");
    return lasting(Tavro::make_string(library) + ' ' + Tavro::make_string(caption));
}

const char* calls_of_tavro_instrumentation()
{
    std::string all;
    unsigned int value = 0;
    Tavro::Instrumentation cursor;
    for (cursor.selectNode(static_cast<Tavro::NodeLexicon::NodeType>(36)); cursor; ++cursor) {
        const bool has = cursor.getProperty(static_cast<Tavro::NodeLexicon::Properties>(1), value);
        all += cursor.convertPathToString(cursor.getPathToNode()) + cursor.getNodeDescription() +
               std::to_string(cursor.getNodeStatus()) + (has ? std::to_string(value) : "-");
    }
    return lasting(all);
}
}
