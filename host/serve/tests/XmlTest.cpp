#include "serve/Xml.h"

#include "serve/Dtd.h"
#include "serve/Fault.h"

#include <optional>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace cimhost::serve;
using testing::AllOf;
using testing::HasSubstr;
using testing::StartsWith;

namespace {

Element parse(const std::string& document, const XmlLimits& limits = {})
{
    return parseXml(document, limits, &isKnownElement);
}

/// What reading the document ends in.
struct Ending
{
    std::optional<Fault> fault; ///< nothing: it was read
    std::string message;
};

Ending endingOf(const std::string& document, const XmlLimits& limits = {})
{
    try {
        parse(document, limits);
        return {};
    } catch (const RequestError& error) {
        return {error.fault(), error.what()};
    }
}

std::string repeated(const std::string& text, int count)
{
    std::string all;
    for (int i = 0; i < count; ++i)
        all += text;
    return all;
}

TEST(Xml, becomesATree)
{
    const Element cim = parse("<?xml version=\"1.0\"?>\n<CIM A=\"1\" B='2'>\n<MESSAGE/><HOST>h</HOST></CIM>");
    EXPECT_EQ(cim.name, "CIM");
    EXPECT_EQ(cim.line, 2);
    ASSERT_EQ(cim.attributes.size(), 2U);
    EXPECT_EQ(cim.attributes[1].name + cim.attributes[1].value, "B2");
    ASSERT_EQ(cim.children.size(), 2U);
    EXPECT_EQ(cim.children[0].name, "MESSAGE");
    EXPECT_EQ(cim.children[0].line, 3);
    EXPECT_EQ(cim.children[1].text, "h");
}

TEST(Xml, resolvesReferencesAndCdata)
{
    const Element value =
        parse("<VALUE A=\"&lt;&#x41;&quot;\"> a&amp;<![CDATA[<b>&amp;]]>\r\n&#13;\u00fc\u98a8 </VALUE>");
    EXPECT_EQ(value.attributes[0].value, "<A\"");
    EXPECT_EQ(value.text, " a&<b>&amp;\n\r\u00fc\u98a8 ");
}

TEST(Xml, leavesOutWhatTheDtdDoesNotKnow)
{
    const Element cim =
        parse("<CIM><NEW><VALUE>a</VALUE>b<NEW/></NEW><x:VALUE xmlns:x=\"u\"/><VALUE>c</VALUE></CIM>");
    ASSERT_EQ(cim.children.size(), 1U);
    EXPECT_EQ(cim.children[0].text, "c");
    EXPECT_EQ(cim.text, "");
    EXPECT_EQ(endingOf("<NEW/>").fault, Fault::notLooselyValid);
}

TEST(Xml, ignoresCommentsAndInstructions)
{
    EXPECT_EQ(parse("<!-- a --><?b c?><CIM><!-- <VALUE/> --><?d e?></CIM><!-- f -->").children.size(), 0U);
}

TEST(Xml, namesThePlaceOfWhatIsNotWellFormed)
{
    for (const char* document :
         {"", " ", "x", "<CIM", "<CIM>", "<CIM></MESSAGE>", "<CIM/><CIM/>", R"(<CIM A="1" A="2"/>)",
          "<CIM A=1/>", "<CIM>&nothing;</CIM>", "<CIM>&#0;</CIM>", "<CIM>&#x1;</CIM>", "<CIM>\x01</CIM>",
          "<CIM A=\"<\"/>", "<CIM>]]></CIM>", "<CIM/>tail", " <?xml version=\"1.0\"?><CIM/>",
          R"(<?xml version="1.0" encoding="no-such-encoding"?><CIM/>)"}) {
        const Ending ending = endingOf(document);
        EXPECT_EQ(ending.fault, Fault::notWellFormed) << document;
        EXPECT_THAT(ending.message, HasSubstr("expected")) << document;
    }
    EXPECT_THAT(endingOf("<CIM>\n<VALUE>\n</CIM>").message, StartsWith("line 3, column "));
}

TEST(Xml, isTextInUtf8)
{
    EXPECT_EQ(endingOf("\xef\xbb\xbf<?xml version=\"1.0\" encoding=\"utf-8\"?><CIM/>").fault, std::nullopt);
    const Ending latin = endingOf("<CIM>\n\xfc</CIM>");
    EXPECT_EQ(latin.fault, Fault::notWellFormed);
    EXPECT_EQ(latin.message, "line 2, column 1: found a byte that is not UTF-8, expected text in UTF-8");
    EXPECT_THAT(endingOf(std::string("<CIM>\0</CIM>", 12)).message, HasSubstr("a null character"));
    for (const char* encoding : {"ISO-8859-1", "UTF-16", "US-ASCII", "UTF-7"})
        EXPECT_THAT(
            endingOf(std::string("<?xml version=\"1.0\" encoding=\"") + encoding + "\"?><CIM/>").message,
            HasSubstr(encoding));
    EXPECT_EQ(endingOf(std::string("\xff\xfe<\0C\0", 6)).fault, Fault::notWellFormed);
    EXPECT_EQ(endingOf(std::string("<\0C\0I\0M\0/\0>\0", 12)).fault, Fault::notWellFormed);
    EXPECT_EQ(endingOf("<CIM>\xed\xa0\x80</CIM>").fault, Fault::notWellFormed) << "half a surrogate pair";
}

TEST(Xml, hasNoDocumentTypeDeclaration)
{
    const char* const bomb = "<!DOCTYPE CIM [<!ENTITY a \"aaaaaaaaaa\"><!ENTITY b \"&a;&a;&a;&a;\">"
                             "<!ENTITY c \"&b;&b;&b;&b;\">]><CIM>&c;</CIM>";
    const char* const file = "<!DOCTYPE CIM [<!ENTITY a SYSTEM \"file:///etc/passwd\">]><CIM>&a;</CIM>";
    const char* const subset =
        "<?xml version=\"1.0\"?>\n<!DOCTYPE CIM SYSTEM \"http://127.0.0.1/cim.dtd\"><CIM/>";
    const char* const parameter = "<!DOCTYPE CIM [<!ENTITY % a SYSTEM \"file:///dev/zero\"> %a;]><CIM/>";
    for (const char* document : {bomb, file, subset, parameter}) {
        EXPECT_EQ(endingOf(document).fault, Fault::notValid) << document;
        EXPECT_THAT(
            endingOf(document).message,
            AllOf(StartsWith("line "), HasSubstr("found a document type declaration, expected none")));
    }
}

TEST(Xml, isBoundedInDepth)
{
    const XmlLimits limits{5, 100};
    EXPECT_EQ(endingOf(repeated("<CIM>", 5) + repeated("</CIM>", 5), limits).fault, std::nullopt);
    EXPECT_EQ(endingOf(repeated("<CIM>", 6) + repeated("</CIM>", 6), limits).fault, Fault::tooLarge);
    EXPECT_EQ(endingOf(repeated("<X>", 6), limits).fault, Fault::tooLarge);
    EXPECT_THAT(
        endingOf(repeated("<CIM>\n", 100000)).message,
        AllOf(StartsWith("line 65, column "), HasSubstr("expected elements at most 64 deep in each other")));
}

TEST(Xml, isBoundedInElements)
{
    const XmlLimits limits{5, 10};
    EXPECT_EQ(endingOf("<CIM>" + repeated("<CIM/>", 9) + "</CIM>", limits).fault, std::nullopt);
    EXPECT_EQ(endingOf("<CIM>" + repeated("<CIM/>", 10) + "</CIM>", limits).fault, Fault::tooLarge);
    EXPECT_EQ(endingOf("<CIM>" + repeated("<X/>", 10) + "</CIM>", limits).fault, Fault::tooLarge);
}

TEST(Xml, takesLongAttributes)
{
    const std::string huge(500000, 'x');
    EXPECT_EQ(parse("<CIM A=\"" + huge + "\"/>").attributes[0].value, huge);
    // A name is no text: the library bounds it.
    EXPECT_EQ(endingOf("<" + huge + "/>").fault, Fault::notWellFormed);
}

TEST(Xml, tellsInPrintableTextWhatIsWrong)
{
    EXPECT_EQ(endingOf("<CIM>&\x1b[2J;</CIM>").message.find('\x1b'), std::string::npos);
    EXPECT_LT(endingOf("<CIM>&" + std::string(40000, 'x') + "</CIM>").message.size(), 500U);
}

} // namespace
