// What is counted before a parser sees it. The documents of the counts are read with a parser too, so that the
// counts are those of what it sees.

#include "serve/XmlLimits.h"

#include "serve/Dtd.h"
#include "serve/Fault.h"
#include "serve/Xml.h"

#include <optional>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost::serve;
using testing::EndsWith;
using testing::StartsWith;

namespace {

/// The message of the refusal; empty: it is within the limits.
std::string refusalOf(const std::string& document, const XmlLimits& limits = {})
{
    try {
        requireWithin(limits, document);
        return "";
    } catch (const RequestError& error) {
        EXPECT_EQ(error.fault(), Fault::tooLarge);
        return error.what();
    }
}

/// That many of it in a row, with a number behind each `name`.
std::string numbered(int count, const std::string& name, const std::string& rest = "")
{
    std::string all;
    for (int i = 0; i < count; ++i)
        all.append(name).append(std::to_string(i)).append(rest);
    return all;
}

/// What is within the limits but for one of them, which is just enough.
void expectJustEnough(const std::string& document, std::size_t XmlLimits::*limit, std::size_t count)
{
    XmlLimits limits;
    limits.*limit = count;
    EXPECT_EQ(refusalOf(document, limits), "") << document.substr(0, 200);
    EXPECT_NO_THROW(parseXml(document, limits, &isKnownElement)) << document.substr(0, 200);
    limits.*limit = count - 1;
    EXPECT_NE(refusalOf(document, limits), "") << document.substr(0, 200);
}

TEST(Limits, countElements)
{
    for (const char* document :
         {"<CIM><CIM/><CIM ></CIM ><X A='>'/></CIM>", "<CIM><CIM A=\"/>\"></CIM><X/><X /></CIM>",
          "<?xml version=\"1.0\"?><!-- <a> --><CIM><?p <b>?><X/><X/><X/><![CDATA[<c>]]></CIM>"})
        expectJustEnough(document, &XmlLimits::elements, 4);
}

TEST(Limits, countHowDeepElementsAre)
{
    for (const char* document :
         {"<CIM><CIM/><CIM><X/></CIM></CIM>", "<CIM><CIM A='/'><X/></CIM><CIM/></CIM>",
          "<CIM><!-- <CIM> --><CIM><?p <CIM>?><X/></CIM><![CDATA[<CIM><CIM><CIM>]]></CIM>"})
        expectJustEnough(document, &XmlLimits::depth, 3);
}

TEST(Limits, countAttributes)
{
    expectJustEnough("<CIM A='=' B = \"'='\"><X C='>='/>=</CIM>", &XmlLimits::attributes, 3);
    expectJustEnough("<CIM A='=' B = \"'='\n\"><X C='>'/></CIM>", &XmlLimits::attributesOfElement, 2);
}

TEST(Limits, countNamespaces)
{
    expectJustEnough("<CIM xmlns='a'><a:X xmlns:a='xmlns'><X/></a:X><X xmlns='b'/></CIM>",
                     &XmlLimits::namespaces, 2);
    expectJustEnough("<CIM>xmlns<X xmlns='a' /><X xmlns='a'></X><X A='' xmlns:b='a'/></CIM>",
                     &XmlLimits::namespaces, 1);
}

TEST(Limits, areThose)
{
    EXPECT_EQ(refusalOf("<A" + numbered(100, " a", "=''") + "/>"), "");
    EXPECT_THAT(refusalOf("<A" + numbered(101, " a", "=''") + "/>"),
                EndsWith("at most 100 attributes of an element"));
    std::string elements;
    for (int i = 0; i < 600; ++i)
        elements += "<A" + numbered(100, " a", "=''") + "/>";
    EXPECT_EQ(refusalOf(elements), "");
    EXPECT_THAT(refusalOf(elements + "<A a=''/>"), EndsWith("at most 60000 attributes"));
    EXPECT_EQ(refusalOf(numbered(20000, "<A", "/>")), "");
    EXPECT_THAT(refusalOf(numbered(20001, "<A", "/>")), EndsWith("at most 20000 elements"));
    EXPECT_EQ(refusalOf("<A" + numbered(100, " xmlns:a", "=''") + ">"), "");
    EXPECT_THAT(refusalOf("<A" + numbered(100, " xmlns:a", "=''") + "><A xmlns=''>"),
                EndsWith("at most 100 namespaces declared at a time"));
    EXPECT_EQ(refusalOf(numbered(64, "<A", ">")), "");
    EXPECT_THAT(refusalOf(numbered(65, "<A", ">")), EndsWith("elements at most 64 deep in each other"));
}

TEST(Limits, holdForWhatIsNotWellFormed)
{
    // The parser stops at each of these; what stands behind it is counted or not.
    for (const char* document :
         {"",   "<",   "<a",   "<a b",   "<a b='",    "<a b=\"x", "</",   "</a></a></a><b>",
          "<!", "<!-", "<!--", "<!--->", "<![CDATA[", "<?",       "<?x",  ">",
          "/>", "<>",  "</>",  "<a/",    "=",         "<=",       "<a='", "<a =/>"})
        EXPECT_EQ(refusalOf(document), "") << document;
    EXPECT_EQ(refusalOf("<a " + std::string(50, '=') + ">"), "");
    EXPECT_NE(refusalOf("<a " + std::string(101, '=')), "");
    EXPECT_NE(refusalOf(numbered(65, "<a b='>' c=", "")), "");
}

TEST(Limits, tellThePlace)
{
    XmlLimits limits;
    limits.elements = 1;
    EXPECT_THAT(refusalOf("<a>\n\u00fc\u00fc<b/>", limits), StartsWith("line 2, column 3: expected "));
    EXPECT_EQ(placeAt("abc", 0), "line 1, column 1: ");
    EXPECT_EQ(placeAt("a\n\nbc", 4), "line 3, column 2: ");
}

} // namespace
