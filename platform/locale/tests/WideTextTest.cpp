#include <Tavro/Locale.h>

#include <string>

#include <gtest/gtest.h>

namespace {

using Tavro::make_string;

constexpr const char* replacement = "\xEF\xBF\xBD";

std::string utf8(unsigned int codePoint)
{
    return make_string(std::wstring(1, static_cast<wchar_t>(codePoint)));
}

TEST(WideText, anEmptyTextStaysEmpty)
{
    EXPECT_EQ(make_string(L""), "");
}

TEST(WideText, becomesUtf8)
{
    EXPECT_EQ(make_string(L"Diagnostic Indicator"), "Diagnostic Indicator");
    EXPECT_EQ(make_string(L"L\u00FCfter \u2460 \u8A3A \U0001F6A8"),
              "L\xC3\xBC"
              "fter \xE2\x91\xA0 \xE8\xA8\xBA \xF0\x9F\x9A\xA8");
}

TEST(WideText, keepsNullCharacters)
{
    EXPECT_EQ(make_string(std::wstring(L"a\0b", 3)), std::string("a\0b", 3));
}

TEST(WideText, encodesTheEndsOfEachLength)
{
    EXPECT_EQ(utf8(0x7F), "\x7F");
    EXPECT_EQ(utf8(0x80), "\xC2\x80");
    EXPECT_EQ(utf8(0x7FF), "\xDF\xBF");
    EXPECT_EQ(utf8(0x800), "\xE0\xA0\x80");
    EXPECT_EQ(utf8(0xFFFF), "\xEF\xBF\xBF");
    EXPECT_EQ(utf8(0x10000), "\xF0\x90\x80\x80");
    EXPECT_EQ(utf8(0x10FFFF), "\xF4\x8F\xBF\xBF");
}

TEST(WideText, replacesWhatIsNoCharacter)
{
    for (const unsigned int codePoint :
         {0xD800U, 0xDBFFU, 0xDC00U, 0xDFFFU, 0x110000U, 0x7FFFFFFFU, 0x80000000U, 0xFFFFFFFFU})
        EXPECT_EQ(utf8(codePoint), replacement) << std::hex << codePoint;
}

TEST(WideText, keepsTheNeighboursOfSurrogates)
{
    EXPECT_EQ(utf8(0xD7FF), "\xED\x9F\xBF");
    EXPECT_EQ(utf8(0xE000), "\xEE\x80\x80");
}

TEST(WideText, replacesEachHalfOfASurrogatePair)
{
    const std::wstring pair = {static_cast<wchar_t>(0xD83D), static_cast<wchar_t>(0xDEA8)};
    EXPECT_EQ(make_string(L"a" + pair + L"b"), std::string("a") + replacement + replacement + "b");
}

} // namespace
