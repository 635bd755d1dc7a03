// The rules of HTTP. The broker serves nothing, so that a request that reaches it is answered by status 3.

#include "serve/CimBinding.h"

#include "serve/tests/Messages.h"

#include <functional>
#include <string>
#include <tuple>
#include <utility>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost;
using namespace cimhost::serve;
using testing::HasSubstr;

namespace {

std::string headerOf(const HttpResponse& response, const std::string& name)
{
    for (const HeaderField& field : response.headers)
        if (field.name == name)
            return field.value;
    return "";
}

TEST(BindingWithAPage, answersItsTargetAndCim)
{
    Broker broker{{}, {}};
    const CimBinding binding(broker, "here", {}, {"/page", "text/x", [] { return std::string("a page"); }});
    HttpRequest request;
    request.method = "GET";
    request.target = "/page";
    EXPECT_FALSE(binding.refuse(request));
    const HttpResponse response = binding.answer(request);
    EXPECT_EQ(response.status, 200U);
    EXPECT_EQ(headerOf(response, "Content-Type"), "text/x");
    EXPECT_EQ(response.body.whole(), "a page");
    for (const char* const other : {"/", "/page/", "/pag", "/cimom"}) {
        request.target = other;
        EXPECT_EQ(binding.answer(request).status, 405U) << other;
    }
    request.target = "/page";
    EXPECT_EQ(CimBinding(broker, "here").answer(request).status, 405U) << "where there is no page";
    request.method = "POST";
    EXPECT_EQ(binding.answer(request).status, 400U) << "a question of CIM, which it is not";
}

class Binding : public testing::Test
{
protected:
    Binding()
    {
        request.method = "POST";
        request.body = callOf("EnumerateInstanceNames", parameter("ClassName", className()));
        request.headers = {{"Content-Type", "application/xml; charset=\"utf-8\""},
                           {"Content-Length", std::to_string(request.body.size())},
                           {"CIMProtocolVersion", "1.0"},
                           {"CIMOperation", "MethodCall"},
                           {"CIMMethod", "EnumerateInstanceNames"},
                           {"CIMObject", "root%2Fcimv2"}};
    }

    /// Gives a header another value, or takes it away.
    void set(const std::string& name, const std::string& value)
    {
        remove(name);
        request.headers.push_back({name, value});
    }
    void remove(const std::string& name)
    {
        for (auto field = request.headers.begin(); field != request.headers.end();)
            field = field->name == name ? request.headers.erase(field) : field + 1;
    }

    void expectAnswered()
    {
        const HttpResponse response = binding.answer(request);
        EXPECT_EQ(response.status, 200U) << response.body.whole();
        EXPECT_THAT(response.body.whole(), HasSubstr("<ERROR CODE=\"3\""));
    }

    void expectError(unsigned int status, const std::string& cimError, const std::string& text)
    {
        const HttpResponse response = binding.answer(request);
        EXPECT_EQ(response.status, status) << response.body.whole();
        EXPECT_EQ(headerOf(response, "CIMError"), cimError) << response.body.whole();
        EXPECT_EQ(headerOf(response, "Content-Type"), "text/plain; charset=utf-8");
        EXPECT_THAT(response.body.whole(), HasSubstr(text));
    }

    [[nodiscard]] unsigned int refusal() const
    {
        const std::optional<HttpResponse> response = binding.refuse(request);
        return response ? response->status : 0;
    }

    HttpRequest request;
    Broker broker{{}, {}};
    CimBinding binding{broker, "here", {4096, {}}};
};

TEST_F(Binding, answersAnOperation)
{
    const HttpResponse response = binding.answer(request);
    EXPECT_EQ(response.status, 200U);
    EXPECT_EQ(headerOf(response, "Content-Type"), "application/xml; charset=\"utf-8\"");
    EXPECT_EQ(headerOf(response, "CIMOperation"), "MethodResponse");
    EXPECT_THAT(
        response.body.whole(),
        HasSubstr("<IMETHODRESPONSE NAME=\"EnumerateInstanceNames\"><ERROR CODE=\"3\" DESCRIPTION=\"no "
                  "registration names the namespace root/cimv2\"></ERROR>"));
}

TEST_F(Binding, takesPostOnly)
{
    for (const char* method : {"GET", "PUT", "OPTIONS", "post", "X"}) {
        request.method = method;
        expectError(405, "", "expected POST or M-POST");
        EXPECT_EQ(headerOf(binding.answer(request), "Allow"), "POST, M-POST");
        EXPECT_EQ(refusal(), 0U) << "the body is waited for";
    }
}

TEST_F(Binding, takesMPostWithItsDeclaration)
{
    request.method = "M-POST";
    expectError(400, "", "M-POST without a header Man");
    for (const char* man : {"http://example.org/; ns=73", "http://www.dmtf.org/cim/mapping/http/v1.0",
                            "http://www.dmtf.org/cim/mapping/http/v1.0; ns=x", ""}) {
        set("Man", man);
        expectError(510, "", "Man: expected http://www.dmtf.org/cim/mapping/http/v1.0; ns= and two digits");
    }
    set("Man", "http://www.dmtf.org/cim/mapping/http/v1.0 ; ns=73");
    expectError(400, "", "expected the header 73-CIMOperation: MethodCall");
    for (HeaderField& field : request.headers)
        if (field.name.substr(0, 3) == "CIM")
            field.name = "73-" + field.name;
    expectAnswered();
    set("Man", "\"http://www.dmtf.org/cim/mapping/http/v1.0\"; ns=73");
    expectAnswered();
    const HttpResponse response = binding.answer(request);
    EXPECT_EQ(headerOf(response, "73-CIMOperation"), "MethodResponse");
    EXPECT_EQ(headerOf(response, "Man"), "http://www.dmtf.org/cim/mapping/http/v1.0; ns=73");
    EXPECT_EQ(response.headers.size(), 5U) << "Ext and Cache-Control, too";
}

TEST_F(Binding, needsALengthWithinTheLimit)
{
    EXPECT_EQ(refusal(), 0U);
    set("Content-Length", "4096");
    EXPECT_EQ(refusal(), 0U);
    for (const char* length : {"4097", "99999999999999999999999"}) {
        set("Content-Length", length);
        EXPECT_EQ(refusal(), 413U) << length;
    }
    remove("Content-Length");
    EXPECT_EQ(refusal(), 411U);
    set("Transfer-Encoding", "chunked");
    EXPECT_EQ(refusal(), 0U);
    EXPECT_EQ(binding.tooLarge().status, 413U);
}

TEST_F(Binding, takesXmlInUtf8)
{
    for (const char* type : {"text/xml", "application/XML", "text/xml; charset=UTF-8", "text/xml;foo=bar"}) {
        set("Content-Type", type);
        expectAnswered();
    }
    for (const char* type : {"", "text/plain", "application/x-www-form-urlencoded", "text/xml+x"}) {
        set("Content-Type", type);
        expectError(415, "", "expected application/xml or text/xml");
    }
    set("Content-Type", "text/xml; charset=iso-8859-1");
    expectError(415, "", "expected the charset utf-8");
    remove("Content-Type");
    expectError(415, "", "Content-Type");
}

TEST_F(Binding, takesNoEncodedBodies)
{
    set("Content-Encoding", "identity");
    expectAnswered();
    set("Content-Encoding", "gzip");
    expectError(415, "", "Content-Encoding");
}

TEST_F(Binding, refusesClientsThatWantSomethingElse)
{
    set("Accept", "text/html");
    expectError(406, "", "Accept: expected application/xml or text/xml");
    set("Accept", "text/html, */*");
    expectAnswered();
    set("Accept-Charset", "iso-8859-1");
    expectError(406, "", "Accept-Charset: expected utf-8");
}

TEST_F(Binding, checksTheOperationHeaders)
{
    set("CIMOperation", "methodcall");
    expectAnswered();
    set("CIMOperation", "MethodResponse");
    expectError(501, "unsupported-operation", "CIMOperation: found \"MethodResponse\", expected MethodCall");
    remove("CIMOperation");
    expectError(400, "", "expected the header CIMOperation: MethodCall");
    set("CIMExport", "MethodRequest");
    expectError(501, "unsupported-operation", "CIMExport");
    remove("CIMExport");
    set("CIMOperation", "MethodCall");
    set("CIMBatch", "");
    expectError(501, "multiple-requests-unsupported", "CIMBatch");
}

TEST_F(Binding, checksTheProtocolVersion)
{
    remove("CIMProtocolVersion");
    expectAnswered();
    set("CIMProtocolVersion", "2.0");
    expectError(501, "unsupported-protocol-version", "expected 1.x");
    set("CIMProtocolVersion", "1.1");
    expectError(400, "header-mismatch",
                R"(CIMProtocolVersion: found "1.1", expected "1.0" as in the message)");
}

TEST_F(Binding, comparesHeadersAndMessage)
{
    set("CIMMethod", "enumerateInstanceNames");
    set("CIMObject", "ROOT/cimv2");
    expectAnswered();
    for (const char* object : {"root%2fcimv2", "%72oot/cimv2"}) {
        set("CIMObject", object);
        expectAnswered();
    }
    set("CIMObject", "root%2Fother");
    expectError(400, "header-mismatch",
                R"(CIMObject: found "root/other", expected "root/cimv2" as in the message)");
    for (const char* object : {"root%2", "root%", "root%zzcimv2", "root%+1"}) {
        set("CIMObject", object);
        expectError(400, "header-mismatch", "expected two hexadecimal digits behind %");
    }
    remove("CIMObject");
    expectError(400, "header-mismatch", "expected the header CIMObject");
    set("CIMObject", "root/cimv2");
    set("CIMMethod", "GetInstance");
    expectError(400, "header-mismatch", "CIMMethod");
    request.headers.push_back({"cimmethod", "EnumerateInstanceNames"});
    expectError(400, "header-mismatch", "CIMMethod: found it several times, expected it once");
}

TEST_F(Binding, namesTheFaultOfTheMessage)
{
    request.body = "<CIM";
    expectError(400, "request-not-well-formed", "line 1");
    request.body = "<!DOCTYPE CIM><CIM/>";
    expectError(400, "request-not-valid", "found a document type declaration");
    request.body = "<CIM/>";
    expectError(400, "request-not-loosely-valid", "CIMVERSION");
    request.body = R"(<CIM CIMVERSION="3.0" DTDVERSION="2.0"/>)";
    expectError(501, "unsupported-cim-version", "expected 2.x");
    request.body = R"(<CIM CIMVERSION="2.0" DTDVERSION="3.0"/>)";
    expectError(501, "unsupported-dtd-version", "expected 2.x");
    request.body = messageWith("<MULTIREQ/>");
    expectError(501, "multiple-requests-unsupported", "expected a single request");
    request.body = "";
    for (int i = 0; i < 100; ++i)
        request.body += "<CIM>";
    expectError(413, "", "deep in each other");
}

TEST_F(Binding, answersAllStepsOfAnEnumeration)
{
    // Each comes to who answers it: the broker, which has no namespaces, or the enumerations, of which none
    // is open.
    for (const auto& [method, parameters, code] :
         {std::tuple{"GetClass", parameter("ClassName", className()), "3"},
          {"OpenEnumerateInstances", parameter("ClassName", className()), "3"},
          {"OpenEnumerateInstances",
           parameter("ClassName", className()) + parameter("OperationTimeout", text("0")), "22"},
          {"PullInstancePaths",
           parameter("EnumerationContext", text("x")) + parameter("MaxObjectCount", text("1")), "21"},
          {"CloseEnumeration", parameter("EnumerationContext", text("x")), "21"},
          {"EnumerationCount", parameter("EnumerationContext", text("x")), "21"}}) {
        request.body = callOf(method, parameters);
        set("CIMMethod", method);
        EXPECT_THAT(binding.answer(request).body.whole(),
                    HasSubstr(std::string("<ERROR CODE=\"") + code + '"'))
            << method;
    }
}

TEST_F(Binding, answersSoManyAtOnce)
{
    RequestLimits limits;
    limits.atOnce = 0;
    limits.waiting = std::chrono::milliseconds(1);
    const HttpResponse response = CimBinding(broker, "here", limits).answer(request);
    EXPECT_EQ(response.status, 503U);
    EXPECT_EQ(headerOf(response, "Retry-After"), "10");
}

TEST_F(Binding, answersWhatIsNotServedByAStatus)
{
    request.body = callOf("CreateClass", "");
    set("CIMMethod", "CreateClass");
    EXPECT_THAT(binding.answer(request).body.whole(),
                HasSubstr("<IMETHODRESPONSE NAME=\"CreateClass\"><ERROR CODE=\"7\""));
    request.body = messageWith(
        R"(<SIMPLEREQ><METHODCALL NAME="Reset"><LOCALCLASSPATH><LOCALNAMESPACEPATH><NAMESPACE NAME="a"/>)"
        R"(</LOCALNAMESPACEPATH><CLASSNAME NAME="CIM_A"/></LOCALCLASSPATH></METHODCALL></SIMPLEREQ>)");
    set("CIMMethod", "Reset");
    set("CIMObject", "a%3ACIM_A");
    EXPECT_THAT(binding.answer(request).body.whole(),
                HasSubstr("<METHODRESPONSE NAME=\"Reset\"><ERROR CODE=\"7\""));
}

} // namespace
