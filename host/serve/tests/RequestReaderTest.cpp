#include "serve/RequestReader.h"

#include "cim/Values.h"
#include "serve/tests/Messages.h"

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::serve;
using testing::ElementsAre;
using testing::HasSubstr;

namespace {

/// The question that a message asks.
Question questionOf(const std::string& message)
{
    const RequestMessage read = readRequest(message);
    if (const auto* status = std::get_if<cim::Status>(&read.content))
        ADD_FAILURE() << status->message.value_or("");
    const auto* question = std::get_if<Question>(&read.content);
    return question == nullptr ? Question() : *question;
}

/// What a provider is asked by it.
OperationRequest requestOf(const std::string& message)
{
    return questionOf(message).request;
}

/// The status that a message is answered with by itself.
cim::Status statusOf(const std::string& message)
{
    const RequestMessage read = readRequest(message);
    const auto* status = std::get_if<cim::Status>(&read.content);
    return status == nullptr ? cim::Status() : *status;
}

void expectStatus(const std::string& message, CMPIrc code, const std::string& text)
{
    const cim::Status status = statusOf(message);
    EXPECT_EQ(status.code, code) << message;
    EXPECT_THAT(status.message.value_or(""), HasSubstr(text)) << message;
}

void expectFault(const std::string& message, Fault fault, const std::string& text)
{
    try {
        readRequest(message);
        ADD_FAILURE() << "read: " << message;
    } catch (const RequestError& error) {
        EXPECT_EQ(error.fault(), fault) << message << ": " << error.what();
        EXPECT_THAT(error.what(), HasSubstr(text)) << message;
    }
}

const cim::ObjectPath classA{"", "root/cimv2", "CIM_A", {}};
const cim::ObjectPath instanceA{"", "root/cimv2", "CIM_A", {{"Name", cim::textValue("x")}}};

TEST(RequestReader, readsTheMessageAroundTheCall)
{
    const RequestMessage message =
        readRequest(callOf("enumerateinstancenames", parameter("ClassName", className())));
    EXPECT_EQ(message.id, "42");
    EXPECT_EQ(message.protocolVersion, "1.0");
    EXPECT_EQ(message.method, "enumerateinstancenames");
    EXPECT_EQ(message.nameSpace, "root/cimv2");
    EXPECT_TRUE(message.isIntrinsic);
}

TEST(RequestReader, readsEnumerations)
{
    const OperationRequest names =
        requestOf(callOf("EnumerateInstanceNames", parameter("classname", className())));
    EXPECT_EQ(names.operation, Operation::enumerateInstanceNames);
    EXPECT_EQ(names.target, classA);

    const OperationRequest all = requestOf(callOf(
        "EnumerateInstances",
        parameter("ClassName", className()) + parameter("LocalOnly", text("TRUE")) +
            parameter("DeepInheritance", text("false")) + parameter("IncludeQualifiers", text(" True ")) +
            parameter("IncludeClassOrigin", text("FALSE")) +
            parameter("PropertyList", "<VALUE.ARRAY><VALUE>a</VALUE><VALUE>b</VALUE></VALUE.ARRAY>")));
    EXPECT_EQ(all.operation, Operation::enumerateInstances);
    EXPECT_EQ(all.target, classA);
    EXPECT_THAT(all.properties.value(), ElementsAre("a", "b"));
}

TEST(RequestReader, tellsAnEmptyPropertyListFromNone)
{
    const std::string name = parameter("InstanceName", instanceName());
    EXPECT_EQ(requestOf(callOf("GetInstance", name)).properties, std::nullopt);
    EXPECT_EQ(requestOf(callOf("GetInstance", name + "<IPARAMVALUE NAME=\"PropertyList\"/>")).properties,
              std::nullopt);
    EXPECT_EQ(requestOf(callOf("GetInstance", name + parameter("PropertyList", "<VALUE.ARRAY/>"))).properties,
              std::vector<std::string>());
}

TEST(RequestReader, readsGetAndDelete)
{
    const OperationRequest get = requestOf(callOf("GetInstance", parameter("InstanceName", instanceName())));
    EXPECT_EQ(get.operation, Operation::getInstance);
    EXPECT_EQ(get.target, instanceA);
    const OperationRequest gone =
        requestOf(callOf("DeleteInstance", parameter("InstanceName", instanceName())));
    EXPECT_EQ(gone.operation, Operation::deleteInstance);
    EXPECT_EQ(gone.target, instanceA);
}

TEST(RequestReader, readsTraversals)
{
    const std::string object = parameter("ObjectName", instanceName());
    const std::string ends = parameter("ResultClass", className("CIM_R")) + parameter("Role", text("From"));
    const std::string middle =
        parameter("AssocClass", className("CIM_B")) + parameter("ResultRole", text("To"));
    const struct
    {
        const char* name;
        Operation operation;
        bool hasMiddle;
    } methods[] = {{"Associators", Operation::associators, true},
                   {"AssociatorNames", Operation::associatorNames, true},
                   {"References", Operation::references, false},
                   {"ReferenceNames", Operation::referenceNames, false}};
    for (const auto& method : methods) {
        const OperationRequest bare = requestOf(callOf(method.name, object));
        EXPECT_EQ(bare.operation, method.operation);
        EXPECT_EQ(bare.target, instanceA);
        EXPECT_EQ(bare.traversal.assocClass, std::nullopt);
        EXPECT_EQ(bare.traversal.resultRole, std::nullopt);

        const OperationRequest full =
            requestOf(callOf(method.name, object + ends + (method.hasMiddle ? middle : "")));
        EXPECT_EQ(full.traversal.resultClass, "CIM_R");
        EXPECT_EQ(full.traversal.role, "From");
        EXPECT_EQ(full.traversal.assocClass,
                  method.hasMiddle ? std::optional<std::string>("CIM_B") : std::nullopt);
        EXPECT_EQ(full.traversal.resultRole,
                  method.hasMiddle ? std::optional<std::string>("To") : std::nullopt);
        if (!method.hasMiddle)
            expectStatus(callOf(method.name, object + middle), CMPI_RC_ERR_INVALID_PARAMETER, "AssocClass");
    }
}

TEST(RequestReader, refusesTraversalsFromAClass)
{
    expectStatus(callOf("Associators", parameter("ObjectName", className())), CMPI_RC_ERR_NOT_SUPPORTED,
                 "traversals from a class are not served");
}

TEST(RequestReader, readsInstancesToCreateAndModify)
{
    const std::string instance =
        R"(<INSTANCE CLASSNAME="CIM_A"><PROPERTY NAME="Name" TYPE="string"><VALUE>x</VALUE></PROPERTY></INSTANCE>)";
    const OperationRequest create = requestOf(callOf("CreateInstance", parameter("NewInstance", instance)));
    EXPECT_EQ(create.operation, Operation::createInstance);
    EXPECT_EQ(create.target, classA);
    EXPECT_EQ(create.instance, (cim::Instance{classA, {{"Name", cim::textValue("x")}}}));

    const std::string named = "<VALUE.NAMEDINSTANCE>" + instanceName() + instance + "</VALUE.NAMEDINSTANCE>";
    const OperationRequest modify = requestOf(callOf(
        "ModifyInstance", parameter("ModifiedInstance", named) +
                              parameter("PropertyList", "<VALUE.ARRAY><VALUE>Name</VALUE></VALUE.ARRAY>")));
    EXPECT_EQ(modify.operation, Operation::modifyInstance);
    EXPECT_EQ(modify.target, instanceA);
    EXPECT_EQ(modify.instance.path, instanceA);
    EXPECT_THAT(modify.properties.value(), ElementsAre("Name"));

    const std::string other = R"(<INSTANCE CLASSNAME="CIM_B"/>)";
    expectStatus(
        callOf("ModifyInstance", parameter("ModifiedInstance", "<VALUE.NAMEDINSTANCE>" + instanceName() +
                                                                   other + "</VALUE.NAMEDINSTANCE>")),
        CMPI_RC_ERR_INVALID_PARAMETER, "not of the class");
}

std::string queryOf(const std::string& query)
{
    return callOf("ExecQuery", parameter("QueryLanguage", text("WQL")) + parameter("Query", text(query)));
}

TEST(RequestReader, asksTheClassThatAQuerySelectsFrom)
{
    const OperationRequest request = requestOf(queryOf("select * from CIM_A where Name = 'x from CIM_B'"));
    EXPECT_EQ(request.operation, Operation::execQuery);
    EXPECT_EQ(request.target, classA);
    EXPECT_EQ(request.query, "select * from CIM_A where Name = 'x from CIM_B'");
    EXPECT_EQ(request.queryLanguage, "WQL");
    EXPECT_EQ(requestOf(queryOf("SELECT 'a FROM b',\"FROM c\"\nFROM\tCIM_A")).target, classA);
    for (const char* query : {"", "SELECT *", "SELECT * FROM", "SELECT 'FROM CIM_A", "FROM 'CIM_A'"})
        expectStatus(queryOf(query), CMPI_RC_ERR_INVALID_QUERY, "names no class after FROM");
}

TEST(RequestReader, readsQuestionsForClasses)
{
    const Question get = questionOf(callOf("GetClass", parameter("ClassName", className())));
    EXPECT_EQ(get.step, Step::getClass);
    EXPECT_EQ(get.request.target, classA);
    for (const auto& flag :
         {get.localOnly, get.deepInheritance, get.includeQualifiers, get.includeClassOrigin})
        EXPECT_EQ(flag, std::nullopt);

    const Question chosen = questionOf(
        callOf("GetClass", parameter("ClassName", className()) + parameter("LocalOnly", text("false")) +
                               parameter("IncludeQualifiers", text("FALSE")) +
                               parameter("IncludeClassOrigin", text("true")) +
                               parameter("PropertyList", "<VALUE.ARRAY><VALUE>Name</VALUE></VALUE.ARRAY>")));
    EXPECT_EQ(chosen.localOnly, false);
    EXPECT_EQ(chosen.includeQualifiers, false);
    EXPECT_EQ(chosen.includeClassOrigin, true);
    EXPECT_EQ(chosen.request.properties, cim::PropertyList({"Name"}));

    const Question all = questionOf(callOf("EnumerateClasses", parameter("DeepInheritance", text("TRUE"))));
    EXPECT_EQ(all.step, Step::enumerateClasses);
    EXPECT_EQ(all.request.target.className, "");
    EXPECT_EQ(all.request.target.nameSpace, "root/cimv2");
    EXPECT_EQ(all.deepInheritance, true);
    EXPECT_EQ(questionOf(callOf("EnumerateClassNames", parameter("ClassName", className()))).step,
              Step::enumerateClassNames);
    expectStatus(callOf("GetClass", ""), CMPI_RC_ERR_INVALID_PARAMETER,
                 "GetClass without a value of ClassName");
    expectStatus(callOf("GetClass", parameter("DeepInheritance", text("TRUE"))),
                 CMPI_RC_ERR_INVALID_PARAMETER, "the parameter \"DeepInheritance\"");
}

TEST(RequestReader, readsOpeningsOfEnumerations)
{
    const std::string terms = parameter("OperationTimeout", text("20")) +
                              parameter("ContinueOnError", text("false")) +
                              parameter("MaxObjectCount", text("7")) + parameter("FilterQuery", "");
    const struct
    {
        const char* method;
        std::string object;
        Operation operation;
        Items items;
    } openings[] = {
        {"OpenEnumerateInstances", parameter("ClassName", className()), Operation::enumerateInstances,
         Items::instancesWithPaths},
        {"OpenEnumerateInstancePaths", parameter("ClassName", className()), Operation::enumerateInstanceNames,
         Items::paths},
        {"OpenAssociatorInstances", parameter("InstanceName", instanceName()), Operation::associators,
         Items::instancesWithPaths},
        {"OpenAssociatorInstancePaths", parameter("InstanceName", instanceName()), Operation::associatorNames,
         Items::paths},
        {"OpenReferenceInstances", parameter("InstanceName", instanceName()), Operation::references,
         Items::instancesWithPaths},
        {"OpenReferenceInstancePaths", parameter("InstanceName", instanceName()), Operation::referenceNames,
         Items::paths},
    };
    for (const auto& opening : openings) {
        const Question question = questionOf(callOf(opening.method, opening.object + terms));
        EXPECT_EQ(question.step, Step::open) << opening.method;
        EXPECT_EQ(question.request.operation, opening.operation) << opening.method;
        EXPECT_EQ(question.items, opening.items) << opening.method;
        EXPECT_EQ(question.timeout, 20U);
        EXPECT_EQ(question.mostItems, 7U);
        const Question bare = questionOf(callOf(opening.method, opening.object));
        EXPECT_EQ(bare.timeout, std::nullopt);
        EXPECT_EQ(bare.mostItems, 0U);
        expectStatus(
            callOf(opening.method, opening.object + parameter("FilterQueryLanguage", text("DMTF:FQL"))),
            filteredEnumerationNotSupported, "filters are not served");
        expectStatus(callOf(opening.method, opening.object + parameter("ContinueOnError", text("true"))),
                     continuationOnErrorNotSupported, "ends with its first error");
        expectStatus(callOf(opening.method, opening.object + parameter("MaxObjectCount", text("-1"))),
                     CMPI_RC_ERR_INVALID_PARAMETER, "a value of the type uint32");
    }
    const std::string origin =
        parameter("ClassName", className()) + parameter("IncludeClassOrigin", text("true"));
    EXPECT_EQ(questionOf(callOf("OpenEnumerateInstances", origin)).includeClassOrigin, true);
    expectStatus(callOf("OpenEnumerateInstancePaths", origin), CMPI_RC_ERR_INVALID_PARAMETER,
                 "IncludeClassOrigin");
}

TEST(RequestReader, readsWhatComesAfterAnOpening)
{
    const std::string context = parameter("EnumerationContext", text("1-2"));
    const std::string most = parameter("MaxObjectCount", text("3"));
    for (const auto& [method, items] : {std::pair{"PullInstancesWithPath", Items::instancesWithPaths},
                                        {"PullInstancePaths", Items::paths},
                                        {"PullInstances", Items::instances}}) {
        const Question question = questionOf(callOf(method, context + most));
        EXPECT_EQ(question.step, Step::pull);
        EXPECT_EQ(question.items, items);
        EXPECT_EQ(question.context, "1-2");
        EXPECT_EQ(question.mostItems, 3U);
        expectStatus(callOf(method, context), CMPI_RC_ERR_INVALID_PARAMETER,
                     "without a value of MaxObjectCount");
        expectStatus(callOf(method, most), CMPI_RC_ERR_INVALID_PARAMETER,
                     "without a value of EnumerationContext");
    }
    EXPECT_EQ(questionOf(callOf("CloseEnumeration", context)).step, Step::close);
    EXPECT_EQ(questionOf(callOf("EnumerationCount", context)).context, "1-2");
}

TEST(RequestReader, doesNotServeWhatNoProviderAnswers)
{
    for (const char* method : {"CreateClass", "GetQualifier", "GetProperty", "SetProperty",
                               "OpenQueryInstances", "NoSuchMethod", ""})
        expectStatus(callOf(method, parameter("ClassName", className())), CMPI_RC_ERR_NOT_SUPPORTED,
                     "is not served");
}

TEST(RequestReader, refusesParametersThatAreMissingRepeatedOrUnknown)
{
    expectStatus(callOf("EnumerateInstances", ""), CMPI_RC_ERR_INVALID_PARAMETER,
                 "line 1, IMETHODCALL: found EnumerateInstances without a value of ClassName, expected one");
    expectStatus(callOf("EnumerateInstances", "<IPARAMVALUE NAME=\"ClassName\"/>"),
                 CMPI_RC_ERR_INVALID_PARAMETER, "without a value of ClassName");
    expectStatus(callOf("EnumerateInstances",
                        parameter("ClassName", className()) + parameter("CLASSNAME", className())),
                 CMPI_RC_ERR_INVALID_PARAMETER,
                 "found the parameter ClassName again, expected each parameter once");
    expectStatus(
        callOf("EnumerateInstances", parameter("ClassName", className()) + parameter("Role", text("x"))),
        CMPI_RC_ERR_INVALID_PARAMETER,
        "found the parameter \"Role\", expected those of EnumerateInstances: ClassName, LocalOnly");
    expectStatus(callOf("ExecQuery", parameter("QueryLanguage", text("WQL"))), CMPI_RC_ERR_INVALID_PARAMETER,
                 "without a value of Query");
}

TEST(RequestReader, refusesParametersOfTheWrongType)
{
    const std::string name = parameter("ClassName", className());
    expectStatus(callOf("EnumerateInstances", parameter("ClassName", text("CIM_A"))),
                 CMPI_RC_ERR_INVALID_PARAMETER,
                 "line 1, VALUE: found this element, expected CLASSNAME, in the parameter ClassName");
    expectStatus(callOf("EnumerateInstances", parameter("ClassName", instanceName())),
                 CMPI_RC_ERR_INVALID_PARAMETER, "expected CLASSNAME");
    expectStatus(callOf("EnumerateInstances", name + parameter("LocalOnly", text("yes"))),
                 CMPI_RC_ERR_INVALID_PARAMETER, "found \"yes\", expected a value of the type boolean");
    expectStatus(callOf("EnumerateInstances", name + parameter("PropertyList", text("Name"))),
                 CMPI_RC_ERR_INVALID_PARAMETER, "expected VALUE.ARRAY");
    expectStatus(callOf("EnumerateInstances",
                        name + parameter("PropertyList", "<VALUE.ARRAY><VALUE.NULL/></VALUE.ARRAY>")),
                 CMPI_RC_ERR_INVALID_PARAMETER, "expected the name of a property");
    expectStatus(callOf("GetInstance", parameter("InstanceName", className())), CMPI_RC_ERR_INVALID_PARAMETER,
                 "expected INSTANCENAME");
    expectStatus(callOf("CreateInstance", parameter("NewInstance", instanceName())),
                 CMPI_RC_ERR_INVALID_PARAMETER, "expected INSTANCE");
    expectStatus(callOf("ModifyInstance", parameter("ModifiedInstance", instanceName())),
                 CMPI_RC_ERR_INVALID_PARAMETER, "expected VALUE.NAMEDINSTANCE");
    expectStatus(
        callOf("Associators", parameter("ObjectName", instanceName()) + parameter("Role", className())),
        CMPI_RC_ERR_INVALID_PARAMETER, "expected VALUE");
}

TEST(RequestReader, callsNoMethodsOfClasses)
{
    const RequestMessage message = readRequest(messageWith(
        R"(<SIMPLEREQ><METHODCALL NAME="Reset"><LOCALCLASSPATH><LOCALNAMESPACEPATH><NAMESPACE NAME="a"/>)"
        R"(</LOCALNAMESPACEPATH><CLASSNAME NAME="CIM_A"/></LOCALCLASSPATH></METHODCALL></SIMPLEREQ>)"));
    EXPECT_FALSE(message.isIntrinsic);
    EXPECT_EQ(message.nameSpace, "a");
    EXPECT_EQ(std::get<cim::Status>(message.content).code, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST(RequestReader, knowsTheVersionsItUnderstands)
{
    const auto document = [](const std::string& cim, const std::string& dtd, const std::string& protocol) {
        return "<CIM CIMVERSION=\"" + cim + "\" DTDVERSION=\"" + dtd +
               R"("><MESSAGE ID="1" PROTOCOLVERSION=")" + protocol +
               R"("><SIMPLEREQ><IMETHODCALL NAME="GetClass"><LOCALNAMESPACEPATH><NAMESPACE NAME="a"/>)" +
               "</LOCALNAMESPACEPATH></IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>";
    };
    for (const char* version : {"2.0", "2.3", "2.99"})
        EXPECT_EQ(readRequest(document(version, version, "1.4")).id, "1");
    for (const char* version : {"", "2", "2.", "3.0", "x.y"}) {
        expectFault(document(version, "2.0", "1.0"), Fault::unsupportedCimVersion, "expected 2.x");
        expectFault(document("2.0", version, "1.0"), Fault::unsupportedDtdVersion, "expected 2.x");
    }
    expectFault(document("2.0", "2.0", "2.0"), Fault::unsupportedProtocolVersion,
                "line 1, MESSAGE: found PROTOCOLVERSION \"2.0\", expected 1.x");
}

TEST(RequestReader, takesOneOperationAndNoExports)
{
    const std::string multiple = "<MULTIREQ><SIMPLEREQ/><SIMPLEREQ/></MULTIREQ>";
    expectFault(messageWith(multiple), Fault::multipleRequests, "expected a single request");
    expectFault(messageWith("<SIMPLEEXPREQ/>"), Fault::unsupportedOperation, "expected an operation");
    expectFault(messageWith("<MULTIEXPREQ/>"), Fault::unsupportedOperation, "expected an operation");
}

TEST(RequestReader, refusesWhatTheDtdDoesNotAllow)
{
    const auto refuse = [](const std::string& message, const std::string& text) {
        expectFault(message, Fault::notLooselyValid, text);
    };
    refuse("<MESSAGE/>", "line 1, MESSAGE: found this element, expected CIM");
    refuse("<CIM/>", "found no attribute CIMVERSION, expected one");
    refuse("<CIM CIMVERSION=\"2.0\"/>", "DTDVERSION");
    refuse(R"(<CIM CIMVERSION="2.0" DTDVERSION="2.0"/>)", "found nothing, expected MESSAGE");
    refuse(
        R"(<CIM CIMVERSION="2.0" DTDVERSION="2.0"><MESSAGE PROTOCOLVERSION="1.0"><SIMPLEREQ/></MESSAGE></CIM>)",
        "found no call");
    refuse(messageWith(""), "expected SIMPLEREQ, MULTIREQ, SIMPLEEXPREQ or MULTIEXPREQ");
    refuse(messageWith("<SIMPLEREQ/><SIMPLEREQ/>"), "a second element in MESSAGE");
    refuse(messageWith("<SIMPLERSP/>"), "found this element in MESSAGE");
    refuse(messageWith("text<SIMPLEREQ/>"), "found the text \"text\", expected elements only");
    refuse(messageWith("<SIMPLEREQ/>"), "found no call, expected IMETHODCALL or METHODCALL");
    refuse(messageWith("<SIMPLEREQ><IMETHODCALL NAME=\"GetClass\"/></SIMPLEREQ>"), "found no namespace");
    refuse(messageWith(
               "<SIMPLEREQ><IMETHODCALL NAME=\"GetClass\"><LOCALNAMESPACEPATH/></IMETHODCALL></SIMPLEREQ>"),
           "expected NAMESPACE");
    refuse(messageWith("<SIMPLEREQ><METHODCALL NAME=\"x\"/></SIMPLEREQ>"), "found no object");
    refuse(callOf("EnumerateInstances", className()), "expected LOCALNAMESPACEPATH or IPARAMVALUE");
    refuse(callOf("EnumerateInstances", parameter("ClassName", className() + className())),
           "a second element");
    refuse(callOf("EnumerateInstances", "<IPARAMVALUE>" + className() + "</IPARAMVALUE>"),
           "no attribute NAME");
    refuse(callOf("EnumerateInstances", parameter("ClassName", "<CLASSNAME/>")), "no attribute NAME");
    refuse(callOf("EnumerateInstances", "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"a\"/></LOCALNAMESPACEPATH>"),
           "a second LOCALNAMESPACEPATH");
    refuse(callOf("ModifyInstance", parameter("ModifiedInstance", "<VALUE.NAMEDINSTANCE>" + instanceName() +
                                                                      "</VALUE.NAMEDINSTANCE>")),
           "found its end, expected INSTANCE");
}

TEST(RequestReader, survivesEveryBeginningOfARequest)
{
    const std::string whole =
        callOf("Associators", parameter("ObjectName", instanceName()) + parameter("Role", text("x")));
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_THROW(readRequest(whole.substr(0, length)), RequestError) << length;
}

} // namespace
