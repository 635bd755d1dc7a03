#include "cli/Reports.h"

#include <sstream>

#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::cli;

namespace {

TEST(Reports, showMisuseAlways)
{
    std::ostringstream err;
    const Listeners listeners = reportTo(err, false);
    listeners.misuse("returnInstance was given null\n");
    EXPECT_EQ(err.str(), "cimhost: provider misuse: returnInstance was given null\\n\n");
    EXPECT_FALSE(listeners.trace);
    EXPECT_FALSE(listeners.log);
}

TEST(Reports, showAMisuseOnce)
{
    std::ostringstream err;
    const Listeners listeners = reportTo(err, false);
    for (int i = 0; i < 3; ++i)
        for (const char* line : {"a", "b"})
            listeners.misuse(line);
    EXPECT_EQ(err.str(), "cimhost: provider misuse: a\ncimhost: provider misuse: b\n");
}

TEST(Reports, showSomeMisusesOnly)
{
    std::ostringstream err;
    const Listeners listeners = reportTo(err, false);
    for (int i = 0; i < 2000; ++i)
        listeners.misuse(std::to_string(i));
    const std::string end =
        "cimhost: provider misuse: 999\ncimhost: provider misuse: no more is told of it\n";
    EXPECT_EQ(err.str().substr(err.str().size() - end.size()), end);
}

TEST(Reports, showTracesByLevelAndComponent)
{
    std::ostringstream err;
    const Listeners listeners = reportTo(err, true);
    listeners.trace({CMPI_LEV_INFO, "Provider", "***None  found***"});
    listeners.trace({CMPI_LEV_WARNING, "Provider", "a\nb\x1b"});
    listeners.trace({CMPI_LEV_VERBOSE, "", "text"});
    listeners.trace({static_cast<CMPILevel>(0), "P", ""});
    EXPECT_EQ(err.str(), "cimhost: trace INFO Provider: ***None  found***\n"
                         "cimhost: trace WARNING Provider: a\\nb\\x001B\n"
                         "cimhost: trace VERBOSE: text\n"
                         "cimhost: trace level 0 P: \n");
}

TEST(Reports, showLogMessagesBySeverityAndId)
{
    std::ostringstream err;
    const Listeners listeners = reportTo(err, true);
    listeners.log({CMPI_SEV_ERROR, "ID1", "a"});
    listeners.log({CMPI_SEV_INFO, "ID2", "b"});
    listeners.log({CMPI_SEV_WARNING, "ID3", "c"});
    listeners.log({CMPI_DEV_DEBUG, "", "d"});
    listeners.log({static_cast<CMPISeverity>(0), "", "e"});
    EXPECT_EQ(err.str(), "cimhost: log ERROR ID1: a\n"
                         "cimhost: log INFO ID2: b\n"
                         "cimhost: log WARNING ID3: c\n"
                         "cimhost: log DEBUG: d\n"
                         "cimhost: log severity 0: e\n");
}

} // namespace
