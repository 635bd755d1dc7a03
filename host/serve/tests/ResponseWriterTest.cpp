#include "serve/ResponseWriter.h"

#include "cim/Values.h"
#include "cim/tests/Print.h"
#include "schema/MofReader.h"
#include "serve/ClassWriter.h"
#include "serve/Dtd.h"
#include "serve/ValueReader.h"
#include "serve/ValueWriter.h"
#include "serve/Xml.h"

#include <limits>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::serve;
using testing::HasSubstr;
using testing::Not;

namespace {

RequestMessage requestFor(Operation operation)
{
    Question question;
    question.request.operation = operation;
    return {"7 & \"8\"", "1.0", "Method", true, "root/cimv2", question};
}

/// What stands inside of the response's method.
std::string bodyOf(const RequestMessage& request, const Reply& reply, const schema::Classes& classes = {})
{
    const std::string document = writeResponse(request, reply, "here", classes).whole();
    const std::string before =
        "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">"
        "<MESSAGE ID=\"7 &amp; &quot;8&quot;\" PROTOCOLVERSION=\"1.0\"><SIMPLERSP><IMETHODRESPONSE NAME=\"Method\">";
    const std::string after = "</IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>";
    EXPECT_EQ(document.substr(0, before.size()), before);
    EXPECT_EQ(document.substr(document.size() - after.size()), after);
    return document.substr(before.size(), document.size() - before.size() - after.size());
}

std::string bodyOf(Operation operation, const cim::Answer& answer)
{
    return bodyOf(requestFor(operation), {answer});
}

RequestMessage requestFor(Step step)
{
    RequestMessage request = requestFor(Operation::enumerateInstances);
    std::get<Question>(request.content).step = step;
    return request;
}

std::string instanceText(const cim::Instance& instance)
{
    XmlWriter xml;
    writeInstance(xml, instance);
    return xml.document();
}

const cim::ObjectPath path{"", "root/cimv2", "CIM_A", {{"Name", cim::textValue("<a> & \"b\"")}}};
const cim::Instance instance{path, {{"Size", cim::unsignedValue(3, CMPI_uint16)}}};
const std::string nameXml =
    "<INSTANCENAME CLASSNAME=\"CIM_A\"><KEYBINDING NAME=\"Name\"><KEYVALUE VALUETYPE=\"string\">"
    "&lt;a&gt; &amp; &quot;b&quot;</KEYVALUE></KEYBINDING></INSTANCENAME>";
const std::string instanceXml =
    "<INSTANCE CLASSNAME=\"CIM_A\"><PROPERTY NAME=\"Size\" TYPE=\"uint16\"><VALUE>3</VALUE>"
    "</PROPERTY></INSTANCE>";
const std::string pathXml =
    "<INSTANCEPATH><NAMESPACEPATH><HOST>here</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\">"
    "</NAMESPACE><NAMESPACE NAME=\"cimv2\"></NAMESPACE></LOCALNAMESPACEPATH></NAMESPACEPATH>" +
    nameXml + "</INSTANCEPATH>";

TEST(ResponseWriter, givesPiecesOfEnumerationsTheirForm)
{
    const auto trailer = [](const std::string& context, const std::string& isEnd) {
        return R"(<PARAMVALUE NAME="EnumerationContext" PARAMTYPE="string"><VALUE>)" + context +
               R"(</VALUE></PARAMVALUE><PARAMVALUE NAME="EndOfSequence" PARAMTYPE="boolean"><VALUE>)" +
               isEnd + "</VALUE></PARAMVALUE>";
    };
    Reply reply{{{}, {}, {instance}}};
    reply.context = "7";
    EXPECT_EQ(bodyOf(requestFor(Step::open), reply),
              "<IRETURNVALUE><VALUE.INSTANCEWITHPATH>" + pathXml + instanceXml +
                  "</VALUE.INSTANCEWITHPATH></IRETURNVALUE>" + trailer("7", "FALSE"));
    EXPECT_EQ(bodyOf(requestFor(Step::pull), {{{}, {path}, {}}}),
              "<IRETURNVALUE>" + pathXml + "</IRETURNVALUE>" + trailer("", "TRUE"));
    EXPECT_EQ(bodyOf(requestFor(Step::close), {}), "");
    reply.count = 12;
    EXPECT_EQ(bodyOf(requestFor(Step::count), reply), "<IRETURNVALUE><VALUE>12</VALUE></IRETURNVALUE>");
}

TEST(ResponseWriter, writesClassesAndTheirNames)
{
    const schema::Classes classes(schema::readMof(R"(
        [Association, Version("1.0"), Description("a <b>")] class CIM_Base {
            [Key, MaxLen(64), MinValue(1), Experimental(false)] string Name = "x";
            uint16 States[] = {1, 2}; boolean Flag = true; };
        [Version("2.0")] class CIM_Leaf : CIM_Base {
            [Override("States"), Values {"a", "b"}] uint16 States[]; CIM_Base REF End; };)",
                                                  "a.mof")
                                      .classes);
    Reply reply;
    reply.classes = {classes.completed(*classes.find("CIM_Leaf"))};
    const auto qualifier = [](const std::string& name, const std::string& type, const std::string& value,
                              bool isInherited = true, const std::string& toSubclass = "true") {
        return "<QUALIFIER NAME=\"" + name + "\" TYPE=\"" + type + '"' +
               (isInherited ? " PROPAGATED=\"true\"" : "") + " TOSUBCLASS=\"" + toSubclass + "\">" + value +
               "</QUALIFIER>";
    };
    const std::string whole =
        R"(<CLASS NAME="CIM_Leaf" SUPERCLASS="CIM_Base">)" +
        qualifier("Version", "string", "<VALUE>2.0</VALUE>", false, "false") +
        qualifier("Association", "boolean", "<VALUE>TRUE</VALUE>") +
        qualifier("Description", "string", "<VALUE>a &lt;b&gt;</VALUE>") +
        R"(<PROPERTY NAME="Name" TYPE="string" CLASSORIGIN="CIM_Base" PROPAGATED="true">)" +
        qualifier("Key", "boolean", "<VALUE>TRUE</VALUE>") +
        qualifier("MaxLen", "uint32", "<VALUE>64</VALUE>") +
        qualifier("MinValue", "sint64", "<VALUE>1</VALUE>") +
        qualifier("Experimental", "boolean", "<VALUE>FALSE</VALUE>", true, "false") +
        R"(<VALUE>x</VALUE></PROPERTY>)"
        R"(<PROPERTY.ARRAY NAME="States" TYPE="uint16" CLASSORIGIN="CIM_Base" PROPAGATED="false">)" +
        qualifier("Override", "string", "<VALUE>States</VALUE>", false, "false") +
        qualifier("Values", "string", "<VALUE.ARRAY><VALUE>a</VALUE><VALUE>b</VALUE></VALUE.ARRAY>", false) +
        R"(</PROPERTY.ARRAY><PROPERTY NAME="Flag" TYPE="boolean" CLASSORIGIN="CIM_Base" PROPAGATED="true">)"
        R"(<VALUE>TRUE</VALUE></PROPERTY>)"
        R"(<PROPERTY.REFERENCE NAME="End" REFERENCECLASS="CIM_Base" CLASSORIGIN="CIM_Leaf" PROPAGATED="false">)"
        "</PROPERTY.REFERENCE></CLASS>";
    EXPECT_EQ(bodyOf(requestFor(Step::getClass), reply), "<IRETURNVALUE>" + whole + "</IRETURNVALUE>");
    EXPECT_EQ(bodyOf(requestFor(Step::enumerateClasses), reply),
              "<IRETURNVALUE>" + whole + "</IRETURNVALUE>");
    EXPECT_EQ(bodyOf(requestFor(Step::enumerateClassNames), reply),
              "<IRETURNVALUE><CLASSNAME NAME=\"CIM_Leaf\"></CLASSNAME></IRETURNVALUE>");

    const schema::Class base = classes.completed(*classes.find("CIM_Base"));
    XmlWriter xml;
    writeClass(xml, base);
    EXPECT_THAT(xml.document(),
                HasSubstr("<VALUE.ARRAY><VALUE>1</VALUE><VALUE>2</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>"));
}

TEST(ResponseWriter, tellsWhereInstancesPropertiesComeFromWhenAsked)
{
    const schema::Classes classes(
        schema::readMof("class CIM_Base { uint16 Size; }; class CIM_A : CIM_Base {};", "a.mof").classes);
    RequestMessage request = requestFor(Operation::enumerateInstances);
    const Reply reply{{{}, {}, {instance}}};
    EXPECT_THAT(bodyOf(request, reply, classes), Not(HasSubstr("CLASSORIGIN")));
    std::get<Question>(request.content).includeClassOrigin = true;
    EXPECT_THAT(bodyOf(request, reply, classes), HasSubstr("NAME=\"Size\" CLASSORIGIN=\"CIM_Base\" TYPE"));
    EXPECT_THAT(bodyOf(request, reply), Not(HasSubstr("CLASSORIGIN"))) << "of no known class";
}

TEST(ResponseWriter, givesEachOperationItsForm)
{
    const cim::Answer paths{{}, {path}, {}};
    const cim::Answer instances{{}, {}, {instance}};
    const auto returned = [](const std::string& value) {
        return "<IRETURNVALUE>" + value + "</IRETURNVALUE>";
    };
    EXPECT_EQ(bodyOf(Operation::enumerateInstanceNames, paths), returned(nameXml));
    EXPECT_EQ(bodyOf(Operation::createInstance, paths), returned(nameXml));
    EXPECT_EQ(bodyOf(Operation::enumerateInstances, instances),
              returned("<VALUE.NAMEDINSTANCE>" + nameXml + instanceXml + "</VALUE.NAMEDINSTANCE>"));
    EXPECT_EQ(bodyOf(Operation::getInstance, instances), returned(instanceXml));
    EXPECT_EQ(bodyOf(Operation::execQuery, instances),
              returned("<VALUE.OBJECT>" + instanceXml + "</VALUE.OBJECT>"));
    const std::string withPath =
        returned("<VALUE.OBJECTWITHPATH>" + pathXml + instanceXml + "</VALUE.OBJECTWITHPATH>");
    EXPECT_EQ(bodyOf(Operation::associators, instances), withPath);
    EXPECT_EQ(bodyOf(Operation::references, instances), withPath);
    EXPECT_EQ(bodyOf(Operation::associatorNames, paths),
              returned("<OBJECTPATH>" + pathXml + "</OBJECTPATH>"));
    EXPECT_EQ(bodyOf(Operation::referenceNames, paths), returned("<OBJECTPATH>" + pathXml + "</OBJECTPATH>"));
    EXPECT_EQ(bodyOf(Operation::modifyInstance, {}), "");
    EXPECT_EQ(bodyOf(Operation::deleteInstance, {}), "");
    EXPECT_EQ(bodyOf(Operation::associators, {}), returned(""));
}

TEST(ResponseWriter, namesTheHostThatThePathNames)
{
    cim::ObjectPath elsewhere = path;
    elsewhere.host = "srv";
    elsewhere.nameSpace = "";
    const std::string body = bodyOf(Operation::associatorNames, {{}, {elsewhere}, {}});
    EXPECT_THAT(body, HasSubstr("<HOST>srv</HOST>"));
    EXPECT_THAT(body, HasSubstr("<NAMESPACE NAME=\"cimv2\">")) << "without a namespace it is the request's";
}

/// What stands in the response after an error that came behind a result.
std::string errorOf(CMPIrc code, const char* message)
{
    cim::Answer answer;
    answer.status.code = code;
    if (message != nullptr)
        answer.status.message = message;
    answer.paths.push_back(path);
    return bodyOf(Operation::enumerateInstanceNames, answer);
}

TEST(ResponseWriter, sendsTheErrorOnly)
{
    EXPECT_EQ(errorOf(CMPI_RC_ERR_FAILED, "a \"b\" <c> \x1b \xff"),
              "<ERROR CODE=\"1\" DESCRIPTION=\"a &quot;b&quot; &lt;c&gt; \ufffd \ufffd\"></ERROR>");
    EXPECT_EQ(errorOf(CMPI_RC_ERR_METHOD_NOT_FOUND, nullptr), "<ERROR CODE=\"17\"></ERROR>");
    EXPECT_EQ(errorOf(CMPI_RC_ERROR_SYSTEM, nullptr),
              "<ERROR CODE=\"1\" DESCRIPTION=\"CMPI_RC_ERROR_SYSTEM\"></ERROR>");
}

TEST(ResponseWriter, answersMethodsOfClassesInTheirOwnElement)
{
    const RequestMessage message{"1",   "1.0", "Reset",
                                 false, "a",   cim::Status{CMPI_RC_ERR_NOT_SUPPORTED, "no"}};
    EXPECT_THAT(
        writeResponse(message, {{{CMPI_RC_ERR_NOT_SUPPORTED, "no"}, {}, {}}}, "here").whole(),
        HasSubstr(
            "<METHODRESPONSE NAME=\"Reset\"><ERROR CODE=\"7\" DESCRIPTION=\"no\"></ERROR></METHODRESPONSE>"));
}

TEST(ResponseWriter, refusesWhatTheBudgetDoesNotHold)
{
    Reply reply;
    const cim::Instance large{{"", "", "CIM_A", {}}, {{"P", cim::textValue(std::string(50000, 'x'))}}};
    reply.answer.instances = {large, large, large, large};
    const RequestMessage request = requestFor(Operation::enumerateInstances);
    const auto budget = std::make_shared<TextBudget>(150000);
    EXPECT_THAT(writeResponse(request, reply, "here", {}, budget).whole(),
                HasSubstr("<ERROR CODE=\"27\" DESCRIPTION=\"the answers that are being given take all"));
    EXPECT_TRUE(budget->take(150000)) << "nothing is kept of it";
    budget->giveBack(150000);
    reply.answer.instances = {large, large};
    EXPECT_THAT(writeResponse(request, reply, "here", {}, budget).whole(), HasSubstr("</IRETURNVALUE>"));
}

TEST(ResponseWriter, failsForWhatHasNoForm)
{
    for (const cim::Value& key :
         {cim::nullValue(CMPI_string), cim::arrayValue(CMPI_uint8, {}), cim::instanceValue(instance)}) {
        const cim::Answer answer{{}, {{"", "", "CIM_A", {{"K", key}}}}, {}};
        const std::string body = bodyOf(Operation::enumerateInstanceNames, answer);
        EXPECT_THAT(
            body, HasSubstr("<ERROR CODE=\"1\" DESCRIPTION=\"the provider returned the key K of the type "));
        EXPECT_THAT(body, Not(HasSubstr("IRETURNVALUE")));
    }
    const cim::Instance refs{
        path, {{"P", cim::arrayValue(CMPI_ref, {std::make_shared<const cim::ObjectPath>(path)})}}};
    EXPECT_THAT(bodyOf(Operation::getInstance, {{}, {}, {refs}}), HasSubstr("an array of references"));
}

TEST(ValueWriter, writesNumbersThatAreNone)
{
    const auto text = [](double number) {
        return instanceText({{"", "", "A", {}}, {{"P", cim::realValue(number)}}});
    };
    using Limits = std::numeric_limits<double>;
    EXPECT_THAT(text(Limits::quiet_NaN()), HasSubstr("<VALUE>NaN</VALUE>"));
    EXPECT_THAT(text(Limits::infinity()), HasSubstr("<VALUE>INF</VALUE>"));
    EXPECT_THAT(text(-Limits::infinity()), HasSubstr("<VALUE>-INF</VALUE>"));
}

TEST(ValueWriter, writesAnEmptyTextWithAnEndTag)
{
    EXPECT_THAT(instanceText({{"", "", "A", {}}, {{"P", cim::textValue("")}}}), HasSubstr("<VALUE></VALUE>"));
}

TEST(ValueWriter, writesWhatTheReaderReads)
{
    cim::ObjectPath far{"srv", "root/b", "CIM_B", {}};
    far.keys = {{"Text", cim::textValue("  \r\n\t<&>\"'\u98a8\U0001F300 ")},
                {"Flag", cim::booleanValue(true)},
                {"Number", cim::signedValue(-5, CMPI_sint16)},
                {"Real", cim::realValue(0.1)},
                {"Time", cim::textValue("20260101000000.000000+000", CMPI_dateTime)},
                {"Char", cim::unsignedValue(0x98a8, CMPI_char16)},
                {"Near", cim::referenceValue({"", "", "CIM_C", {{"K", cim::unsignedValue(1, CMPI_uint8)}}})}};
    cim::ObjectPath local = far;
    local.host = "";
    const cim::Instance inner{{"", "", "CIM_D", {}}, {{"P", cim::textValue("]]> <x/>")}}};
    const cim::Instance whole{
        {"", "", "CIM_A", {}},
        {{"Far", cim::referenceValue(far)},
         {"Local", cim::referenceValue(local)},
         {"NullRef", cim::nullValue(CMPI_ref)},
         {"Null", cim::nullValue(CMPI_uint32)},
         {"NullArray", cim::nullValue(CMPI_stringA)},
         {"Empty", cim::arrayValue(CMPI_string, {})},
         {"List", cim::arrayValue(CMPI_string, {std::string(" a "), std::monostate(), std::string()})},
         {"Least", cim::signedValue(INT64_MIN)},
         {"Most", cim::unsignedValue(UINT64_MAX)},
         {"Embedded", cim::instanceValue(inner)}}};
    const cim::Instance read = readInstance(parseXml(instanceText(whole), {}, &isKnownElement), {});
    ASSERT_EQ(read.properties.size(), whole.properties.size());
    for (std::size_t i = 0; i < whole.properties.size(); ++i)
        EXPECT_EQ(read.properties[i].value, whole.properties[i].value) << whole.properties[i].name;
    EXPECT_TRUE(read == whole);
}

} // namespace
