#include "cim/ObjectPathText.h"

#include "cim/Values.h"
#include "cim/tests/Print.h"

#include <string>

#include <gtest/gtest.h>

using namespace cimhost::cim;

namespace {

/// The value of the one key of CIM_A.K=TEXT.
Value keyOf(const std::string& text)
{
    const ObjectPath path = parseObjectPath("CIM_A.K=" + text);
    EXPECT_EQ(path.keys.size(), 1U);
    return path.keys.at(0).value;
}

ObjectPath pathWithKey(Value value)
{
    return {"", "", "CIM_A", {{"K", std::move(value)}}};
}

TEST(ObjectPathReader, readsAClassAlone)
{
    EXPECT_EQ(parseObjectPath("CIM_A"), (ObjectPath{"", "", "CIM_A", {}}));
}

TEST(ObjectPathReader, readsANamespace)
{
    EXPECT_EQ(parseObjectPath("root:CIM_A"), (ObjectPath{"", "root", "CIM_A", {}}));
    EXPECT_EQ(parseObjectPath("root/a/b:CIM_A"), (ObjectPath{"", "root/a/b", "CIM_A", {}}));
}

TEST(ObjectPathReader, readsAHostAndDropsTheScheme)
{
    EXPECT_EQ(parseObjectPath("//srv-1.example/root/cimv2:CIM_A"),
              (ObjectPath{"srv-1.example", "root/cimv2", "CIM_A", {}}));
    EXPECT_EQ(parseObjectPath("http://127.0.0.1:5988/root/cimv2:CIM_A"),
              (ObjectPath{"127.0.0.1:5988", "root/cimv2", "CIM_A", {}}));
    EXPECT_EQ(parseObjectPath("HTTPS://[::1]:5989/root/cimv2:CIM_A"),
              (ObjectPath{"[::1]:5989", "root/cimv2", "CIM_A", {}}));
    EXPECT_EQ(parseObjectPath("//srv/CIM_A"), (ObjectPath{"srv", "", "CIM_A", {}}));
}

TEST(ObjectPathReader, takesHttpWithoutSlashesForANamespace)
{
    EXPECT_EQ(parseObjectPath("http:CIM_A"), (ObjectPath{"", "http", "CIM_A", {}}));
}

TEST(ObjectPathReader, readsSeveralKeysInTheirOrder)
{
    const ObjectPath path = parseObjectPath("root/cimv2:CIM_A.Name=\"x\",Number=42,Flag=TRUE");
    ASSERT_EQ(path.keys.size(), 3U);
    EXPECT_EQ(path.keys[0].name, "Name");
    EXPECT_EQ(path.keys[0].value, textValue("x"));
    EXPECT_EQ(path.keys[1].name, "Number");
    EXPECT_EQ(path.keys[1].value, unsignedValue(42));
    EXPECT_EQ(path.keys[2].name, "Flag");
    EXPECT_EQ(path.keys[2].value, booleanValue(true));
}

TEST(ObjectPathReader, readsNumbersOfBothSignsUpToTheirLimits)
{
    EXPECT_EQ(keyOf("0"), unsignedValue(0));
    EXPECT_EQ(keyOf("-0"), unsignedValue(0));
    EXPECT_EQ(keyOf("+7"), unsignedValue(7));
    EXPECT_EQ(keyOf("007"), unsignedValue(7));
    EXPECT_EQ(keyOf("-7"), signedValue(-7));
    EXPECT_EQ(keyOf("18446744073709551615"), unsignedValue(UINT64_MAX));
    EXPECT_EQ(keyOf("-9223372036854775808"), signedValue(INT64_MIN));
}

TEST(ObjectPathReader, readsRealNumbers)
{
    EXPECT_EQ(keyOf("1.5"), realValue(1.5));
    EXPECT_EQ(keyOf("-2.5e-3"), realValue(-2.5e-3));
    EXPECT_EQ(keyOf("1E3"), realValue(1000));
    EXPECT_EQ(keyOf(".5"), realValue(0.5));
}

TEST(ObjectPathReader, readsBooleansInAnyLetterCase)
{
    EXPECT_EQ(keyOf("TRUE"), booleanValue(true));
    EXPECT_EQ(keyOf("true"), booleanValue(true));
    EXPECT_EQ(keyOf("FALSE"), booleanValue(false));
    EXPECT_EQ(keyOf("False"), booleanValue(false));
}

TEST(ObjectPathReader, readsEveryEscape)
{
    EXPECT_EQ(keyOf(R"("\"\\\'\b\t\n\f\r")"), textValue("\"\\'\b\t\n\f\r"));
    EXPECT_EQ(keyOf(R"("\x41\x0042\xe9\X20AC")"), textValue("AB\u00e9\u20ac"));
    EXPECT_EQ(keyOf(R"("\x00411")"), textValue("A1")); // four digits at most
}

TEST(ObjectPathReader, keepsTextInUtf8)
{
    EXPECT_EQ(keyOf("\"L\u00fcfter \u98a8\""), textValue("L\u00fcfter \u98a8"));
}

TEST(ObjectPathReader, readsReferences)
{
    const ObjectPath fan{"", "root/cimv2", "ACME_Fan", {{"Name", textValue("a \"b\"")}}};
    EXPECT_EQ(keyOf(R"("root/cimv2:ACME_Fan.Name=\"a \\\"b\\\"\"")"), referenceValue(fan));
    const ObjectPath bare{"", "", "ACME_Fan", {{"Number", unsignedValue(1)}}};
    EXPECT_EQ(keyOf(R"("ACME_Fan.Number=1")"), referenceValue(bare));
    const ObjectPath remote{"srv", "root/cimv2", "ACME_Fan", {{"Number", unsignedValue(1)}}};
    EXPECT_EQ(keyOf(R"("//srv/root/cimv2:ACME_Fan.Number=1")"), referenceValue(remote));
}

TEST(ObjectPathReader, readsReferencesInsideReferences)
{
    const ObjectPath inner{"", "", "CIM_C", {{"N", unsignedValue(1)}}};
    const ObjectPath outer{"", "", "CIM_B", {{"R", referenceValue(inner)}}};
    EXPECT_EQ(keyOf(R"("CIM_B.R=\"CIM_C.N=1\"")"), referenceValue(outer));
}

/// Texts that share something with a path and are none.
class StringsLikePaths : public testing::TestWithParam<const char*>
{};

TEST_P(StringsLikePaths, stayStrings)
{
    const std::string content = GetParam();
    const std::string written = toText(pathWithKey(textValue(content)));
    EXPECT_EQ(parseObjectPath(written), pathWithKey(textValue(content))) << written;
    // No special escape is needed: what a person types without one means the same.
    EXPECT_EQ(written.find("\\x"), std::string::npos) << written;
}

INSTANTIATE_TEST_SUITE_P(
    ObjectPathReader, StringsLikePaths,
    testing::Values("", "Fan 1:/x", "Fan 1:/root/led[3]", "System ID LED:0.1.2", "a.b=c", "a=b,c=d", "=", ".",
                    ",", ":", "/", "root/cimv2:CIM_A", "CIM_A", "CIM_A.", "CIM_A.K", "CIM_A.K=", "CIM_A.K=x",
                    "CIM_A.K=\"x", "CIM_A.K=\"x\" ", " CIM_A.K=\"x\"", "CIM_A.K=\"x\",", "CIM_A.K=1,K=2",
                    "CIM_A.K =1", "Fan.Number=1", "root/cimv2:Fan.Number=1", "_A.K=1", "A_.K=1", "1_A.K=1",
                    "Bay 3: CIM_A.K=1", "\"quoted\"", "back\\slash", "ACME:Capabilities1", "TRUE", "42", "//",
                    "//srv/", "http://srv/index.html", "mailto:CIM_A.K=1?", "CIM-A.K=1"));

TEST(ObjectPathReader, takesAnEscapedTextForAStringWhateverItLooksLike)
{
    EXPECT_EQ(keyOf(R"("CIM_B.N\x003D1")"), textValue("CIM_B.N=1"));
    EXPECT_EQ(keyOf(R"("\x43IM_B.N=1")"), textValue("CIM_B.N=1"));
}

TEST(ObjectPathWriter, tellsAStringThatLooksLikeAPathFromAReference)
{
    const ObjectPath string = pathWithKey(textValue("CIM_B.N=1"));
    EXPECT_EQ(toText(string), R"(CIM_A.K="CIM_B.N\x003D1")");
    EXPECT_EQ(parseObjectPath(toText(string)), string);

    const ObjectPath target{"", "", "CIM_B", {{"N", unsignedValue(1)}}};
    EXPECT_EQ(toText(pathWithKey(referenceValue(target))), R"(CIM_A.K="CIM_B.N=1")");
}

TEST(ObjectPathWriter, writesEveryPart)
{
    const ObjectPath path{"srv:5988",
                          "root/cimv2",
                          "CIM_A",
                          {{"S", textValue(R"(a "b" \c)")},
                           {"U", unsignedValue(UINT64_MAX)},
                           {"I", signedValue(INT64_MIN)},
                           {"R", realValue(5)},
                           {"B", booleanValue(false)}}};
    EXPECT_EQ(toText(path),
              R"(//srv:5988/root/cimv2:CIM_A.S="a \"b\" \\c",U=18446744073709551615,I=-9223372036854775808,)"
              R"(R=5.0,B=FALSE)");
    EXPECT_EQ(parseObjectPath(toText(path)), path);
}

TEST(ObjectPathWriter, leavesOutWhatIsNotThere)
{
    EXPECT_EQ(toText(ObjectPath{"", "", "CIM_A", {}}), "CIM_A");
    EXPECT_EQ(toText(ObjectPath{"", "root", "CIM_A", {}}), "root:CIM_A");
    EXPECT_EQ(toText(ObjectPath{"srv", "", "CIM_A", {}}), "//srv/CIM_A");
    EXPECT_EQ(toText(ObjectPath{}), "");
}

TEST(ObjectPathWriter, writesWhatNoKeyMayHaveWithoutFailing)
{
    EXPECT_EQ(toText(pathWithKey(nullValue(CMPI_string))), "CIM_A.K=NULL");
    EXPECT_EQ(toText(pathWithKey(arrayValue(CMPI_uint16, {std::uint64_t{1}, std::uint64_t{2}}))),
              "CIM_A.K={1, 2}");
    EXPECT_THROW(parseObjectPath("CIM_A.K=NULL"), ParseError);
    EXPECT_THROW(parseObjectPath("CIM_A.K={1, 2}"), ParseError);
}

TEST(ObjectPathWriter, escapesWhatWouldDriveATerminal)
{
    // NOLINTNEXTLINE(misc-misleading-bidirectional): what must not get through
    const ObjectPath path = pathWithKey(textValue("\x1b[2J\n\u009b\u202e"));
    EXPECT_EQ(toText(path), R"(CIM_A.K="\x001B[2J\n\x009B\x202E")");
    EXPECT_EQ(parseObjectPath(toText(path)), path);
}

/// One wrong text, and the error that it gives.
struct Wrong
{
    const char* text;
    std::size_t column;
    const char* found;
    const char* expected;
};

class WrongPaths : public testing::TestWithParam<Wrong>
{};

TEST_P(WrongPaths, areRefusedWithThePlace)
{
    const Wrong& wrong = GetParam();
    try {
        parseObjectPath(wrong.text);
        FAIL() << "read: " << wrong.text;
    } catch (const ParseError& error) {
        EXPECT_EQ(error.column(), wrong.column) << wrong.text;
        EXPECT_EQ(error.found(), wrong.found) << wrong.text;
        EXPECT_EQ(error.expected(), wrong.expected) << wrong.text;
        EXPECT_EQ(error.what(), "column " + std::to_string(wrong.column) + ": found " + wrong.found +
                                    ", expected " + wrong.expected);
    }
}

constexpr const char* aName = "a namespace or a class name";
constexpr const char* aClass = "a class name";
constexpr const char* colonAndClass = "\":\" and a class name";
constexpr const char* aKey = "a key name";
constexpr const char* equals = "\"=\" and the key's value";
constexpr const char* aValue = "a quoted text, a number, TRUE or FALSE";
constexpr const char* dotOrEnd = "\".\" and a key, or the end";
constexpr const char* commaOrEnd = "\",\" and a key, or the end";
constexpr const char* number = "a decimal number of 64 bits";
constexpr const char* escape = R"(one of \" \\ \' \b \t \n \f \r \x0000)";
constexpr const char* numericEscape = "\\x and the hexadecimal number of a character";

INSTANTIATE_TEST_SUITE_P(
    ObjectPathReader, WrongPaths,
    testing::Values(
        // Host, namespace and class
        Wrong{"", 1, "the end", aName}, Wrong{" CIM_A", 1, "\" \"", aName}, Wrong{"1A", 1, "\"1\"", aName},
        Wrong{"/root:CIM_A", 1, "\"/\"", aName}, Wrong{":CIM_A", 1, "\":\"", aName},
        Wrong{"//", 3, "the end", "a host name"}, Wrong{"///CIM_A", 3, "\"/\"", "a host name"},
        Wrong{"//srv", 6, "the end", "\"/\" after the host"},
        Wrong{"//me@srv/CIM_A", 5, "\"@\"", "\"/\" after the host"}, Wrong{"//srv/", 7, "the end", aName},
        Wrong{"root/", 6, "the end", "a name of the namespace"},
        Wrong{"root//a:CIM_A", 6, "\"/\"", "a name of the namespace"},
        Wrong{"root/cimv2", 11, "the end", colonAndClass},
        Wrong{"root/cimv2.K=1", 11, "\".\"", colonAndClass}, Wrong{"root:", 6, "the end", aClass},
        Wrong{"root:a:CIM_A", 7, "\":\"", dotOrEnd}, Wrong{"root:5A", 6, "\"5\"", aClass},
        Wrong{"CIM_A ", 6, "\" \"", dotOrEnd}, Wrong{"CIM-A", 4, "\"-\"", dotOrEnd},
        Wrong{"CIM_A=1", 6, "\"=\"", dotOrEnd},
        // Keys
        Wrong{"CIM_A.", 7, "the end", aKey}, Wrong{"CIM_A..", 7, "\".\"", aKey},
        Wrong{"CIM_A.=1", 7, "\"=\"", aKey}, Wrong{"CIM_A.1=1", 7, "\"1\"", aKey},
        Wrong{"CIM_A.K", 8, "the end", equals}, Wrong{"CIM_A.K =1", 8, "\" \"", equals},
        Wrong{"CIM_A.K:1", 8, "\":\"", equals}, Wrong{"CIM_A.K=1,", 11, "the end", aKey},
        Wrong{"CIM_A.K=1 ,L=2", 10, "\" \"", commaOrEnd}, Wrong{"CIM_A.K=1;L=2", 10, "\";\"", commaOrEnd},
        Wrong{"CIM_A.K=\"a\"b", 12, "\"b\"", commaOrEnd},
        Wrong{"CIM_A.K=1,k=2", 11, "the key k again", "each key once"},
        // Values
        Wrong{"CIM_A.K=", 9, "the end", aValue}, Wrong{"CIM_A.K= 1", 9, "\" \"", aValue},
        Wrong{"CIM_A.K=,", 9, "\",\"", aValue}, Wrong{"CIM_A.K='a'", 9, "\"'\"", aValue},
        Wrong{"CIM_A.K=abc", 9, "\"abc\"", aValue}, Wrong{"CIM_A.K=TRUEST", 9, "\"TRUEST\"", aValue},
        Wrong{"CIM_A.K=-", 9, "\"-\"", number}, Wrong{"CIM_A.K=+-1", 9, "\"+-1\"", number},
        Wrong{"CIM_A.K=1-2", 9, "\"1-2\"", number}, Wrong{"CIM_A.K=1.2.3", 9, "\"1.2.3\"", number},
        Wrong{"CIM_A.K=.", 9, "\".\"", number}, Wrong{"CIM_A.K=1e", 9, "\"1e\"", number},
        Wrong{"CIM_A.K=1e999", 9, "\"1e999\"", number}, Wrong{"CIM_A.K=0x10", 10, "\"x\"", commaOrEnd},
        Wrong{"CIM_A.K=18446744073709551616", 9, "\"18446744073709551616\"", number},
        Wrong{"CIM_A.K=-9223372036854775809", 9, "\"-9223372036854775809\"", number},
        // Quoted texts
        Wrong{"CIM_A.K=\"", 10, "the end", "the closing quote"},
        Wrong{"CIM_A.K=\"a\\\"", 13, "the end", "the closing quote"},
        Wrong{R"(CIM_A.K="\)", 10, "a backslash before the end", escape},
        Wrong{"CIM_A.K=\"\\d\"", 10, "a backslash before \"d\"", escape},
        Wrong{"CIM_A.K=\"\\\u00e9\"", 10, "a backslash before \"\u00e9\"", escape},
        Wrong{"CIM_A.K=\"\\x\"", 10, "\"\\x\"", numericEscape},
        Wrong{"CIM_A.K=\"\\xg\"", 10, "\"\\x\"", numericEscape},
        Wrong{"CIM_A.K=\"\\x0000\"", 10, "\"\\x0000\"", numericEscape},
        Wrong{"CIM_A.K=\"\\xD800\"", 10, "\"\\xD800\"", numericEscape},
        Wrong{"CIM_A.K=\"\\x-1\"", 10, "\"\\x\"", numericEscape},
        // Characters: columns count them, not bytes
        Wrong{"CIM_A.K=\"\u00e9\u98a8\"!", 13, "\"!\"", commaOrEnd},
        Wrong{"CIM_A.K=\"\xff\"", 10, "a byte that is not UTF-8", "text in UTF-8"},
        Wrong{"CIM_A.K=\"\xe2\x82\"", 10, "a byte that is not UTF-8", "text in UTF-8"},
        Wrong{"CIM_A.K=\x1b", 9, "\"\\x001B\"", aValue}));

TEST(ObjectPathReader, cutsWhatItQuotes)
{
    const std::string name(100, 'x');
    std::string keyTwice = "C." + name;
    keyTwice += "=1," + name;
    keyTwice += "=2";
    for (const std::string& text : {"C.K=" + name, "C.K=7" + std::string(100, '7'), keyTwice})
        try {
            parseObjectPath(text);
            FAIL() << text;
        } catch (const ParseError& error) {
            EXPECT_LT(error.found().size(), 90U) << text;
            EXPECT_NE(error.found().find("..."), std::string::npos) << text;
        }
}

TEST(ObjectPathReader, refusesANullCharacter)
{
    EXPECT_THROW(parseObjectPath(std::string("CIM_A.K=\"a\0b\"", 13)), ParseError);
}

TEST(ObjectPathReader, refusesTextThatIsTooLong)
{
    const std::string frame = "CIM_A.K=\"\"";
    const std::string longest =
        std::string("CIM_A.K=\"") + std::string(maxPathLength - frame.size(), 'x') + '"';
    EXPECT_EQ(parseObjectPath(longest).className, "CIM_A");
    try {
        parseObjectPath(longest + "x");
        FAIL();
    } catch (const ParseError& error) {
        EXPECT_STREQ(error.what(), "column 1: found 65537 bytes, expected at most 65536");
    }
}

/// References inside each other, so many that the innermost is at that depth.
ObjectPath nested(int depth)
{
    ObjectPath path = pathWithKey(unsignedValue(1));
    for (int level = 0; level < depth; ++level)
        path = pathWithKey(referenceValue(std::move(path)));
    return path;
}

TEST(ObjectPathReader, readsReferencesUpToTheDeepest)
{
    EXPECT_EQ(parseObjectPath(toText(nested(maxPathDepth))), nested(maxPathDepth));
}

TEST(ObjectPathReader, refusesDeeperReferencesAtTheOutermostOne)
{
    try {
        parseObjectPath(toText(nested(maxPathDepth + 1)));
        FAIL();
    } catch (const ParseError& error) {
        EXPECT_STREQ(error.what(),
                     "column 9: found a reference inside of references, expected at most 8 of them");
    }
}

TEST(ObjectPathWriter, keepsAStringOfTooDeepReferencesAString)
{
    const ObjectPath path = pathWithKey(textValue(toText(nested(maxPathDepth))));
    EXPECT_EQ(parseObjectPath(toText(path)), path);
}

/// A path with something of everything.
constexpr const char* everything =
    R"(//srv:5988/root/cimv2:CIM_A.S="a\"b\\\n\x20AC é",N=-42,R=1.5e3,B=TRUE,L="root/cimv2:CIM_B.K=\"x,y=\\\"z\\\"\",M=1")";

TEST(ObjectPathReader, readsOrRefusesEveryBeginningOfAPath)
{
    const std::string text = everything;
    ASSERT_NO_THROW(parseObjectPath(text));
    for (std::size_t length = 0; length < text.size(); ++length) {
        try {
            parseObjectPath(text.substr(0, length));
        } catch (const ParseError& error) {
            EXPECT_LE(error.offset(), length);
            EXPECT_LE(error.column(), length + 1);
        }
    }
}

TEST(ObjectPathReader, readsOrRefusesAPathWithAnyByteChanged)
{
    const std::string text = everything;
    for (std::size_t place = 0; place < text.size(); ++place) {
        for (int byte = 0; byte < 256; ++byte) {
            std::string changed = text;
            changed[place] = static_cast<char>(byte);
            try {
                const ObjectPath path = parseObjectPath(changed);
                EXPECT_EQ(parseObjectPath(toText(path)), path) << changed;
            } catch (const ParseError& error) {
                EXPECT_LE(error.offset(), changed.size()) << changed;
            }
        }
    }
}

} // namespace
