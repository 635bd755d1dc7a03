#include <Tavro/Instrumentation.h>

#include "testing/Allocations.h"
#include "testing/Environment.h"
#include "testing/RecordedLog.h"
#include "testing/TemporaryDirectory.h"
#include "testing/WithoutPrivileges.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <optional>
#include <ostream>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <sys/stat.h>

namespace {

using testing::EndsWith;
using Testing::Environment;
using testing::StartsWith;
using Testing::TemporaryDirectory;

class InventoryFaults : public testing::Test
{
protected:
    /// What is logged about the inventory in that file. Expects exactly one line, and no nodes.
    std::string complaintAbout(const std::string& file)
    {
        inventory.set(file);
        Tavro::Instrumentation cursor;
        // Of a kind that the faulty inventories below have before the fault.
        cursor.selectNode(Tavro::NodeLexicon::DiagnosticIndicator);
        EXPECT_FALSE(cursor);
        const std::vector<RecordedLog::Line> lines = RecordedLog::take();
        EXPECT_EQ(lines.size(), 1U);
        if (lines.empty())
            return {};
        EXPECT_EQ(lines.front().channel, RecordedLog::Channel::log);
        EXPECT_EQ(lines.front().level, 6000);
        EXPECT_EQ(lines.front().category, "Mavrel.Instrumentation");
        EXPECT_EQ(lines.front().file, "FileNodeSource.cpp");
        EXPECT_NE(lines.front().function, "");
        EXPECT_GT(lines.front().line, 0);
        return lines.front().text;
    }

    /// What is logged about that content, after the name of the file.
    std::string faultIn(const std::string& content)
    {
        const std::string file = directory.file("inventory.json", content);
        const std::string complaint = complaintAbout(file);
        EXPECT_THAT(complaint, StartsWith(file + ": "));
        return complaint.substr(std::min(complaint.size(), file.size() + 2));
    }

    TemporaryDirectory directory;
    Environment inventory{"TAVRO_INVENTORY", std::nullopt};
};

// The file.

TEST_F(InventoryFaults, theFileIsMissing)
{
    const std::string file = directory.path("missing.json");
    EXPECT_EQ(complaintAbout(file), file + ": expected a readable file: No such file or directory");
    EXPECT_EQ(complaintAbout(file + "/below"),
              file + "/below: expected a readable file: No such file or directory");
}

TEST_F(InventoryFaults, theFileMayNotBeRead)
{
    const std::string file = directory.file("secret.json", R"({"nodes":[]})");
    ASSERT_EQ(chmod(file.c_str(), 0), 0);
    const Testing::WithoutPrivileges user;
    EXPECT_EQ(complaintAbout(file), file + ": expected a readable file: Permission denied");
}

TEST_F(InventoryFaults, theFileIsNoRegularFile)
{
    const std::string pipe = directory.path("pipe");
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    const std::string folder = directory.path("");
    EXPECT_EQ(complaintAbout(folder), folder + ": expected a regular file, found a directory");
    EXPECT_EQ(complaintAbout(pipe), pipe + ": expected a regular file, found a pipe");
    EXPECT_EQ(complaintAbout("/dev/zero"), "/dev/zero: expected a regular file, found a device");
    EXPECT_EQ(complaintAbout("/dev/null"), "/dev/null: expected a regular file, found a device");
}

TEST_F(InventoryFaults, theFileIsALinkInACircle)
{
    const std::string link = directory.path("link");
    std::filesystem::create_symlink(link, link);
    EXPECT_EQ(complaintAbout(link), link + ": expected a readable file: Too many levels of symbolic links");
}

TEST_F(InventoryFaults, theFileIsTooLong)
{
    const std::string file = directory.file("long.json", "");
    std::filesystem::resize_file(file, 64UL * 1024 * 1024 + 1);
    EXPECT_EQ(complaintAbout(file), file + ": expected at most 67108864 bytes, found more");
}

TEST_F(InventoryFaults, theLongestFileIsRead)
{
    const std::string file = directory.file("long.json", "");
    std::filesystem::resize_file(file, 64UL * 1024 * 1024);
    EXPECT_THAT(complaintAbout(file), StartsWith(file + ": line 1, column 1: expected JSON: "));
}

TEST_F(InventoryFaults, aFileMendedIsReadAgain)
{
    faultIn("{");
    inventory.set(directory.file("inventory.json",
                                 R"({"nodes":[{"kind":36,"description":"D","path":"","status":1}]})"));
    Tavro::Instrumentation cursor;
    cursor.selectNode(Tavro::NodeLexicon::DiagnosticIndicator);
    EXPECT_TRUE(cursor);
    EXPECT_TRUE(RecordedLog::take().empty());
}

TEST_F(InventoryFaults, everyCursorComplainsOnce)
{
    for (int round = 0; round < 3; ++round)
        EXPECT_THAT(faultIn("{"), StartsWith("line 1, column 2: expected JSON: "));
}

// The syntax.

struct Fault
{
    std::string content;
    std::string complaint;
};

std::ostream& operator<<(std::ostream& stream, const Fault& fault)
{
    return stream << fault.content.substr(0, 60);
}

class SyntaxFaults : public InventoryFaults, public testing::WithParamInterface<Fault>
{};

TEST_P(SyntaxFaults, areReportedWithLineAndColumn)
{
    EXPECT_THAT(faultIn(GetParam().content), StartsWith(GetParam().complaint));
}

INSTANTIATE_TEST_SUITE_P(
    Texts, SyntaxFaults,
    testing::Values(
        Fault{"",
              "line 1, column 1: expected JSON: syntax error while parsing value - unexpected end of input"},
        Fault{" \n \n", "line 3, column 1: expected JSON: "},
        Fault{"nodes", "line 1, column 2: expected JSON: "},
        Fault{"{\"nodes\": [,",
              "line 1, column 12: expected JSON: syntax error while parsing value - unexpected ','"},
        Fault{"{\"nodes\":\n[\n   }",
              "line 3, column 4: expected JSON: syntax error while parsing value - unexpected '}'"},
        Fault{"{\"nodes\":\n\n", "line 3, column 1: expected JSON: "},
        Fault{"{\"nodes\":[]",
              "line 1, column 12: expected JSON: syntax error while parsing object - unexpected end of "
              "input; expected '}'"},
        Fault{"{\"nodes\":[]} x", "line 1, column 14: expected JSON: "},
        Fault{"{\"nodes\":[]}{\"nodes\":[]}", "line 1, column 13: expected JSON: "},
        Fault{"{\"nodes\":[]} // done", "line 1, column 14: expected JSON: "},
        Fault{"{'nodes':[]}", "line 1, column 2: expected JSON: "},
        Fault{"{nodes:[]}", "line 1, column 3: expected JSON: "},
        Fault{"{\"nodes\":[{\"status\":01", "line 1, column 22: expected JSON: "},
        Fault{"{\"nodes\":[{\"status\":1e999",
              "line 1, column 25: expected JSON: number overflow parsing '1e999'"},
        Fault{"{\"nodes\":[{\"path\":\"\\ud800\"", "line 1, column 26: expected JSON: "},
        Fault{"{\"nodes\":[{\"path\":\"a\nb\"", "line 1, column 21: expected JSON: "},
        Fault{"{\"nodes\":[{\"path\":\"\xFF\"",
              "line 1, column 20: expected JSON: syntax error while parsing value - "
              "invalid string: ill-formed UTF-8 byte"},
        Fault{"{\"nodes\":[{\"path\":\"\xC3\"", "line 1, column 21: expected JSON: "},
        Fault{"{\"nodes\":[{\"path\":\"\xED\xA0\x80\"", "line 1, column 21: expected JSON: "},
        Fault{std::string("{\"nodes\"\0:[]}", 13), "line 1, column 9: expected JSON: "},
        Fault{std::string("{\"nodes\":[]}\0x", 14),
              "line 1, column 13: expected JSON: a null character after it"},
        Fault{std::string("{\"nodes\":[]}\n\0", 14),
              "line 2, column 1: expected JSON: a null character after it"},
        Fault{"\xFE\xFF", "line 1, column 1: expected JSON: "}));

TEST_F(InventoryFaults, aControlCharacterIsRefusedWhereverItStands)
{
    for (char control = 1; control < ' '; ++control)
        for (const std::size_t before : {0U, 7U, 16U, 33U, 64U})
            EXPECT_THAT(faultIn(R"({"nodes":[{"path":")" + std::string(before, 'x') + control +
                                std::string(20, 'y') + R"(","kind":36,"status":0,"description":"z"}]})"),
                        StartsWith("line "))
                << static_cast<int>(control) << " behind " << before;
}

TEST_F(InventoryFaults, theReportQuotesNoBytesThatAreNoUtf8)
{
    for (const char* const content : {"{\"nodes\":[{\"path\":\"\xFF", "{\"\x87\":[]}",
                                      "{\"nodes\":[{\"\xFF\":1}]}", "{\"nodes\":[{\"path\":\"\xFF\"}]}"})
        EXPECT_EQ(faultIn(content).find_first_of("\x87\xFF"), std::string::npos) << content;
}

TEST_F(InventoryFaults, aByteThatIsNoUtf8IsFoundWhereverItIsInALongText)
{
    // A parser may look at several bytes at a time, and at what is left over one by one.
    for (std::size_t place = 0; place < 20; ++place) {
        std::string text(20, 'x');
        text[place] = '\xFF';
        EXPECT_THAT(
            faultIn(R"({"nodes":[{"kind":36,"description":"D","path":")" + text + R"(","status":1}]})"),
            StartsWith("line 1, column " + std::to_string(48 + place) + ": expected JSON: "));
    }
}

TEST_F(InventoryFaults, theReportStaysShortWhateverTheFileHolds)
{
    const std::string lots(100000, '9');
    for (const char* const beginning :
         {R"({"nodes":[{"path":")", R"({"nodes":[{"status":)", R"({"nodes":[{"status":")", R"({")",
          R"({"nodes":[{")", R"({"nodes":[{"kind":")"})
        for (const char* const end : {"", "\"", "\":"})
            EXPECT_LT(faultIn(beginning + lots + end).size(), 500U) << beginning << end;
}

TEST_F(InventoryFaults, whatIsTooLongIsRefusedWhereItBegins)
{
    const std::string complaint = ": expected JSON: a text, a number or blanks of more than 65536 bytes";
    const std::string longest(65536, ' ');
    EXPECT_EQ(faultIn("{\n  \"nodes\": [" + longest + " ]}"), "line 2, column 13" + complaint);
    EXPECT_EQ(faultIn("{\"nodes\":[{\"path\":\"" + longest + ' '), "line 1, column 20" + complaint);
    EXPECT_EQ(faultIn("{\"nodes\":[]}" + longest + "\n"), "line 1, column 13" + complaint);
    EXPECT_THAT(faultIn("{\"nodes\":[" + longest + "x"), StartsWith("line 1, column 11" + complaint));
    EXPECT_THAT(faultIn("{\"nodes\":[" + longest + "]"),
                StartsWith("line 1, column 65548: expected JSON: syntax"));
    EXPECT_EQ(faultIn("{\"nodes\":[{\"path\":\"" + longest + "\"}]}"),
              "/nodes/0: expected the field \"kind\", found none");
}

TEST_F(InventoryFaults, theReportTakesLittleMoreMemoryThanTheFile)
{
    const std::size_t size = 8UL * 1024 * 1024;
    std::string escapes;
    while (escapes.size() < size)
        escapes += R"(\n)";
    for (const std::string& content :
         {'"' + escapes, std::string(size, '\n') + 'x', R"({"nodes":[)" + std::string(size, '\t') + 'x',
          std::string(size, '9') + 'x', '"' + std::string(size, 'x'), std::string(size, 't'),
          R"({"$schema":")" + std::string(size, 'x') + '\x01'}) {
        inventory.set(directory.file("inventory.json", content));
        Allocations::startCounting();
        {
            const Tavro::Instrumentation cursor;
        }
        const Allocations::Use use = Allocations::stopCounting();
        EXPECT_LE(use.peak, static_cast<std::ptrdiff_t>(4 * size)) << content.substr(0, 20);
        EXPECT_THAT(RecordedLog::take(), testing::SizeIs(1));
    }
}

TEST_F(InventoryFaults, halfOfAnEscapedPairIsNoText)
{
    for (const char* const half : {"\\udc00", "\\ud800", "\\udfff x"})
        EXPECT_THAT(faultIn(std::string(R"({"nodes":[{"path":")") + half + "\"}]}"),
                    StartsWith("line 1, column "))
            << half;
}

const std::string anInventory = R"(: expected an object with the field "nodes" or "sources", found )";

TEST_F(InventoryFaults, deepNestingIsRefusedAtItsBeginning)
{
    EXPECT_EQ(faultIn(std::string(1000000, '[')), "the whole file" + anInventory + "a list");
    EXPECT_EQ(faultIn("{\"nodes\":" + std::string(1000000, '[')),
              "/nodes/0: expected a node, which is an object, found a list");
}

// The content.

class ContentFaults : public InventoryFaults, public testing::WithParamInterface<Fault>
{};

TEST_P(ContentFaults, areReportedWithTheirPlaceAndWhatWasExpected)
{
    EXPECT_EQ(faultIn(GetParam().content), GetParam().complaint);
}

const std::string nothing = R"(: expected the field "nodes" or "sources", found none)";
const std::string inventoryFields = R"(: unknown field, expected one of "$schema", "nodes", "sources")";
const std::string aSource = R"(: expected one of "leds", "enclosures", found )";
const std::string number = "expected a whole number from 0 to 4294967295";
const std::string kind =
    number + R"( or one of "chassis", "system board", "processor", "memory module", "drive", "fan", )"
             R"("power supply", "temperature sensor", "diagnostic indicator")";
const std::string nodeFields = R"(expected one of "kind", "description", "path", "status", "alarmState")";

INSTANTIATE_TEST_SUITE_P(
    TopLevel, ContentFaults,
    testing::Values(
        Fault{"[]", "the whole file" + anInventory + "a list"},
        Fault{"null", "the whole file" + anInventory + "null"},
        Fault{"true", "the whole file" + anInventory + "true"},
        Fault{"7", "the whole file" + anInventory + "7"}, Fault{"-7", "the whole file" + anInventory + "-7"},
        Fault{"\"x\"", "the whole file" + anInventory + "\"x\""}, Fault{"{}", "the whole file" + nothing},
        Fault{R"({"$schema":"x"})", "the whole file" + nothing},
        Fault{R"({"node":[]})", "/node" + inventoryFields},
        Fault{R"({"Nodes":[]})", "/Nodes" + inventoryFields},
        Fault{R"({"nodes":[],"a/b~c":1})", "/a~1b~0c" + inventoryFields},
        Fault{R"({"nodes":[],"a\u0000\u001bb":1})", R"(/a\u0000\u001bb)" + inventoryFields},
        Fault{R"({"nodes":"a\u0000\"\\\nä"})", R"(/nodes: expected a list of nodes, found "a\u0000\"\\\nä")"},
        Fault{R"({"nodes":[],"nodes":[]})", "/nodes: field given twice, expected it once"},
        Fault{R"({"$schema":1,"nodes":[]})", "/$schema: expected a text, found 1"},
        Fault{R"({"$schema":{}})", "/$schema: expected a text, found an object"},
        Fault{R"({"nodes":{}})", "/nodes: expected a list of nodes, found an object"},
        Fault{R"({"nodes":null})", "/nodes: expected a list of nodes, found null"},
        Fault{R"({"nodes":"x"})", "/nodes: expected a list of nodes, found \"x\""},
        Fault{R"({"nodes":3})", "/nodes: expected a list of nodes, found 3"},
        Fault{R"({"nodes":[7]})", "/nodes/0: expected a node, which is an object, found 7"},
        Fault{R"({"nodes":[null]})", "/nodes/0: expected a node, which is an object, found null"},
        Fault{R"({"nodes":["kind"]})", "/nodes/0: expected a node, which is an object, found \"kind\""}));

INSTANTIATE_TEST_SUITE_P(
    Sources, ContentFaults,
    testing::Values(Fault{R"({"sources":"leds"})", "/sources: expected a list of sources, found \"leds\""},
                    Fault{R"({"sources":{}})", "/sources: expected a list of sources, found an object"},
                    Fault{R"({"sources":null})", "/sources: expected a list of sources, found null"},
                    Fault{R"({"sources":1})", "/sources: expected a list of sources, found 1"},
                    Fault{R"({"nodes":[],"sources":["LEDs"]})", "/sources/0" + aSource + "\"LEDs\""},
                    Fault{R"({"sources":["leds","fans"],"nodes":[]})", "/sources/1" + aSource + "\"fans\""},
                    Fault{R"({"sources":["leds",7]})", "/sources/1" + aSource + "7"},
                    Fault{R"({"sources":["leds",null]})", "/sources/1" + aSource + "null"},
                    Fault{R"({"sources":[["leds"]]})", "/sources/0" + aSource + "a list"},
                    Fault{R"({"sources":[{"leds":1}]})", "/sources/0" + aSource + "an object"},
                    Fault{R"({"sources":["enclosures","leds","enclosures"]})",
                          "/sources/2: source given twice, expected it once"},
                    Fault{R"({"sources":["leds"],"sources":[]})",
                          "/sources: field given twice, expected it once"},
                    Fault{R"({"sources":["leds"],"nodes":3})", "/nodes: expected a list of nodes, found 3"}));

/// A node that is well in an inventory with three before it and one in it that are not at fault.
std::string inventoryWith(const std::string& fields)
{
    const std::string well = R"({"kind":36,"description":"D","path":"P","status":1})";
    return "{\"nodes\":[" + well + "," + well + "," + well + ",{" + fields + "}," + well + "]}";
}

Fault fieldFault(const std::string& fields, const std::string& complaint)
{
    return {inventoryWith(fields), "/nodes/3" + complaint};
}

/// The value of one field, as it stands in the file and as the report describes it.
struct WrongValue
{
    std::string json;
    std::string found;
};

/// One fault for each of the wrong values of the field.
std::vector<Fault> valueFaults(const std::string& field, const std::string& expected,
                               const std::vector<WrongValue>& wrongValues)
{
    std::vector<Fault> faults;
    std::transform(wrongValues.begin(), wrongValues.end(), std::back_inserter(faults),
                   [&](const WrongValue& wrong) {
                       return fieldFault('"' + field + "\":" + wrong.json,
                                         '/' + field + ": " + expected + ", found " + wrong.found);
                   });
    return faults;
}

const std::vector<WrongValue> noNumbers = {
    {"-1", "-1"},
    {"4294967296", "4294967296"},
    {"18446744073709551615", "18446744073709551615"},
    {"18446744073709551616", "18446744073709551616"},
    {"-9223372036854775809", "-9223372036854775809"},
    {"1.0", "1.0"},
    {"1e0", "1e0"},
    {"-0.5", "-0.5"},
    {"true", "true"},
    {"false", "false"},
    {"null", "null"},
    {R"("36")", R"("36")"},
    {R"("Fan")", R"("Fan")"},
    {R"("")", R"("")"},
    {"[1]", "a list"},
    {"{}", "an object"},
};

INSTANTIATE_TEST_SUITE_P(Kinds, ContentFaults, testing::ValuesIn(valueFaults("kind", kind, noNumbers)));
INSTANTIATE_TEST_SUITE_P(Statuses, ContentFaults,
                         testing::ValuesIn(valueFaults("status", number, noNumbers)));
INSTANTIATE_TEST_SUITE_P(AlarmStates, ContentFaults,
                         testing::ValuesIn(valueFaults("alarmState", number, noNumbers)));

const std::vector<WrongValue> noTexts = {
    {"1", "1"},
    {"-1", "-1"},
    {"0.5", "0.5"},
    {"true", "true"},
    {"null", "null"},
    {"[]", "a list"},
    {R"({"a":1})", "an object"},
    {R"("a\u0000b")", "a null character in it"},
};

INSTANTIATE_TEST_SUITE_P(Descriptions, ContentFaults,
                         testing::ValuesIn(valueFaults("description", "expected a text", noTexts)));
INSTANTIATE_TEST_SUITE_P(Paths, ContentFaults,
                         testing::ValuesIn(valueFaults("path", "expected a text", noTexts)));

/// As an error lists them.
std::string quoted(const nlohmann::json& names)
{
    std::string list;
    for (const nlohmann::json& name : names)
        list += (list.empty() ? "" : ", ") + name.dump();
    return list;
}

TEST_F(InventoryFaults, theSchemaHasTheNamesThatAreExpected)
{
    std::ifstream file(INVENTORIES "/inventory.schema.json");
    const nlohmann::json schema = nlohmann::json::parse(file);
    EXPECT_EQ(faultIn(R"({"sources":["x"]})"),
              "/sources/0: expected one of " + quoted(schema["/properties/sources/items/enum"_json_pointer]) +
                  ", found \"x\"");
    EXPECT_THAT(faultIn(R"({"nodes":[{"kind":"x"}]})"),
                EndsWith(" or one of " +
                         quoted(schema["/$defs/node/properties/kind/anyOf/1/enum"_json_pointer]) +
                         ", found \"x\""));
}

INSTANTIATE_TEST_SUITE_P(
    Fields, ContentFaults,
    testing::Values(
        fieldFault("", ": expected the field \"kind\", found none"),
        fieldFault(R"("description":"D","path":"P","status":1)", ": expected the field \"kind\", found none"),
        fieldFault(R"("kind":36,"path":"P","status":1)", ": expected the field \"description\", found none"),
        fieldFault(R"("kind":36,"description":"D","status":1)", ": expected the field \"path\", found none"),
        fieldFault(R"("kind":36,"description":"D","path":"P")",
                   ": expected the field \"status\", found none"),
        fieldFault(R"("name":"x")", "/name: unknown field, " + nodeFields),
        fieldFault(R"("Kind":36)", "/Kind: unknown field, " + nodeFields),
        fieldFault(R"("kind ":36)", "/kind : unknown field, " + nodeFields),
        fieldFault(R"("alarm state":1)", "/alarm state: unknown field, " + nodeFields),
        fieldFault(R"("kind":36,"$schema":"x")", "/$schema: unknown field, " + nodeFields),
        fieldFault(R"("kind":36,"kind":36)", "/kind: field given twice, expected it once"),
        fieldFault(R"("alarmState":1,"path":"","alarmState":1)",
                   "/alarmState: field given twice, expected it once")));

TEST_F(InventoryFaults, aNameIsCutWhereACharacterEnds)
{
    std::string name(63, 'x');
    EXPECT_THAT(faultIn("{\"" + name + "\xC3\xBC" + "y\":1}"), StartsWith("/" + name + "...: unknown field"));
}

} // namespace
