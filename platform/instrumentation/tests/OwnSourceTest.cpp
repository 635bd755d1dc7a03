// A source that is not of sysfs takes a row of the table and a reader, as here: the tests' own table stands
// in for src/sources/NodeSources.cpp.

#include "ErrorLine.h"
#include "sources/NodeSource.h"

#include <Tavro/Instrumentation.h>

#include "testing/Environment.h"
#include "testing/RecordedLog.h"
#include "testing/TemporaryDirectory.h"

#include <filesystem>
#include <fstream>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using testing::ElementsAre;
using Testing::Environment;
using testing::IsEmpty;
using Testing::TemporaryDirectory;

const std::string& lampList()
{
    static const TemporaryDirectory directory;
    static const std::string file = directory.path("lamps");
    return file;
}

/// A lamp for each line of a file.
void appendLamps(const std::string& place, Tavro::Sysfs& /*sysfs*/, std::vector<Tavro::Node>& nodes)
{
    std::ifstream list(place);
    if (!list)
        Tavro::logError({"appendLamps", "OwnSourceTest.cpp", __LINE__}, place + ": expected a list of lamps");
    for (std::string name; std::getline(list, name);)
        nodes.push_back({Tavro::NodeLexicon::DiagnosticIndicator, name, name, 1, std::nullopt,
                         std::make_unique<const std::string>("lamp " + name)});
}

} // namespace

namespace Tavro {

NodeReader appendLeds;

std::vector<NodeSource> nodeSources()
{
    return {{"lamps", lampList(), appendLamps}, {"leds", "/sys/class/leds", appendLeds}};
}

} // namespace Tavro

namespace {

class OwnSource : public testing::Test
{
protected:
    OwnSource()
    {
        std::ofstream(lampList()) << "Left Lamp\nRight Lamp\n";
        (void)tree.file("class/leds/red/brightness", "1\n");
    }
    ~OwnSource() override { EXPECT_THAT(RecordedLog::take(), IsEmpty()); }

    void useFile(const std::string& json) { inventory.set(tree.file("inventory.json", json)); }

    static std::vector<std::string> descriptions()
    {
        std::vector<std::string> found;
        Tavro::Instrumentation cursor;
        for (cursor.selectNode(Tavro::NodeLexicon::DiagnosticIndicator); cursor; ++cursor)
            found.push_back(cursor.getNodeDescription());
        return found;
    }

    static std::vector<std::string> logged()
    {
        std::vector<std::string> texts;
        for (const RecordedLog::Line& line : RecordedLog::take())
            texts.push_back(line.text);
        return texts;
    }

    TemporaryDirectory tree;
    Environment root{"TAVRO_SYSFS_ROOT", tree.path().string()};
    Environment inventory{"TAVRO_INVENTORY", std::nullopt};
};

TEST_F(OwnSource, isReadInTheOrderOfTheTable)
{
    EXPECT_THAT(descriptions(), ElementsAre("Left Lamp", "Right Lamp", "Red LED"));
}

TEST_F(OwnSource, isNamedByAnInventoryFile)
{
    useFile(R"({"sources":["leds","lamps"]})");
    EXPECT_THAT(descriptions(), ElementsAre("Red LED", "Left Lamp", "Right Lamp"));
}

TEST_F(OwnSource, isAmongTheNamesThatAreExpected)
{
    useFile(R"({"sources":["enclosures"]})");
    EXPECT_THAT(descriptions(), IsEmpty());
    EXPECT_THAT(logged(),
                ElementsAre(tree.path("inventory.json") +
                            R"(: /sources/0: expected one of "lamps", "leds", found "enclosures")"));
}

TEST_F(OwnSource, isReadWithoutSysfs)
{
    root.set("/nowhere");
    useFile(R"({"sources":["lamps"]})");
    EXPECT_THAT(descriptions(), ElementsAre("Left Lamp", "Right Lamp"));
    EXPECT_THAT(logged(), IsEmpty());

    inventory.set(std::nullopt);
    EXPECT_THAT(descriptions(), ElementsAre("Left Lamp", "Right Lamp"));
    EXPECT_THAT(logged(), ElementsAre("/nowhere: expected a directory of sysfs: No such file or directory"));
}

TEST_F(OwnSource, mayFailAlone)
{
    std::filesystem::remove(lampList());
    EXPECT_THAT(descriptions(), ElementsAre("Red LED"));
    EXPECT_THAT(logged(), ElementsAre(lampList() + ": expected a list of lamps"));
}

TEST_F(OwnSource, saysWhatIsShownForAPath)
{
    Tavro::Instrumentation cursor;
    cursor.selectNode(Tavro::NodeLexicon::DiagnosticIndicator);
    EXPECT_EQ(cursor.convertPathToString(cursor.getPathToNode()), "lamp Left Lamp");
}

} // namespace
