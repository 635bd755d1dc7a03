#include "serve/Http.h"

#include <string>

#include <gtest/gtest.h>

using namespace cimhost::serve;

namespace {

HttpRequest requestWith(const std::string& name, const std::string& value)
{
    return {"POST", "/", "HTTP/1.1", {{name, value}}, ""};
}

TEST(Http, findsHeadersWhateverTheirLetterCase)
{
    const HttpRequest request{"POST", "/", "HTTP/1.1", {{"content-TYPE", "a"}, {"Content-Type", "b"}}, ""};
    ASSERT_NE(findHeader(request, "Content-Type"), nullptr);
    EXPECT_EQ(*findHeader(request, "Content-Type"), "a");
    EXPECT_EQ(findHeader(request, "Content"), nullptr);
}

TEST(Http, splitsValuesAndParameters)
{
    const std::string value = "application/xml ; charset = \"utf-8\";x=1";
    EXPECT_EQ(withoutParameters(value), "application/xml");
    EXPECT_EQ(parameterOf(value, "CharSet"), "utf-8");
    EXPECT_EQ(parameterOf(value, "x"), "1");
    EXPECT_EQ(parameterOf(value, "y"), "");
    EXPECT_EQ(parameterOf("a", "x"), "");
    EXPECT_EQ(parameterOf(";;=;x", "x"), "");
    EXPECT_EQ(parameterOf("a;x=\"", "x"), "\"");
}

TEST(Http, readsListsOfWhatIsAccepted)
{
    const auto takesXml = [](const std::string& list) {
        return accepts(requestWith("Accept", list), "Accept", {"application/xml", "text/xml"});
    };
    EXPECT_TRUE(accepts({}, "Accept", {"text/xml"})) << "without the header anything is";
    for (const char* list : {"*/*", "text/xml", "TEXT/XML", "text/*", "application/*;q=0.5",
                             "text/html, text/xml", "text/html,*/*;q=0.1", "application/xml; charset=utf-8"})
        EXPECT_TRUE(takesXml(list)) << list;
    for (const char* list :
         {"", "text/html", "text/xml;q=0", "*/*; q=0.000", "text", "text/xmlx", "image/*", ","})
        EXPECT_FALSE(takesXml(list)) << list;
    EXPECT_TRUE(accepts(requestWith("Accept-Charset", "iso-8859-1, UTF-8"), "Accept-Charset", {"utf-8"}));
    EXPECT_TRUE(accepts(requestWith("Accept-Charset", "*"), "Accept-Charset", {"utf-8"}));
}

} // namespace
