// Asks each support library that reads the environment, and says what it answered: whether the process is privileged
// (1 or 0), the language, a text, and the indicators. An error goes to the log.

#include <MVLog/MVLogger.h>
#include <Tavro/Instrumentation.h>
#include <Tavro/Locale.h>

#include <iostream>

#include <sys/auxv.h>

int main()
{
    MVLog::MVLogger::logLevelMessage("main", "Program.cpp", __LINE__, "Mavrel.Test", 6000, nullptr, 0, 0,
                                     "an error");

    const Tavro::ResourceString caption(Tavro::Locale::getResourceLibrary(2, "en"),
                                        L"MSGID_ALARMDEVICE_CAPTION");
    std::cout << getauxval(AT_SECURE) << '\n'
              << Tavro::Locale::getLanguageId() << '\n'
              << Tavro::make_string(caption) << '\n';

    Tavro::Instrumentation cursor;
    for (cursor.selectNode(Tavro::NodeLexicon::DiagnosticIndicator); cursor; ++cursor)
        std::cout << cursor.getNodeDescription() << '\n';
}
