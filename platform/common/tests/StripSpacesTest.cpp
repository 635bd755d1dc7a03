#include <Tavro/Common.h>

#include <string>
#include <type_traits>

#include <gtest/gtest.h>

namespace {

using Tavro::stripSpaces;

static_assert(std::is_same_v<decltype(stripSpaces), std::string(const std::string&)>);

TEST(StripSpaces, takesBlanksFromBothEnds)
{
    EXPECT_EQ(stripSpaces("  a  "), "a");
    EXPECT_EQ(stripSpaces(" a"), "a");
    EXPECT_EQ(stripSpaces("a "), "a");
}

TEST(StripSpaces, leavesBlanksWithin)
{
    EXPECT_EQ(stripSpaces(" a  b c "), "a  b c");
}

TEST(StripSpaces, leavesTextsWithoutBlanks)
{
    EXPECT_EQ(stripSpaces("abc"), "abc");
    EXPECT_EQ(stripSpaces(""), "");
}

TEST(StripSpaces, leavesNothingOfBlanksAlone)
{
    EXPECT_EQ(stripSpaces(" "), "");
    EXPECT_EQ(stripSpaces("     "), "");
}

TEST(StripSpaces, takesNoOtherWhiteSpaceForABlank)
{
    for (const std::string text : {"\ta\t", "\na\n", "\ra\r", "\va\v", "\fa\f", "\u00A0a\u00A0"})
        EXPECT_EQ(stripSpaces(" " + text + " "), text);
}

TEST(StripSpaces, keepsNullCharacters)
{
    const std::string text("\0a\0", 3);
    EXPECT_EQ(stripSpaces(" " + text + " "), text);
}

} // namespace
