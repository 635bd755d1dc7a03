#include "cim/Utf8.h"

#include <gtest/gtest.h>

using namespace cimhost::cim;

namespace {

TEST(Characters, areTakenOffOneByOne)
{
    std::string_view text = "a\u00e9\u98a8\U0001f4a1";
    EXPECT_EQ(takeCharacter(text), U'a');
    EXPECT_EQ(takeCharacter(text), U'\u00e9');
    EXPECT_EQ(takeCharacter(text), U'\u98a8');
    EXPECT_EQ(takeCharacter(text), U'\U0001f4a1');
    EXPECT_TRUE(text.empty());
}

TEST(Characters, areMissingWhereBytesAreNoUtf8)
{
    for (const char* wrong : {"\xff", "\xc0\x80", "\xe2\x82", "\xed\xa0\x80", "\xf4\x90\x80\x80"}) {
        std::string_view text = wrong;
        const std::size_t size = text.size();
        EXPECT_EQ(takeCharacter(text), std::nullopt) << wrong;
        EXPECT_EQ(text.size(), size - 1) << wrong;
    }
}

TEST(Printable, leavesTextAlone)
{
    EXPECT_EQ(printable("plain \\ \"text\" L\u00fcfter \u98a8 \U0001f4a1"),
              "plain \\ \"text\" L\u00fcfter \u98a8 \U0001f4a1");
}

TEST(Printable, escapesWhatActsOnATerminal)
{
    EXPECT_EQ(printable("\b\t\n\f\r"), R"(\b\t\n\f\r)");
    EXPECT_EQ(printable("\x1b[31m"), R"(\x001B[31m)");
    EXPECT_EQ(printable(std::string_view("\0\x7f", 2)), R"(\x0000\x007F)");
    EXPECT_EQ(printable("\u0080\u009b"), R"(\x0080\x009B)");
    EXPECT_EQ(printable("\u2028\u2029"), R"(\x2028\x2029)");
    // NOLINTNEXTLINE(misc-misleading-bidirectional): what must not get through
    EXPECT_EQ(printable("\u061c\u200e\u200f\u202a\u202e\u2066\u2069"),
              R"(\x061C\x200E\x200F\x202A\x202E\x2066\x2069)");
}

TEST(Printable, replacesWhatIsNoUtf8)
{
    EXPECT_EQ(printable("a\xff\x9b"
                        "b"),
              "a\uFFFD\uFFFDb");
}

TEST(Excerpt, cutsAfterWholeCharacters)
{
    EXPECT_EQ(excerpt("L\u00fcfter", 6), "L\u00fcfter");
    EXPECT_EQ(excerpt("L\u00fcfter", 2), "L\u00fc...");
    EXPECT_EQ(excerpt("\xff\x1b!", 2), "\uFFFD\\x001B...");
    EXPECT_EQ(excerpt("a", 0), "...");
    EXPECT_EQ(excerpt("", 0), "");
}

TEST(Escaped, escapesBackslashAndQuotes)
{
    EXPECT_EQ(escaped("a\"b\\c'd\n", "\""), R"(a\"b\\c'd\n)");
    EXPECT_EQ(escaped("a\"b'", "'"), R"(a"b\')");
}

TEST(DisplayWidth, countsColumns)
{
    EXPECT_EQ(displayWidth(""), 0U);
    EXPECT_EQ(displayWidth("abc"), 3U);
    EXPECT_EQ(displayWidth("L\u00fcfter"), 6U);
    EXPECT_EQ(displayWidth("\u98a8\u6247"), 4U);
    EXPECT_EQ(displayWidth("e\u0301"), 1U); // a combining accent
}

} // namespace
